#include "app/ranking/SnippetRanking.h"

#include <gmock/gmock.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <chrono>

#include "library/MemoryUserDefaults.h"
#include "tests/app/ranking/RankingSupport.h"

namespace plume {

namespace {

using testing::ElementsAre;

struct Texts {
    std::u16string abbreviation;
    std::u16string label;
    std::u16string content = u"#";
};

std::shared_ptr<Snippet> snippetOf(const Texts& texts) {
    auto snippet = std::make_shared<Snippet>(texts.abbreviation, texts.content);
    snippet->setLabel(texts.label);
    return snippet;
}

std::shared_ptr<SnippetGroup> groupOf(const std::vector<Texts>& all, const std::u16string& prefix = u"") {
    auto group = SnippetGroup::make();
    group->setAbbreviationPrefix(prefix);
    for (const Texts& each : all) group->addItem(snippetOf(each));
    return group;
}

// Abbreviations in the order of the rows, with a bar for the divider.
std::vector<std::string> namesOf(const std::vector<RankedSnippet>& rows) {
    std::vector<std::string> names;
    bool isBelow = false;
    for (const RankedSnippet& row : rows) {
        if (row.isLoose && !isBelow) names.emplace_back("|");
        isBelow = row.isLoose;
        names.push_back(toUtf8(row.snippet->abbreviation().value_or(u"")));
    }
    return names;
}

std::vector<std::string> found(const std::vector<Texts>& all, std::u16string_view query, const SearchRule& rule = {},
                               const std::u16string& prefix = u"") {
    SnippetRanking ranking;
    ranking.setLibrary({groupOf(all, prefix)});
    return namesOf(ranking.search(query, rule));
}

const Date Start{std::chrono::hours(24 * 20000)};

// What the search has to find at the least: the text as it is, but for letter case, in one of the fields.
bool holdsPlainly(const Snippet& snippet, std::u16string_view text, std::int64_t searchBy) {
    const auto holds = [&](const Snippet::Text& field) { return field && containsIgnoringCase(*field, text); };
    const bool hasAbbreviation = !snippet.abbreviation().value_or(u"").empty();
    const bool isAlone = (searchBy & (SearchRule::Content | SearchRule::Label)) == 0;
    const bool byAbbreviation = isAlone || (searchBy & SearchRule::Abbreviation) != 0;
    return (byAbbreviation && hasAbbreviation && holds(snippet.abbreviationWithPrefix())) ||
           ((searchBy & SearchRule::Content) != 0 && holds(snippet.plainTextContent())) ||
           ((searchBy & SearchRule::Label) != 0 && holds(snippet.label()));
}

}  // namespace

TEST(SnippetRankingTest, GoesFromExactAbbreviationsDownToSlips) {
    const std::vector<Texts> all{
        {u"incontent", u"x", u"a Letter to"},
        {u"bletters", u""},
        {u"inside", u"preletter"},
        {u"camel", u"myLetter"},
        {u"word", u"a letter"},
        {u"begins", u"Letters"},
        {u"letterhead", u""},
        {u"same", u"letter"},
        {u"letter", u""},
        {u"lextxtexr", u""},
        {u"none", u"nothing"},
    };
    EXPECT_THAT(found(all, u"letter"), ElementsAre("letter", "same", "letterhead", "begins", "word", "camel", "inside",
                                                   "bletters", "incontent", "|", "lextxtexr"));
}

TEST(SnippetRankingTest, TakesAbbreviationsWithAndWithoutTheirPrefix) {
    const std::vector<Texts> all{{u"asigb", u""}, {u"signal", u""}, {u":sig", u""}, {u"sig", u""}};
    const auto expected = ElementsAre("sig", ":sig", "signal", "asigb");
    EXPECT_THAT(found(all, u"sig", {}, u"ab"), expected);
    EXPECT_THAT(found(all, u"absig", {}, u"ab"), ElementsAre("sig", "signal", "|", ":sig", "asigb"));
    EXPECT_THAT(found({{u"--", u""}, {u"-->", u""}}, u"--", {}, u";"), ElementsAre("--", "-->"));
}

TEST(SnippetRankingTest, ForgivesSlipsOnlyWhereLittleElseIsFound) {
    const std::vector<Texts> two{{u"a", u"signature"}, {u"b", u"My Signatrue"}};
    EXPECT_THAT(found(two, u"signatrue"), ElementsAre("b", "|", "a"));
    std::vector<Texts> four = two;
    four.push_back({u"c", u"signatrue"});
    four.push_back({u"d", u"signatrue"});
    EXPECT_THAT(found(four, u"signatrue"), ElementsAre("c", "d", "b"));
    const struct {
        std::u16string query;
        bool isFound;
    } slips[] = {{u"sig", false},     {u"mael", true},       {u"mial", true},      {u"mailx", true},
                 {u"mol", false},     {u"mmiil", false},     {u"aderesses", true}, {u"adrezes", false},
                 {u"adressez", true}, {u"xaxdresses", true}, {u"ax", false},       {u"malings", false}};
    for (const auto& [query, isFound] : slips) {
        EXPECT_EQ(found({{u"x1", u"mail for addresses"}}, query).size(), isFound ? 2U : 0U) << toUtf8(query);
    }
}

TEST(SnippetRankingTest, SearchesOnlyTheFieldsThatAreAskedFor) {
    const std::vector<Texts> all{{u"key", u""}, {u"b", u"key"}, {u"c", u"", u"key"}, {u"kxexy", u"kxexy"}};
    const std::pair<std::int64_t, std::vector<std::string>> cases[] = {
        {7, {"key", "b", "c", "|", "kxexy"}},
        {1, {"key", "|", "kxexy"}},
        {2, {"c"}},
        {4, {"b", "|", "kxexy"}},
        {0, {"key", "|", "kxexy"}},
        {8, {"key", "|", "kxexy"}},
        {6, {"b", "c", "|", "kxexy"}},
        {-1, {"key", "b", "c", "|", "kxexy"}},
    };
    for (const auto& [searchBy, expected] : cases) {
        EXPECT_EQ(found(all, u"key", {.searchBy = searchBy}), expected) << searchBy;
    }
}

TEST(SnippetRankingTest, NeedsEveryTermAndPutsThemTogetherFirst) {
    const std::vector<Texts> all{{u"a", u"regards kind"},
                                 {u"b", u"kind regards"},
                                 {u"c", u"kind"},
                                 {u"d", u"regards", u"so kind"},
                                 {u"e", u"My kind regards"}};
    EXPECT_THAT(found(all, u" kind \t regards  "), ElementsAre("b", "a", "e", "d"));
    EXPECT_THAT(found(all, u"kind krx"), ElementsAre());
}

TEST(SnippetRankingTest, DecidesTiesByShortnessAndThenByPlace) {
    const std::vector<Texts> all{{u"", u"note"}, {u"long", u"note"}, {u"b", u"note"}, {u"a", u"note"}};
    EXPECT_THAT(found(all, u"note"), ElementsAre("b", "a", "long", ""));
}

TEST(SnippetRankingTest, PrefersWhatIsUsedAmongTheAlike) {
    Date now = Start;
    const ScopedDateSource dates([&now] { return now; });
    MemoryUserDefaults settings;
    settings.set(SnippetUses::SwitchKey, true);
    SnippetUses uses(settings);
    const auto group = groupOf({{u"mail", u""}, {u"mailbox", u""}, {u"mailing", u""}, {u"x", u"mails"}, {u"y", u""}});
    SnippetRanking ranking;
    ranking.setLibrary({group});
    ranking.setUses(&uses);
    const auto names = [&](std::u16string_view query) { return namesOf(ranking.search(query, {})); };
    EXPECT_THAT(names(u"mai"), ElementsAre("mail", "mailbox", "mailing", "x"));
    for (int i = 0; i < 9; ++i) uses.note(*group->items()[3]->uuid(), now);
    uses.note(*group->items()[2]->uuid(), now);
    EXPECT_THAT(names(u"mai"), ElementsAre("mailing", "mail", "mailbox", "x")) << "a better tier stays better";
    now += std::chrono::hours(24 * 200);
    for (int i = 0; i < 3; ++i) uses.note(*group->items()[1]->uuid(), now);
    EXPECT_THAT(names(u"mai"), ElementsAre("mailbox", "mailing", "mail", "x")) << "what is long ago hardly counts";
    settings.set(SnippetUses::SwitchKey, false);
    EXPECT_THAT(names(u"mai"), ElementsAre("mail", "mailbox", "mailing", "x"));
    ranking.setUses(nullptr);
    EXPECT_THAT(names(u"mai"), ElementsAre("mail", "mailbox", "mailing", "x"));
}

TEST(SnippetRankingTest, ShowsTheMostUsedAndThenTheNewestForNoQuery) {
    Date now = Start;
    const ScopedDateSource dates([&now] { return now += std::chrono::minutes(1); });
    MemoryUserDefaults settings;
    settings.set(SnippetUses::SwitchKey, true);
    SnippetUses uses(settings);
    const auto group = SnippetGroup::make();
    for (int i = 0; i < 60; ++i) group->addItem(snippetOf({fromUtf8(std::to_string(i)), u""}));
    group->items()[7]->setLabel(u"changed");
    uses.note(*group->items()[1]->uuid(), now);
    for (int i = 0; i < 2; ++i) uses.note(*group->items()[0]->uuid(), now);
    SnippetRanking ranking;
    ranking.setLibrary({group});
    ranking.setUses(&uses);
    for (const std::u16string_view query : {u"", u"   ", u"\t\u00A0"}) {
        auto names = namesOf(ranking.search(query, {}));
        ASSERT_EQ(names.size(), SnippetRanking::RecentRows);
        names.resize(5);
        EXPECT_THAT(names, ElementsAre("0", "1", "7", "59", "58"));
    }
}

TEST(SnippetRankingTest, FollowsTheLibrary) {
    SnippetRanking ranking;
    const auto group = groupOf({{u"alpha", u""}, {u"beta", u""}, {u"gamma", u""}});
    ranking.setLibrary({group});
    EXPECT_THAT(namesOf(ranking.search(u"a", {})), ElementsAre("alpha", "beta", "gamma"));
    group->items()[1]->setAbbreviation(u"bett");
    group->insertItem(snippetOf({u"ab", u""}), 0);
    ranking.setLibrary({group});
    EXPECT_THAT(namesOf(ranking.search(u"ga", {})), ElementsAre("gamma"));
    EXPECT_THAT(namesOf(ranking.search(u"a", {})), ElementsAre("ab", "alpha", "gamma"));
    group->setAbbreviationPrefix(u"qq");
    ranking.release();
    EXPECT_EQ(ranking.memory(), 0U);
    EXPECT_THAT(namesOf(ranking.search(u"qqbett", {})), ElementsAre("bett"));
    group->setAbbreviationPrefix(u"pp");
    ranking.setLibrary({group});
    EXPECT_THAT(namesOf(ranking.search(u"ppbett", {})), ElementsAre("bett"));
    ranking.setLibrary({});
    EXPECT_THAT(ranking.search(u"a", {}), testing::IsEmpty());
}

TEST(SnippetRankingTest, SortsTheFirstRowsAndKeepsTheOthersInPlace) {
    std::vector<Texts> all;
    for (std::size_t i = 0; i < 300; ++i) all.push_back({u"a" + std::u16string(300 - i, u'b'), u""});
    SnippetRanking ranking;
    ranking.setLibrary({groupOf(all)});
    const auto rows = ranking.search(u"a", {});
    ASSERT_EQ(rows.size(), 300U);
    std::vector<std::size_t> lengths;
    for (const RankedSnippet& row : rows) lengths.push_back(row.snippet->abbreviation()->size());
    for (std::size_t i = 0; i < 200; ++i) EXPECT_EQ(lengths[i], i + 2);
    for (std::size_t i = 200; i < 300; ++i) EXPECT_EQ(lengths[i], 501 - i);
}

TEST(SnippetRankingTest, WithWildcardsFindsWhatIsLikeThePatternAsAWhole) {
    const SearchRule wild{.isWildcard = true};
    const std::vector<Texts> all{{u"zabcd", u""}, {u"ABXC", u""}, {u"abc", u""}, {u"q", u"axxc"}, {u"r", u"", u"a\nc"}};
    EXPECT_THAT(found(all, u"a*c", wild), ElementsAre("ABXC", "abc", "q", "r"));
    EXPECT_THAT(found(all, u"a?c", wild), ElementsAre("abc", "r"));
    EXPECT_THAT(found(all, u"*b*", wild), ElementsAre("zabcd", "ABXC", "abc"));
    EXPECT_THAT(found(all, u"a?c", {.searchBy = 1, .isWildcard = true}), ElementsAre("abc"));
    EXPECT_THAT(found(all, u"pa?c", wild, u"p"), ElementsAre("abc"));
    EXPECT_THAT(found(all, u"a*c", {}), ElementsAre());
    EXPECT_THAT(found({{u"a**b", u""}, {u"ab", u""}}, u"**", wild), ElementsAre("a**b"));
}

RC_GTEST_PROP(SnippetRankingTest, FindsAtLeastWhatHoldsTheTextAsItIs, ()) {
    const auto groups = SnippetGroups{SnippetGroup::make(), SnippetGroup::make()};
    groups[1]->setAbbreviationPrefix(*randomText(2));
    for (int i = 0; i < 12; ++i) {
        groups[static_cast<std::size_t>(i) % 2]->addItem(snippetOf({*randomText(4), *randomText(8), *randomText(20)}));
    }
    SnippetRanking ranking;
    ranking.setLibrary(groups);
    SearchRule rule{.searchBy = *rc::gen::inRange<std::int64_t>(0, 8)};
    // As it is typed, letter by letter: a search among what was found before must find the same as one of its own.
    const std::u16string text = *randomText(4);
    for (std::size_t length = 1; length <= text.size(); ++length) {
        const std::u16string typed = text.substr(0, length);
        if (trimmed(typed).empty() || (typed.back() & 0xFC00) == 0xD800) continue;
        const auto rows = ranking.search(typed, rule);
        SnippetRanking fresh;
        fresh.setLibrary(groups);
        RC_ASSERT(namesOf(rows) == namesOf(fresh.search(typed, rule)));
        for (const auto& group : groups) {
            for (const auto& snippet : group->items()) {
                if (!holdsPlainly(*snippet, typed, rule.searchBy)) continue;
                RC_ASSERT(std::any_of(rows.begin(), rows.end(), [&](const RankedSnippet& row) {
                    return row.snippet == snippet && !row.isLoose;
                }));
            }
        }
    }
}

TEST(SnippetRankingTest, StaysQuickWhateverIsSearchedFor) {
    const std::u16string million(1'000'000, u'a');
    std::u16string words;
    for (int i = 0; i < 5000; ++i) words += fromUtf8("a" + std::to_string(i) + " ");
    SnippetRanking ranking;
    ranking.setLibrary({groupOf({{u"a", u"b", million}, {million, million, words}, {u"x", million + u"b", million}})});
    const std::u16string queries[] = {million,
                                      words,
                                      std::u16string(10'000, u' '),
                                      std::u16string(10'000, u' ') + u"b",
                                      million.substr(0, 60) + u"b",
                                      std::u16string(5000, u'a') + u"c",
                                      u"*a*a*a*a*a*a*b*",
                                      std::u16string(2000, u'*') + u"c",
                                      std::u16string(3000, 0x0301),
                                      std::u16string(1, 0xD83D)};
    const auto start = std::chrono::steady_clock::now();
    for (const std::u16string& query : queries) {
        for (const bool isWildcard : {false, true}) {
            const SearchRule rule{.isWildcard = isWildcard};
            (void)ranking.search(query, rule);
            (void)highlights(million.substr(0, 100'000), query, rule, true);
        }
    }
    // Far more than it takes on a slow machine without optimisation, far less than anything that grows with a square.
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(30));
}

}  // namespace plume

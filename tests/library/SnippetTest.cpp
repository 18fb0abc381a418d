#include "library/Snippet.h"

#include <gtest/gtest.h>

#include <functional>
#include <string>

#include "library/AbbreviationHash.h"
#include "library/SnippetGroup.h"
#include "tests/library/LibrarySupport.h"

namespace plume {
namespace {

using namespace std::chrono_literals;
using test::StoppedDate;

TEST(Snippet, StartsWithItsDatesNowAndNothingElse) {
    StoppedDate date;
    const Snippet empty;
    EXPECT_EQ(empty.dateCreated(), date.now());
    EXPECT_EQ(empty.dateModified(), date.now());
    EXPECT_EQ(empty.lastTimeUsed(), date.now());
    EXPECT_EQ(empty.abbreviation(), std::nullopt);
    EXPECT_EQ(empty.plainTextContent(), std::nullopt);
    EXPECT_EQ(empty.contentData(), std::nullopt);
    EXPECT_TRUE(empty.isSimpleSnippet());
    EXPECT_NE(empty.uuid(), Snippet().uuid());
}

struct Change {
    const char* name;
    std::function<void(Snippet&)> make;
    bool modifies;
};

TEST(Snippet, RemembersWhenItWasModifiedAndUsed) {
    const Change changes[] = {
        {"abbreviation", [](Snippet& s) { s.setAbbreviation(u"other"); }, true},
        {"same abbreviation", [](Snippet& s) { s.setAbbreviation(s.abbreviation()); }, true},
        {"label", [](Snippet& s) { s.setLabel(u"Label"); }, true},
        {"rich content", [](Snippet& s) { s.setRichTextContent(AttributedString(u"x")); }, true},
        {"no rich content", [](Snippet& s) { s.setRichTextContent(std::nullopt); }, true},
        {"plain content", [](Snippet& s) { s.setPlainTextContent(u"x"); }, true},
        {"no plain content", [](Snippet& s) { s.setPlainTextContent(std::nullopt); }, true},
        {"type", [](Snippet& s) { s.setContentType(ContentType::ShellScript); }, true},
        {"same type", [](Snippet& s) { s.setContentType(ContentType::RichText); }, false},
        {"case", [](Snippet& s) { s.setCaseSensitivity(CaseSensitivity::IgnoreCase); }, false},
        {"note", [](Snippet& s) { s.setNote(u"note"); }, false},
        {"group", [](Snippet& s) { s.setParentGroup(SnippetGroup::make()); }, false},
        {"use", [](Snippet& s) { s.updateLastTimeUsed(); }, false},
    };
    for (const Change& change : changes) {
        StoppedDate date;
        const Date created = date.now();
        const auto snippet = test::fullSnippet();
        date.pass(60s);
        change.make(*snippet);
        EXPECT_EQ(snippet->dateModified(), change.modifies ? date.now() : created) << change.name;
        EXPECT_EQ(snippet->lastTimeUsed(), std::string(change.name) == "use" ? date.now() : created) << change.name;
        EXPECT_EQ(snippet->dateCreated(), created) << change.name;
    }
}

TEST(Snippet, HashFollowsTheAbbreviation) {
    Snippet snippet(u"Sig", u"x");
    EXPECT_EQ(snippet.abbreviationHash(), hashOfSuffix(u"sig"));
    snippet.setAbbreviation(u"ADDR");
    EXPECT_EQ(snippet.abbreviationHash(), hashOfSuffix(u"addr"));
    snippet.setAbbreviation(std::nullopt);
    EXPECT_EQ(snippet.abbreviationHash(), EmptySuffixHash);
}

TEST(Snippet, FormattingGoesWhenItBecomesPlainTextOnly) {
    Snippet snippet;
    snippet.setContentType(ContentType::RichText);
    snippet.setContentType(ContentType::PlainText);
    EXPECT_FALSE(snippet.hasContent());
    snippet.setContentType(ContentType::RichText);
    snippet.setRichTextContent(test::richText());
    snippet.setContentType(ContentType::ShellScript);
    EXPECT_EQ(snippet.richTextContent(), test::richText());
    snippet.setContentType(ContentType::PlainText);
    EXPECT_EQ(snippet.richTextContent(), AttributedString(u"plain bold"));
}

TEST(Snippet, AnEmptyContentIsAContent) {
    Snippet snippet;
    snippet.setPlainTextContent(u"");
    EXPECT_EQ(snippet.plainTextContent(), u"");
    EXPECT_NE(snippet.contentData(), std::nullopt);
    EXPECT_EQ(snippet.contentLength(), 0U);
    snippet.setPlainTextContent(u"a\U0001F600");
    EXPECT_EQ(snippet.contentLength(), 3U);
    snippet.setPlainTextContent(std::nullopt);
    EXPECT_FALSE(snippet.hasContent());
    EXPECT_EQ(snippet.contentLength(), 0U);
}

TEST(Snippet, ThePrefixOfALivingGroupStandsBeforeANonEmptyAbbreviation) {
    const struct {
        Snippet::Text prefix;
        Snippet::Text abbreviation;
        Snippet::Text expected;
    } cases[] = {
        {u";", u"ad", u";ad"},
        {u"", u"ad", u"ad"},
        {std::nullopt, u"ad", u"ad"},
        {u";", u"", u""},
        {u";", std::nullopt, std::nullopt},
    };
    for (const auto& c : cases) {
        Snippet snippet(c.abbreviation, u"x");
        {
            const auto group = SnippetGroup::make();
            group->setAbbreviationPrefix(c.prefix);
            snippet.setParentGroup(group);
            EXPECT_EQ(snippet.abbreviationWithPrefix(), c.expected);
        }
        EXPECT_EQ(snippet.parentGroup(), nullptr);
        EXPECT_EQ(snippet.abbreviationWithPrefix(), c.abbreviation);
    }
}

TEST(Snippet, SortsByLabelOrElseContent) {
    Snippet snippet(u"a", u"content");
    EXPECT_EQ(snippet.sortingContent(), u"content");
    snippet.setLabel(u"");
    EXPECT_EQ(snippet.sortingContent(), u"content");
    snippet.setLabel(u"label");
    EXPECT_EQ(snippet.sortingContent(), u"label");
}

TEST(Snippet, ComparesContentsAsTheirTypeShowsThem) {
    Snippet a(u"a", u"plain bold");
    Snippet b(u"b", u"other");
    b.setLabel(u"label");
    b.setRichTextContent(test::richText());
    EXPECT_TRUE(a.isContentEqualTo(b)) << "plain text has no formatting to compare";
    b.setCaseSensitivity(CaseSensitivity::IgnoreCase);
    EXPECT_FALSE(a.isContentEqualTo(b));
    a.setCaseSensitivity(CaseSensitivity::IgnoreCase);
    a.setContentType(ContentType::RichText);
    EXPECT_FALSE(a.isContentEqualTo(b)) << "the types differ";
    b.setContentType(ContentType::RichText);
    EXPECT_FALSE(a.isContentEqualTo(b)) << "the formatting differs";
    a.setRichTextContent(test::richText());
    EXPECT_TRUE(a.isContentEqualTo(b));
    a.setPlainTextContent(u"");
    b.setPlainTextContent(std::nullopt);
    EXPECT_FALSE(a.isContentEqualTo(b)) << "an empty content is not a missing one";
}

TEST(Snippet, KnowsScriptsAndPlaceholders) {
    Snippet snippet(u"a", u"no placeholder】");
    EXPECT_TRUE(snippet.isSimpleSnippet());
    snippet.setPlainTextContent(u"with 【clipboard】");
    EXPECT_FALSE(snippet.isSimpleSnippet());
    for (const auto type : {ContentType::RichText, ContentType::PlainText, static_cast<ContentType>(4)}) {
        snippet.setContentType(type);
        EXPECT_FALSE(snippet.isScript());
    }
    for (const auto type : {ContentType::AppleScript, ContentType::ShellScript}) {
        snippet.setContentType(type);
        EXPECT_TRUE(snippet.isScript());
    }
}

TEST(Snippet, DuplicateSharesEverythingButIdentityDatesAndList) {
    StoppedDate date;
    const auto group = SnippetGroup::make();
    const auto original = test::fullSnippet();
    group->addItem(original);
    date.pass(60s);
    const auto copy = original->copySnippet();
    EXPECT_EQ(test::fieldsOf(*copy), test::fieldsOf(*original));
    EXPECT_NE(copy->uuid(), original->uuid());
    EXPECT_EQ(copy->dateCreated(), date.now());
    EXPECT_EQ(copy->dateModified(), date.now());
    EXPECT_EQ(copy->lastTimeUsed(), date.now());
    EXPECT_EQ(copy->parentGroup(), group);
    EXPECT_EQ(group->items().size(), 1U);
}

}  // namespace
}  // namespace plume

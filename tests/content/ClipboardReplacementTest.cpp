#include "content/ClipboardReplacement.h"
#include "content/ExpansionContext.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <chrono>

#include "Foundation/Strings.h"
#include "tests/content/world/ContentWorld.h"

namespace plume {
namespace {

// Collects what is reported.
struct Reports {
    ContentEnvironment environment() {
        ContentEnvironment result;
        result.report = [this](const std::string& sentence) { sentences.push_back(sentence); };
        return result;
    }
    std::vector<std::string> sentences;
};

SnippetClipboardVariable variable(const std::u16string& find, const std::u16string& replacement, int flags) {
    return SnippetClipboardVariable(
        {{u"find", find}, {u"replacement", replacement}, {u"flags", fromUtf8(std::to_string(flags))}});
}

// With all the time that an expansion has.
template <class Content>
Content process(const SnippetClipboardVariable& variable, const Content& content,
                const ContentEnvironment& environment) {
    std::chrono::nanoseconds timeLeft = ExpansionContext::MaximumPatternTime;
    return processClipboardVariable(variable, content, environment, timeLeft);
}

std::u16string replaced(const std::u16string& find, const std::u16string& replacement, int flags,
                        const std::u16string& content) {
    return process(variable(find, replacement, flags), content, ContentEnvironment());
}

SharedAttributes size(double points) {
    TextAttributes attributes;
    attributes.font = FontAttribute{u"Times", points, false, false};
    return std::make_shared<const TextAttributes>(attributes);
}

TEST(ClipboardReplacement, FollowsEveryCombinationOfFlags) {
    const struct {
        int flags;
        const char16_t* result;
    } cases[] = {
        {0, u"# #x y# y#x ax"},   {2, u"# #x ya. yA.x ax"},   {4, u"# A.x ya. yA.x ax"},  {6, u"# A.x y# yA.x ax"},
        {8, u"# A.x y# yA.x ax"}, {10, u"# A.x ya. yA.x ax"}, {12, u"# A.x ya. yA.x ax"}, {14, u"# A.x y# yA.x ax"},
        {1, u"# #x y# y#x #"},    {3, u"# #x y# y#x #"},      {5, u"# #x y# y#x #"},      {7, u"# #x y# y#x #"},
        {9, u"# A.x y# yA.x #"},  {11, u"# A.x y# yA.x #"},   {13, u"# A.x y# yA.x #"},   {15, u"# A.x y# yA.x #"}};
    for (const auto& c : cases) {
        EXPECT_EQ(toUtf8(replaced(u"a.", u"#", c.flags, u"a. A.x ya. yA.x ax")), toUtf8(c.result)) << c.flags;
    }
}

TEST(ClipboardReplacement, ReplacesPlainText) {
    const struct {
        const char* what;
        std::u16string find;
        std::u16string replacement;
        int flags;
        std::u16string content;
        std::u16string result;
    } cases[] = {
        {"nothing to find", u"", u"x", 1, u"a", u"a"},
        {"whole words in other scripts", u"été", u"x", 4, u"été étés l'été (été)", u"x étés l'x (x)"},
        {"underscores and digits belong to words", u"a", u"b", 4, u"a_ a1 _a a", u"a_ a1 _a b"},
        {"find text that ends quoting", u"a\\Eb", u"x", 4, u"a\\Eb ab aEb", u"x ab aEb"},
        {"find text full of syntax", u"[(*\\Q", u"x", 6, u"[(*\\Q", u"x"},
        {"literal replacement stays literal", u"a", u"$0\\", 0, u"a", u"$0\\"},
        {"named group", u"(?<user>\\w+)@", u"${user}!", 1, u"me@home", u"me!home"},
        {"group that took no part", u"(a)|b", u"<$1>", 1, u"ab", u"<a><>"},
        {"digit after the last group", u"(a)", u"$12", 1, u"a", u"a2"},
        {"escaped dollar", u"a", u"\\$1", 1, u"a", u"$1"},
        {"dollar before no group", u"a", u"US$ $", 1, u"a", u"US$ $"},
        {"empty matches", u"x*", u"-", 1, u"axb", u"-a--b-"},
        {"empty matches around a surrogate pair", u"y*", u"-", 1, u"😀", u"-😀-"},
        {"look-behind sees what was replaced", u"(?<=a)b|a", u"x", 1, u"abb", u"xxb"},
        {"unpaired surrogates", u"_b", u"_x", 1, u"a\xD83D_b", u"a\xD83D_x"},
    };
    for (const auto& c : cases) {
        EXPECT_EQ(toUtf8(replaced(c.find, c.replacement, c.flags, c.content)), toUtf8(c.result)) << c.what;
    }
}

TEST(ClipboardReplacement, LeavesTheContentAndReportsOnceWhatCannotWork) {
    const struct {
        std::u16string find;
        std::u16string replacement;
        std::u16string content;
    } cases[] = {
        {u"(one", u"x", u"(one"},      {u"two", u"$9", u"two"},    {u"three", u"${nobody}", u"three"},
        {u"four", u"${four", u"four"}, {u"five", u"x\\", u"five"}, {std::u16string(100'000, u'6'), u"x", u"6"},
    };
    for (const auto& [find, replacement, content] : cases) {
        Reports reports;
        const auto pattern = variable(find, replacement, 1);
        const AttributedString rich(content, size(9));
        for (int i = 0; i < 2; ++i) {
            EXPECT_EQ(process(pattern, content, reports.environment()), content);
            EXPECT_EQ(process(pattern, rich, reports.environment()), rich);
        }
        EXPECT_EQ(reports.sentences.size(), 1U) << toUtf8(content);
    }
}

TEST(ClipboardReplacement, GivesUpOnPatternsThatExplode) {
    const std::u16string explosive = std::u16string(5'000, u'a') + u"b";
    const std::pair<std::u16string, std::u16string> cases[] = {
        {u"(a+)+$", explosive}, {u"(a|aa)+$", explosive}, {u"(?:a|b)*c", std::u16string(3'000'000, u'a')}};
    for (const auto& [find, content] : cases) {
        Reports reports;
        std::chrono::nanoseconds timeLeft = std::chrono::hours(1);
        const auto start = std::chrono::steady_clock::now();
        EXPECT_EQ(processClipboardVariable(variable(find, u"x", 1), content, reports.environment(), timeLeft), content);
        EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(2)) << toUtf8(find);
        EXPECT_LT(timeLeft, std::chrono::hours(1)) << toUtf8(find);
        EXPECT_EQ(reports.sentences.size(), 1U) << toUtf8(find);
    }
}

TEST(ClipboardReplacement, SearchesForNoPatternWhenTheTimeIsUpButAlwaysForText) {
    Reports reports;
    std::chrono::nanoseconds timeLeft{0};
    for (const auto& [flags, expected] : {std::pair(0, u"xp"), std::pair(1, u"up"), std::pair(2, u"up")}) {
        const auto asked = variable(u"u", u"x", flags);
        EXPECT_EQ(processClipboardVariable(asked, u"up", reports.environment(), timeLeft), expected);
        const AttributedString rich(u"up");
        EXPECT_EQ(processClipboardVariable(asked, rich, reports.environment(), timeLeft).string(), expected);
    }
    EXPECT_EQ(timeLeft, std::chrono::nanoseconds(0)) << "text takes no time off";
    EXPECT_EQ(reports.sentences.size(), 1U);
}

TEST(ClipboardReplacement, HoldsAnExpansionUpNoLongerForManyPatternsThatExplode) {
    ContentWorld world;
    world.pasteboard.plainText = std::string(5'000, 'a') + "b";
    std::string content;
    std::string unchanged;
    for (int i = 0; i < 30; ++i) {
        content += "【clipboard find:(a+)+" + std::to_string(i) + "$ flags:1】";
        unchanged += *world.pasteboard.plainText;
    }
    for (const ContentType type : {ContentType::PlainText, ContentType::RichText}) {
        const auto start = std::chrono::steady_clock::now();
        EXPECT_EQ(toUtf8(world.expand(content, type)->string()), unchanged);
        EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(2));
    }
    EXPECT_GE(world.reports.size(), 30U);
}

TEST(ClipboardReplacement, FindsLiteralTextInLinearTime) {
    const std::u16string content(2'000'000, u'a');
    const std::u16string find = std::u16string(100'000, u'A') + u"b";
    EXPECT_EQ(replaced(find, u"x", 0, content), content);
    EXPECT_EQ(replaced(find, u"x", 0, content + u"b" + content), std::u16string(1'900'000, u'a') + u"x" + content);
}

RC_GTEST_PROP(ClipboardReplacement, FindsLiteralTextWhereASimpleSearchDoes, ()) {
    const auto texts = rc::gen::container<std::string>(rc::gen::elementOf(std::string("aA")));
    const auto content = fromUtf8(*texts);
    const auto find = fromUtf8(*rc::gen::resize(5, rc::gen::nonEmpty(texts)));
    RC_ASSERT(replaced(find, u"-", 8, content) == replacingAll(content, find, u"-"));
}

TEST(ClipboardReplacement, RefusesResultsThatGrowWithoutMeasure) {
    std::u16string copies;
    for (int i = 0; i < 4'000; ++i) copies += u"$0";
    const std::u16string content(100'000, u'a');
    Reports reports;
    EXPECT_EQ(process(variable(u".*grow|.+", copies, 1), content, reports.environment()), content);
    EXPECT_EQ(process(variable(u"a", std::u16string(10'000, u'x'), 0), content, reports.environment()), content);
    EXPECT_EQ(reports.sentences.size(), 2U);
}

TEST(ClipboardReplacement, GivesTheReplacementTheLookOfWhatStoodThere) {
    AttributedString content(u"one ", size(1));
    content.append(u"two", size(2));
    content.append(u" three", size(3));
    AttributedString expected(u"one ", size(1));
    expected.append(u"zwei drei", size(2));
    EXPECT_EQ(process(variable(u"two three", u"zwei drei", 0), content, ContentEnvironment()), expected);
    EXPECT_EQ(process(variable(u"(two) three", u"zwei drei", 1), content, ContentEnvironment()), expected);

    AttributedString marked(u"one |", size(1));  // at an empty match: of what stands before
    marked.append(u"two", size(2));
    marked.append(u" three", size(3));
    EXPECT_EQ(process(variable(u"(?=two)", u"|", 1), content, ContentEnvironment()), marked);

    TextAttributes file;
    file.attachment = std::make_shared<const TextAttachment>(TextAttachment{u"a.png", "bytes", u""});
    const AttributedString attached(u"\uFFFC", std::make_shared<const TextAttributes>(file));
    EXPECT_EQ(process(variable(u"\uFFFC", u"x", 0), attached, ContentEnvironment()), AttributedString(u"x"));
}

TEST(ClipboardReplacement, RewritesRichTextOfManyRuns) {
    AttributedString content;
    AttributedString expected;
    for (int i = 0; i < 3'000; ++i) {
        const SharedAttributes look = size(i % 7 + 1);
        content.append(u"ab", look);
        expected.append(u"xyb", look);
    }
    EXPECT_EQ(process(variable(u"a", u"xy", 1), content, ContentEnvironment()), expected);
    EXPECT_EQ(process(variable(u"a", u"xy", 0), content, ContentEnvironment()), expected);
}

RC_GTEST_PROP(ClipboardReplacement, SaysTheSameInRichAndInPlainText, ()) {
    const auto texts = rc::gen::container<std::string>(rc::gen::elementOf(std::string("aAb. ")));
    const auto pieces = *rc::gen::container<std::vector<std::string>>(texts);
    AttributedString content;
    for (std::size_t i = 0; i < pieces.size(); ++i) content.append(fromUtf8(pieces[i]), size(static_cast<double>(i)));
    const auto find = fromUtf8(*rc::gen::nonEmpty(texts));
    const auto pattern = variable(find, u"<>", *rc::gen::inRange(0, 16));
    const AttributedString result = process(pattern, content, ContentEnvironment());
    RC_ASSERT(toUtf8(result.string()) == toUtf8(process(pattern, content.string(), ContentEnvironment())));
}

}  // namespace
}  // namespace plume

#include "content/SnippetVariable.h"

#include <gtest/gtest.h>

#include "Foundation/Strings.h"
#include "content/SnippetVariableUtils.h"

namespace plume {
namespace {

template <typename Variable>
std::shared_ptr<Variable> read(std::u16string_view body) {
    return std::dynamic_pointer_cast<Variable>(SnippetVariableUtils::parseVariable(body));
}

struct WrittenBack {
    const char* what;
    std::u16string body;
    std::u16string written;
};

void PrintTo(const WrittenBack& writtenBack, std::ostream* out) {
    *out << writtenBack.what;
}

class WritingBack : public testing::TestWithParam<WrittenBack> {};

TEST_P(WritingBack, GivesTheBody) {
    const auto variable = SnippetVariableUtils::parseVariable(GetParam().body);
    ASSERT_NE(variable, nullptr);
    EXPECT_EQ(toUtf8(variable->toString()), toUtf8(GetParam().written));
}

INSTANTIATE_TEST_SUITE_P(
    Keys, WritingBack,
    testing::Values(WrittenBack{"everything", u"key:↩ code:36 modifiers:131072 count:3 delay:0.5",
                                u"key:↩ code:36 modifiers:131072 count:3 delay:0.5"},
                    WrittenBack{"no code is no key", u"key:A", u"key:A code:65535"},
                    WrittenBack{"code beyond 16 bits is no key", u"key:A code:65572", u"key:A code:65535"},
                    WrittenBack{"negative code is no key", u"key:A code:-1", u"key:A code:65535"},
                    WrittenBack{"single press", u"key:A code:0 count:1", u"key:A code:0"},
                    WrittenBack{"no press becomes one", u"key:A code:0 count:0", u"key:A code:0"},
                    WrittenBack{"negative count becomes one", u"key:A code:0 count:-7", u"key:A code:0"},
                    WrittenBack{"count without sense", u"key:A code:0 count:many", u"key:A code:0"},
                    WrittenBack{"count without end", u"key:A code:0 count:99999999999999999999",
                                u"key:A code:0 count:10000"},
                    WrittenBack{"negative modifiers", u"key:A code:0 modifiers:-1", u"key:A code:0"},
                    WrittenBack{"label with a space", u"key:\"Page Up\" code:116", u"key:\"Page Up\" code:116"},
                    WrittenBack{"options are not written", u"key:A code:0 optional:1 readonly", u"key:A code:0"},
                    WrittenBack{"repeated parameter", u"key:A code:1 code:2", u"key:A code:2"},
                    WrittenBack{"grouped delay", u"key:A code:0 delay:1,234.5", u"key:A code:0 delay:1,234.5"},
                    WrittenBack{"ungrouped delay", u"key:A code:0 delay:1234.5", u"key:A code:0 delay:1,234.5"},
                    WrittenBack{"comma that groups nothing", u"key:A code:0 delay:1,5", u"key:A code:0 delay:1"},
                    WrittenBack{"comma before four digits", u"key:A code:0 delay:1,2345", u"key:A code:0 delay:1"},
                    WrittenBack{"three fraction digits", u"key:A code:0 delay:0.12345", u"key:A code:0 delay:0.123"},
                    WrittenBack{"delay with exponent", u"key:A code:0 delay:5e-1", u"key:A code:0 delay:0.5"},
                    WrittenBack{"delay with sign and space", u"key:A code:0 delay:\" +2\"", u"key:A code:0 delay:2"},
                    WrittenBack{"negative delay", u"key:A code:0 delay:-1", u"key:A code:0"},
                    WrittenBack{"infinite delay", u"key:A code:0 delay:inf", u"key:A code:0"},
                    WrittenBack{"delay that is no number", u"key:A code:0 delay:nan", u"key:A code:0"},
                    WrittenBack{"delay of years", u"key:A code:0 delay:1e30", u"key:A code:0 delay:86,400"}));

INSTANTIATE_TEST_SUITE_P(
    Fields, WritingBack,
    testing::Values(WrittenBack{"bare", u"field", u"field"}, WrittenBack{"empty name", u"field:", u"field"},
                    WrittenBack{"letters after the word", u"fields:Name", u"field"},
                    WrittenBack{"name and value", u"field:\"First name\" value:\"a \"\"b\"\": c\"",
                                u"field:\"First name\" value:\"a \"\"b\"\": c\""},
                    WrittenBack{"empty value", u"field:Name value:", u"field:Name"},
                    WrittenBack{"sizes after the options",
                                u"field:N type:1 width:40 height:7 optional:1 readonly value:x",
                                u"field:N type:1 value:x optional:1 readonly width:40 height:7"},
                    WrittenBack{"default sizes", u"field:N type:1", u"field:N type:1"},
                    WrittenBack{"sizes of 0 and less", u"field:N type:1 width:0 height:-3", u"field:N type:1"},
                    WrittenBack{"single line has no height", u"field:N height:7 width:9", u"field:N width:9"},
                    WrittenBack{"number has neither size nor read-only", u"field:N type:3 width:9 height:9 readonly",
                                u"field:N type:3"},
                    WrittenBack{"menu writes its default under the width",
                                u"field:N type:2 value:a\nb\nc defaultIndex:2",
                                u"field:N type:2 width:2 value:a\nb\nc"},
                    WrittenBack{"menu loses its default when read again", u"field:N type:2 width:2 value:a",
                                u"field:N type:2 width:0 value:a"},
                    WrittenBack{"unknown type is kept", u"field:N type:9 width:3", u"field:N type:9"},
                    WrittenBack{"type beyond 32 bits", u"field:N type:4294967297", u"field:N type:2147483647"},
                    WrittenBack{"odd option is ticked", u"field:N optional:3", u"field:N optional:1"},
                    WrittenBack{"option that is no number", u"field:N optional:yes", u"field:N optional:0"},
                    WrittenBack{"option without a value", u"field:N optional", u"field:N optional:0"},
                    WrittenBack{"read-only", u"field:N readonly:0", u"field:N readonly"}));

INSTANTIATE_TEST_SUITE_P(
    ClipboardAndSnippets, WritingBack,
    testing::Values(WrittenBack{"clipboard alone", u"clipboard", u"clipboard flags:0"},
                    WrittenBack{"clipboard followed by anything", u"clipboards find:a", u"clipboard find:a flags:0"},
                    WrittenBack{"clipboard with everything",
                                u"clipboard find:\"a b\" replacement:\"c:d\" flags:13 optional:1 readonly",
                                u"clipboard find:\"a b\" replacement:\"c:d\" flags:13 optional:1 readonly"},
                    WrittenBack{"clipboard keeps only four flags", u"clipboard flags:255", u"clipboard flags:15"},
                    WrittenBack{"snippet", u"snippet:\"a:b\" uuid:F00 optional:0",
                                u"snippet:\"a:b\" uuid:F00 optional:0"},
                    WrittenBack{"snippet without an abbreviation", u"snippet: uuid:F00", u"snippet: uuid:F00"}));

INSTANTIATE_TEST_SUITE_P(
    DatesAndTimes, WritingBack,
    testing::Values(WrittenBack{"date alone", u"date:short", u"date:short"},
                    WrittenBack{"pattern with spaces", u"date:\"d. MMMM yyyy\" locale:de_DE",
                                u"date:\"d. MMMM yyyy\" locale:de_DE"},
                    WrittenBack{"offsets", u"date:short day:-3 year:1 month:0", u"date:short year:1 day:-3"},
                    WrittenBack{"weekday hides offsets", u"date:short valueType:1 weekday:0 day:4",
                                u"date:short valueType:1 weekday:0"},
                    WrittenBack{"other value types are kept", u"date:short valueType:7 weekday:3",
                                u"date:short valueType:7 weekday:3"},
                    WrittenBack{"weekday of an offset", u"date:short weekday:3", u"date:short"},
                    WrittenBack{"optional date", u"date:short locale:fr_FR optional:1 readonly",
                                u"date:short locale:fr_FR optional:1 readonly"},
                    WrittenBack{"read-only date that is not optional", u"date:short readonly", u"date:short"},
                    WrittenBack{"time", u"time:\"HH:mm\" hour:1 minute:-90 second:0 locale:en_US optional:0",
                                u"time:\"HH:mm\" hour:1 minute:-90 locale:en_US optional:0"},
                    WrittenBack{"offset without end", u"time:short hour:99999999999999999999",
                                u"time:short hour:9223372036854775807"}));

TEST(SnippetFieldVariable, KnowsGivenSizesFromDefaultOnes) {
    const auto given = read<SnippetFieldVariable>(u"field:N type:1 width:12 height:3");
    EXPECT_EQ(given->width(), 12);
    EXPECT_EQ(given->height(), 3);
    EXPECT_TRUE(given->hasWidth() && given->hasHeight());

    const auto missing = read<SnippetFieldVariable>(u"field:N type:1 width:-1");
    EXPECT_EQ(missing->width(), 30);
    EXPECT_EQ(missing->height(), 5);
    EXPECT_FALSE(missing->hasWidth() || missing->hasHeight());
}

TEST(SnippetFieldVariable, ReadsTheDefaultOfAMenu) {
    EXPECT_EQ(read<SnippetFieldVariable>(u"field:N type:2 defaultIndex:2")->defaultIndex, 2);
    EXPECT_EQ(read<SnippetFieldVariable>(u"field:N type:2 width:2")->defaultIndex, 0);
}

TEST(SnippetKeyVariable, ReadsModifierBits) {
    const auto key = read<SnippetKeyVariable>(u"key:A code:0 modifiers:1179648");  // Shift and Command
    EXPECT_TRUE(key->shift());
    EXPECT_FALSE(key->control());
    EXPECT_FALSE(key->option());
    EXPECT_TRUE(key->command());
    EXPECT_TRUE(read<SnippetKeyVariable>(u"key:A modifiers:262144")->control());
    EXPECT_TRUE(read<SnippetKeyVariable>(u"key:A modifiers:524288")->option());
}

TEST(SnippetClipboardVariable, TakesItsFlagsApart) {
    const auto variable = read<SnippetClipboardVariable>(u"clipboard flags:13");
    EXPECT_TRUE(variable->regularExpressions);
    EXPECT_EQ(variable->matchingOption, SnippetClipboardVariable::MatchingOption::WholeWord);
    EXPECT_TRUE(variable->matchCase);
    EXPECT_EQ(variable->find, std::nullopt);
}

TEST(SnippetContentCaret, WritesItself) {
    EXPECT_EQ(SnippetContentCaret().toString(), u"|");
}

}  // namespace
}  // namespace plume

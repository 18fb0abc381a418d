#include "content/SnippetVariable.h"

#include <gtest/gtest.h>

#include "Foundation/Strings.h"
#include "content/PlaceholderKinds.h"
#include "content/SnippetFieldVariable.h"
#include "content/SnippetKeyVariable.h"

namespace plume {
namespace {

template <typename Variable>
std::shared_ptr<Variable> read(std::u16string_view body) {
    return std::dynamic_pointer_cast<Variable>(parseVariable(body));
}

TEST(SnippetVariable, IsWrittenBackAsItsKindAllows) {
    const struct {
        const char* what;
        const char16_t* body;
        const char16_t* written;
    } cases[] = {
        {"key with everything", u"key:↩ code:36 modifiers:131072 count:3 delay:0.5",
         u"key:↩ code:36 modifiers:131072 count:3 delay:0.5"},
        {"no code is no key", u"key:A", u"key:A code:65535"},
        {"code beyond 16 bits is no key", u"key:A code:65572", u"key:A code:65535"},
        {"negative code is no key", u"key:A code:-1", u"key:A code:65535"},
        {"no press becomes one", u"key:A code:0 count:0", u"key:A code:0"},
        {"negative count becomes one", u"key:A code:0 count:-7", u"key:A code:0"},
        {"count without end", u"key:A code:0 count:99999999999999999999", u"key:A code:0 count:10000"},
        {"negative modifiers", u"key:A code:0 modifiers:-1", u"key:A code:0"},
        {"options are not written", u"key:A code:0 optional:1 readonly", u"key:A code:0"},
        {"ungrouped delay", u"key:A code:0 delay:1234.5", u"key:A code:0 delay:1,234.5"},
        {"comma that groups nothing", u"key:A code:0 delay:1,5", u"key:A code:0 delay:1"},
        {"comma before four digits", u"key:A code:0 delay:1,2345", u"key:A code:0 delay:1"},
        {"three fraction digits", u"key:A code:0 delay:0.12345", u"key:A code:0 delay:0.123"},
        {"delay with exponent", u"key:A code:0 delay:5e-1", u"key:A code:0 delay:0.5"},
        {"delay with sign and space", u"key:A code:0 delay:\" +2\"", u"key:A code:0 delay:2"},
        {"infinite delay", u"key:A code:0 delay:inf", u"key:A code:0"},
        {"delay that is no number", u"key:A code:0 delay:nan", u"key:A code:0"},
        {"delay of years", u"key:A code:0 delay:1e30", u"key:A code:0 delay:86,400"},
        {"bare field", u"field", u"field"},
        {"letters after the word", u"fields:Name", u"field"},
        {"name and value", u"field:\"First name\" value:\"a \"\"b\"\": c\"",
         u"field:\"First name\" value:\"a \"\"b\"\": c\""},
        {"empty value", u"field:Name value:", u"field:Name"},
        {"sizes after the options", u"field:N type:1 width:40 height:7 optional:1 readonly value:x",
         u"field:N type:1 value:x optional:1 readonly width:40 height:7"},
        {"sizes of 0 and less", u"field:N type:1 width:0 height:-3", u"field:N type:1"},
        {"single line has no height", u"field:N height:7 width:9", u"field:N width:9"},
        {"number has neither size nor read-only", u"field:N type:3 width:9 height:9 readonly", u"field:N type:3"},
        {"menu writes its default under the width", u"field:N type:2 value:a\nb\nc defaultIndex:2",
         u"field:N type:2 width:2 value:a\nb\nc"},
        {"menu loses its default when read again", u"field:N type:2 width:2 value:a",
         u"field:N type:2 width:0 value:a"},
        {"unknown type is kept", u"field:N type:9 width:3", u"field:N type:9"},
        {"type beyond 32 bits", u"field:N type:4294967297", u"field:N type:2147483647"},
        {"odd option is ticked", u"field:N optional:3", u"field:N optional:1"},
        {"option that is no number", u"field:N optional:yes", u"field:N optional:0"},
        {"read-only", u"field:N readonly:0", u"field:N readonly"},
        {"clipboard followed by anything", u"clipboards find:a", u"clipboard find:a flags:0"},
        {"clipboard with everything", u"clipboard find:\"a b\" replacement:\"c:d\" flags:13 optional:1 readonly",
         u"clipboard find:\"a b\" replacement:\"c:d\" flags:13 optional:1 readonly"},
        {"clipboard keeps only four flags", u"clipboard flags:255", u"clipboard flags:15"},
        {"snippet", u"snippet:\"a:b\" uuid:F00 optional:0", u"snippet:\"a:b\" uuid:F00 optional:0"},
        {"snippet without an abbreviation", u"snippet: uuid:F00", u"snippet: uuid:F00"},
        {"offsets", u"date:short day:-3 year:1 month:0", u"date:short year:1 day:-3"},
        {"weekday hides offsets", u"date:short valueType:1 weekday:0 day:4", u"date:short valueType:1 weekday:0"},
        {"other value types are kept", u"date:short valueType:7 weekday:3", u"date:short valueType:7 weekday:3"},
        {"weekday of an offset", u"date:short weekday:3", u"date:short"},
        {"optional date", u"date:short locale:fr_FR optional:1 readonly",
         u"date:short locale:fr_FR optional:1 readonly"},
        {"read-only date that is not optional", u"date:short readonly", u"date:short"},
        {"time", u"time:\"HH:mm\" hour:1 minute:-90 second:0 locale:en_US optional:0",
         u"time:\"HH:mm\" hour:1 minute:-90 locale:en_US optional:0"},
        {"offset without end", u"time:short hour:99999999999999999999", u"time:short hour:9223372036854775807"},
    };
    for (const auto& c : cases) {
        const auto variable = parseVariable(c.body);
        ASSERT_NE(variable, nullptr) << c.what;
        EXPECT_EQ(toUtf8(variable->toString()), toUtf8(c.written)) << c.what;
    }
    EXPECT_EQ(SnippetContentCaret().toString(), u"|");
}

TEST(SnippetVariable, IsMadeForTheBodiesOfItsKindAlone) {
    for (const char16_t* body : {u"", u"|", u"◀", u"date", u"Date:short", u" date:short", u"key", u"snippet", u"x"}) {
        EXPECT_EQ(parseVariable(body), nullptr) << toUtf8(body);
    }
}

TEST(SnippetFieldVariable, HasDefaultSizes) {
    const auto field = read<SnippetFieldVariable>(u"field:N type:1 width:-1");
    EXPECT_EQ(field->width(), 30);
    EXPECT_EQ(field->height(), 5);
    EXPECT_FALSE(field->hasWidth() || field->hasHeight());
}

TEST(SnippetKeyVariable, ReadsModifierBits) {
    const auto key = read<SnippetKeyVariable>(u"key:A code:0 modifiers:1179648");  // Shift and Command
    EXPECT_TRUE(key->shift() && key->command());
    EXPECT_FALSE(key->control() || key->option());
    EXPECT_TRUE(read<SnippetKeyVariable>(u"key:A modifiers:262144")->control());
    EXPECT_TRUE(read<SnippetKeyVariable>(u"key:A modifiers:524288")->option());
}

}  // namespace
}  // namespace plume

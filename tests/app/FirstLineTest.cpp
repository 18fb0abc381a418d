#include "app/FirstLine.h"

#include <gtest/gtest.h>

#include "Foundation/Strings.h"

namespace plume {
namespace {

const std::string Cut = "\u2009…";

std::string line(std::u16string_view content) {
    return toUtf8(firstLine(content));
}

TEST(FirstLine, IsTheFirstThatSaysSomething) {
    const struct {
        std::u16string_view content;
        std::string line;
    } cases[] = {
        {u"", ""},
        {u" \t\r\n ", ""},
        {u"one", "one"},
        {u"  one \n\n", "one"},
        {u"\n \n one\ntwo", "one" + Cut},
        {u"one\r\ntwo", "one" + Cut},
        {u"one\u2028two", "one" + Cut},
        {u"one\u2029two", "one" + Cut},
        {u"one\ttwo", "one\ttwo"},
        {u"one \n two", "one" + Cut},
    };
    for (const auto& each : cases) EXPECT_EQ(line(each.content), each.line) << toUtf8(each.content);
}

TEST(FirstLine, IsCutBetweenCharacters) {
    const std::u16string full(80, u'x');
    EXPECT_EQ(line(full), toUtf8(full));
    EXPECT_EQ(line(full + u"y"), toUtf8(full) + Cut);
    EXPECT_EQ(line(full + u" \n"), toUtf8(full));
    // The pair would have one unit of itself in sight.
    EXPECT_EQ(line(full.substr(1) + u"\U0001F600"), toUtf8(full.substr(1)) + Cut);
    EXPECT_EQ(line(full.substr(2) + u"\U0001F600"), toUtf8(full.substr(2)) + "\U0001F600");
    EXPECT_EQ(line(full.substr(5) + u"     y"), toUtf8(full.substr(5)) + Cut);
}

TEST(FirstLine, DoesNotReadOnForEver) {
    for (const std::size_t blanks : {std::size_t{4094}, std::size_t{4095}, std::size_t{4096}, std::size_t{5'000'000}}) {
        const std::string shown = line(std::u16string(blanks, u' ') + u"\U0001F600");
        EXPECT_EQ(shown, blanks == 4094 ? "\U0001F600" : Cut) << blanks;
    }
    EXPECT_EQ(line(std::u16string(5'000'000, u'x')), std::string(80, 'x') + Cut);
}

}  // namespace
}  // namespace plume

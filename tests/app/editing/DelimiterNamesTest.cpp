#include "app/editing/DelimiterNames.h"

#include <gtest/gtest.h>

#include <vector>

#include "Foundation/Strings.h"

namespace plume {
namespace {

TEST(DelimiterNames, TellEveryCharacterSoThatItCanBeReadAndCalled) {
    struct Case {
        char32_t character;
        std::u16string name;
    };
    const std::vector<Case> cases{{U' ', u"Space"},
                                  {U'\t', u"Tab"},
                                  {U'\r', u"Return"},
                                  {U'\u0003', u"Enter"},
                                  {U'.', u"."},
                                  {U'\u00AB', u"\u00AB"},
                                  {U'\u00A0', u"U+00A0"},
                                  {U'\u200B', u"U+200B"},
                                  {U'\u0301', u"U+0301"},
                                  {U'\u0000', u"U+0000"},
                                  {U'\U0001F600', u"😀"},
                                  {U'\U000E0001', u"U+E0001"},
                                  {char32_t{0xD800}, u"U+D800"}};
    for (const auto& [character, name] : cases) {
        EXPECT_EQ(delimiterName(character), name);
        EXPECT_EQ(delimiterCalled(name), character);
    }
    EXPECT_EQ(delimiterName(U'\n'), u"Return");
    EXPECT_EQ(delimiterCalled(u"u+000a"), U'\r');
    EXPECT_EQ(delimiterCalled(u"sPACE"), U' ');
    for (const auto* none : {u"", u"ab", u"U+", u"U+A0", u"U+110000", u"U+00G0", u"U+0041x"}) {
        EXPECT_FALSE(delimiterCalled(none)) << toUtf8(none);
    }
}

TEST(DelimiterNames, TakeWhatPeopleWrite) {
    struct Case {
        std::u16string written;
        std::u16string read;
    };
    const std::vector<Case> cases{{u"", u""},
                                  {u"  ", u""},
                                  {u".,;", u", . ;"},
                                  {u", . , .", u", ."},
                                  {u"ab U+00A0 tab", u"Tab a b U+00A0"},
                                  {u"U+A0", u"+ 0 A U"},
                                  {u"\n\t.", u"Tab Return ."},
                                  {u"😀x", u"x 😀"}};
    for (const auto& [written, read] : cases) EXPECT_EQ(textFromDelimiters(delimitersFromText(written)), read);
}

TEST(DelimiterNames, OfASetThatIsWrittenReadAsTheSameSet) {
    std::u16string all;
    for (char16_t c = 0; c < 0x3100; ++c) {
        if (c != u'\n') all += c;
    }
    const auto set = CharacterSet::withCharacters(all);
    EXPECT_EQ(delimitersFromText(textFromDelimiters(set)), set);
}

}  // namespace
}  // namespace plume

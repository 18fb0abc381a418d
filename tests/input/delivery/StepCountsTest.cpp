#include "input/delivery/StepCounts.h"

#include <gtest/gtest.h>

#include "Foundation/Strings.h"

namespace plume {
namespace {

TEST(StepCounts, AreWhatProgramsWereSeenToTake) {
    const struct {
        const char* text;
        std::uint64_t character, emojiPart, emoji, letter, left;
    } cases[] = {
        {"", 0, 0, 0, 0, 0},
        {"abc é", 5, 5, 5, 5, 5},
        {"😀!", 2, 2, 2, 2, 2},
        {"👩\u200D👩\u200D👦", 5, 3, 1, 1, 1},
        {"🇩🇪", 2, 1, 1, 1, 1},
        {"👍🏽", 2, 1, 1, 1, 1},
        {"❤\uFE0F", 2, 1, 1, 1, 1},
        {"1\uFE0F\u20E3", 3, 1, 1, 1, 1},
        {"🏴\U000E0067\U000E0062\U000E007F", 4, 4, 1, 4, 1},
        {"e\u0301α\u0301", 4, 4, 4, 2, 2},
        {"\u1100\u1161\u11A8", 3, 3, 3, 3, 1},
        {"a\u200D", 2, 2, 2, 2, 1},
        {"\u0628\u064E", 2, 2, 2, 2, 1},
        {"a\r\nb", 3, 3, 3, 3, 3},
    };
    for (const auto& c : cases) {
        const std::u16string text = fromUtf8(c.text);
        EXPECT_EQ(backspacesFor(text, ErasedAtOnce::Character), c.character) << c.text;
        EXPECT_EQ(backspacesFor(text, ErasedAtOnce::EmojiPart), c.emojiPart) << c.text;
        EXPECT_EQ(backspacesFor(text, ErasedAtOnce::Emoji), c.emoji) << c.text;
        EXPECT_EQ(backspacesFor(text, ErasedAtOnce::Letter), c.letter) << c.text;
        EXPECT_EQ(leftArrowsFor(text), c.left) << c.text;
    }
}

}  // namespace
}  // namespace plume

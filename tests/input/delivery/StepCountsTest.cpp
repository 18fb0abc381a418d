#include "input/delivery/StepCounts.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>
#include <unicode/ubrk.h>

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

// However the text is cut to be counted faster.
RC_GTEST_PROP(StepCounts, AreAsManyAsClustersOfTheWhole, ()) {
    const std::u16string units =
        u"aaaaaaaa\u4e2d\u4e2d\ud55c\uac00\r\n\u0301\u0903\u0600\u1100\u1161\u11a8\u200d\ufe0f\u0e33"
        u"\U0001f469\U0001f1e9\U0001f3fd\u0915\u094d\ue000" +
        std::u16string(1, u'\0');
    std::u16string text;
    for (int pieces = *rc::gen::inRange(0, 12); pieces > 0; --pieces) {
        text += *rc::gen::container<std::u16string>(rc::gen::elementOf(units));
        text += std::u16string(*rc::gen::inRange<std::size_t>(0, 70), *rc::gen::elementOf(units));
    }
    UErrorCode status = U_ZERO_ERROR;
    UBreakIterator* whole = ubrk_open(UBRK_CHARACTER, "", text.data(), static_cast<std::int32_t>(text.size()), &status);
    std::uint64_t count = 0;
    while (ubrk_next(whole) != UBRK_DONE) ++count;
    ubrk_close(whole);
    RC_ASSERT(leftArrowsFor(text) == count);
}

}  // namespace
}  // namespace plume

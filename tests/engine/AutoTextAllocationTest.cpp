// A key that completes nothing allocates nothing, from the tap to the engine and back.
#include <gtest/gtest.h>

#include "tests/engine/AllocationCounter.h"
#include "tests/engine/EngineDesk.h"

namespace plume {
namespace {

class Allocation : public ::testing::TestWithParam<bool> {};

TEST_P(Allocation, IsNotNeededForKeysThatCompleteNothing) {
    EngineDesk desk;
    desk.engine.setSuggestsByItself(GetParam());
    const auto group = desk.add({u"zz"}, ExpandTrigger::DelimiterSwallowed);
    for (char16_t c = u'a'; c <= u'z'; ++c) {
        group->addItem(std::make_shared<Snippet>(std::u16string(12, c), u"content"));
    }
    desk.engine.correction().setCapitalizeNewSentences(true);
    desk.engine.correction().setCorrectDoubleCapitals(true);
    const std::u16string typed = u"The quick brown fox, jumps over 13 lazy dogs; aaaaaaaaaaab \baaaaaaaaaaa ";
    const auto type = [&] {
        std::size_t swallowed = 0;
        for (const char16_t& c : typed) {
            const auto stroke = SimulatedInputSources::strokeFor(c);
            const EventFlags flags = stroke->shift ? EventFlag::Shift : EventFlags();
            SimulatedKeyboardTap& tap = desk.desktop.keyboardTap();
            for (const auto change : {TapEvent::Type::KeyDown, TapEvent::Type::KeyUp}) {
                swallowed += tap.swallows({change, stroke->keyCode, flags, {&c, 1}}) ? 1U : 0U;
            }
        }
        return swallowed;
    };
    // The first keys may fill what is filled once.
    type();
    const std::size_t before = allocationCount();
    EXPECT_EQ(type(), 0U);
    EXPECT_EQ(allocationCount(), before);
    EXPECT_EQ(desk.engine.letters().size(), 2 * (typed.size() - 2)) << "every key was followed";
}

INSTANTIATE_TEST_SUITE_P(SuggestingByItselfOrNot, Allocation, ::testing::Bool());

TEST(AllocationForNames, IsNotNeededForAKnownProgram) {
    EngineDesk desk;
    const ProcessSerialNumber editor = desk.desktop.front()->process();
    desk.identifiers.getBundleIdentifier(editor);
    const std::size_t before = allocationCount();
    EXPECT_EQ(desk.identifiers.getBundleIdentifier(editor), u"org.example.editor");
    EXPECT_EQ(allocationCount(), before);
}

}  // namespace
}  // namespace plume

// A key that completes nothing allocates nothing.
#include <gtest/gtest.h>

#include "tests/engine/AllocationCounter.h"
#include "tests/engine/EngineDesk.h"

namespace plume {
namespace {

class NothingBehind final : public AutoCorrector {
    void autoCorrect(EngineState& /*engine*/, ZDKeyEventArgs& /*event*/, std::u16string_view /*context*/) override {}
};

TEST(Allocation, KeysThatCompleteNothingAllocateNothing) {
    EngineDesk desk;
    NothingBehind corrector;
    AutoText engine({desk.service, desk.resolver, desk.sources, desk.defaults, desk.sender, desk.suggestionSource,
                     &corrector, [] { return nullptr; }, [] { return nullptr; }});
    engine.setEnabled(true);
    desk.engine.setEnabled(false);
    const auto group = SnippetGroup::make();
    group->setExpandTrigger(ExpandTrigger::DelimiterSwallowed);
    for (char16_t c = u'a'; c <= u'z'; ++c) {
        group->addItem(std::make_shared<Snippet>(std::u16string(12, c), u"content"));
    }
    engine.setSnippetGroups({group});
    // The first key may fill what is filled once.
    const std::u16string typed = u"The quick brown fox, jumps over 13 lazy dogs. aaaaaaaaaaab \baaaaaaaaaaa ";
    desk.service.typeText(typed);

    const std::size_t before = allocationCount();
    for (const char16_t c : typed) desk.service.pressKey(SimulatedInputSources::strokeFor(c)->keyCode);
    EXPECT_EQ(allocationCount(), before);
}

TEST(Allocation, AKnownProgramIsNamedWithoutAllocating) {
    EngineDesk desk;
    desk.resolver.getBundleIdentifier(desk.editor);
    const std::size_t before = allocationCount();
    EXPECT_EQ(desk.resolver.getBundleIdentifier(desk.editor), u"org.example.editor");
    EXPECT_EQ(allocationCount(), before);
}

}  // namespace
}  // namespace plume

#include "input/delivery/ContextInputSetting.h"

#include <gtest/gtest.h>

namespace plume {
namespace {

using enum InputFlag;

// By the whole identifier, its beginning, its end, a part of it, or not at all.
TEST(ContextInputSettings, KnowsApplicationsAndTheirFamilies) {
    const InputFlags virtualMachine = DisableCapitalization | UseClipboard | AlternativePasting;
    const struct {
        const char16_t* application;
        InputFlags flags;  // none: not known
        double pastingDelay = 0;
        double afterPastingDelay = 0;
    } cases[] = {
        {u"org.example.editor", {}},
        {u"com.google.Chrome", IncludeHTMLData | UseClipboardIfHasNewLine, 0, 0.05},
        {u"org.virtualbox.app.VirtualBoxVM", virtualMachine | UseControlKey | DelayPasting | DoNotRestoreClipboard,
         0.2},
        {u"com.vmware.proxyApp.1234", virtualMachine | UseVMHelper | UseControlKey | ClickAtVMHelper},
        {u"com.parallels.winapp.x", virtualMachine | Reactivate | DoNotRestoreClipboard},
        {u"com.jetbrains.intellij", UseClipboardIfHasNewLine},
        {u"com.jetbrains", {}},
        {u"com.adobe.Photoshop", UseClipboard},
        {u"com.codeweavers.CrossOverHelper.x", UseClipboard},
        {u"some.game.wineskin.prefs", UseClipboard | UseControlKey | DoNotRestoreClipboard},
    };
    ContextInputSettings settings;
    for (const auto& expected : cases) {
        bool isKnown = false;
        const auto setting = settings.resolve(expected.application, isKnown);
        EXPECT_EQ(isKnown, !expected.flags.isEmpty());
        EXPECT_EQ(setting->flags.bits(), expected.flags.bits());
        EXPECT_EQ(setting->pastingDelay, expected.pastingDelay);
        EXPECT_EQ(setting->afterPastingDelay, expected.afterPastingDelay);
        EXPECT_EQ(setting->bundleIdentifier, expected.application);
    }
}

TEST(ContextInputSettings, EntriesAreCopiedAndFamiliesAreShared) {
    ContextInputSettings settings;
    bool isKnown = false;
    settings.resolve(u"com.microsoft.Word", isKnown)->flags |= UseClipboard;
    EXPECT_FALSE(settings.resolve(u"com.microsoft.Word", isKnown)->has(UseClipboard));
    settings.resolve(u"com.jetbrains.clion", isKnown)->flags |= UseClipboard;
    EXPECT_TRUE(settings.resolve(u"com.jetbrains.pycharm", isKnown)->has(UseClipboard));
    EXPECT_EQ(settings.resolve(std::nullopt, isKnown)->flags, InputFlags());
    EXPECT_FALSE(isKnown);
}

}  // namespace
}  // namespace plume

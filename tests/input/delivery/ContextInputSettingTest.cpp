#include "input/delivery/ContextInputSetting.h"

#include <gtest/gtest.h>

namespace plume {
namespace {

using enum InputFlag;

struct SettingCase {
    const char16_t* application;
    bool isKnown;
    InputFlags flags;
    double pastingDelay = 0;
    double afterPastingDelay = 0;
    std::uint64_t blockLength = 0;
};

TEST(ContextInputSettings, KnowsApplicationsAndTheirFamilies) {
    const SettingCase cases[] = {
        {u"org.example.editor", false, {}},
        {u"com.sublimetext.3", true, UseClipboardIfHasNewLine},
        {u"com.google.Chrome", true, IncludeHTMLData | UseClipboardIfHasNewLine, 0, 0.05},
        {u"org.virtualbox.app.VirtualBoxVM", true,
         DisableCapitalization | UseClipboard | AlternativePasting | UseControlKey | DelayPasting |
             DoNotRestoreClipboard,
         0.2},
        {u"com.teamviewer.TeamViewer", true, AlternativePasting | DelayPasting | UseControlKey | DoNotRestoreClipboard},
        {u"de.ragtime.ragtime", true, {}, 0, 0, 5},
        {u"com.vmware.fusion", true,
         DisableCapitalization | UseClipboard | UseVMHelper | DeleteAfterActivateVM | UseControlKey |
             AlternativePasting | ClickAtVM},
        {u"com.vmware.proxyApp.1234", true,
         DisableCapitalization | UseClipboard | UseVMHelper | UseControlKey | AlternativePasting | ClickAtVMHelper},
        {u"com.codeweavers.CrossOverHelper.x", true, UseClipboard},
        {u"some.game.wineskin.prefs", true, UseClipboard | UseControlKey | DoNotRestoreClipboard},
        {u"com.adobe.Photoshop", true, UseClipboard},
        {u"com.parallels.winapp.x", true,
         DisableCapitalization | UseClipboard | Reactivate | AlternativePasting | DoNotRestoreClipboard},
        {u"com.jetbrains.intellij", true, UseClipboardIfHasNewLine},
        {u"com.jetbrains", false, {}},
    };
    ContextInputSettings settings;
    for (const SettingCase& expected : cases) {
        bool isKnown = !expected.isKnown;
        const auto setting = settings.resolve(expected.application, isKnown);
        const std::string name(expected.application,
                               expected.application + std::u16string(expected.application).size());
        EXPECT_EQ(isKnown, expected.isKnown) << name;
        EXPECT_EQ(setting->flags.bits(), expected.flags.bits()) << name;
        EXPECT_EQ(setting->pastingDelay, expected.pastingDelay) << name;
        EXPECT_EQ(setting->afterPastingDelay, expected.afterPastingDelay) << name;
        EXPECT_EQ(setting->blockLength, expected.blockLength) << name;
        EXPECT_EQ(setting->bundleIdentifier, expected.application) << name;
    }
}

TEST(ContextInputSettings, EntriesAreCopiedAndFamiliesAreShared) {
    ContextInputSettings settings;
    bool isKnown = false;
    settings.resolve(u"com.microsoft.Word", isKnown)->flags |= UseClipboard;
    EXPECT_FALSE(settings.resolve(u"com.microsoft.Word", isKnown)->has(UseClipboard));
    settings.resolve(u"com.jetbrains.clion", isKnown)->flags |= UseClipboard;
    EXPECT_TRUE(settings.resolve(u"com.jetbrains.pycharm", isKnown)->has(UseClipboard));
}

TEST(ContextInputSettings, APortAddsItsOwnApplications) {
    ContextInputSettings settings;
    auto terminal = std::make_shared<ContextInputSetting>();
    terminal->flags = UseControlKey;
    settings.set(u"xterm", terminal);
    bool isKnown = false;
    EXPECT_TRUE(settings.resolve(u"xterm", isKnown)->has(UseControlKey));
    EXPECT_TRUE(isKnown);
    EXPECT_EQ(settings.resolve(std::nullopt, isKnown)->flags, InputFlags());
    EXPECT_FALSE(isKnown);
}

}  // namespace
}  // namespace plume

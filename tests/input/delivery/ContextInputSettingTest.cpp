#include "input/delivery/ContextInputSetting.h"

#include <gtest/gtest.h>

namespace plume {
namespace {

using enum InputFlag;

struct SettingCase {
    const char16_t* application;
    bool isKnown;
    InputFlags flags;
};

// By the whole identifier, its beginning, its end, a part of it, or not at all.
TEST(ContextInputSettings, KnowsApplicationsAndTheirFamilies) {
    const SettingCase cases[] = {
        {u"org.example.editor", false, {}},
        {u"com.google.Chrome", true, IncludeHTMLData | UseClipboardIfHasNewLine},
        {u"com.jetbrains.intellij", true, UseClipboardIfHasNewLine},
        {u"com.jetbrains", false, {}},
        {u"com.codeweavers.CrossOverHelper.x", true, UseClipboard},
        {u"some.game.wineskin.prefs", true, UseClipboard | UseControlKey | DoNotRestoreClipboard},
    };
    ContextInputSettings settings;
    for (const SettingCase& expected : cases) {
        bool isKnown = !expected.isKnown;
        const auto setting = settings.resolve(expected.application, isKnown);
        EXPECT_EQ(isKnown, expected.isKnown);
        EXPECT_EQ(setting->flags.bits(), expected.flags.bits());
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

#include "input/delivery/ContextInputSetting.h"

#include <gtest/gtest.h>

#include "input/delivery/ApplicationTable.h"

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

constexpr const char* Table = R"json({
  "default": {"pasteKeys": ["Control+V"], "copyKeys": ["Control+C"], "typesBeyondBmp": false, "longestTyped": 9},
  "families": {"old": {"pasteKeys": ["Shift+Insert"], "copyKeys": "none", "pastesPrimary": true},
               "new": {"family": "old", "about": "one more", "typesBeyondBmp": true}},
  "applications": {"Term": {"family": "new"}, "te*": {"afterErasingDelay": 0.5}, "term-*": {"blockLength": 3}}
})json";

TEST(ContextInputSettings, APlatformHasRowsOfItsOwnAndTheUsersComeFirst) {
    ContextInputSettings settings;
    settings.setTable(
        std::make_shared<const ApplicationTable>(ApplicationTable::read(Table, "applications.json").value()));
    bool isKnown = false;
    const auto rowOf = [&](const char16_t* application) { return settings.resolve(application, isKnown); };
    const auto other = rowOf(u"com.google.Chrome");
    EXPECT_FALSE(isKnown);
    EXPECT_EQ(other->flags, InputFlags()) << "the built-in table does not count here";
    const Keystrokes controlV = {{u'v', KeyCode::None, EventFlag::Control}};
    EXPECT_EQ(other->pasteKeys, controlV);
    EXPECT_EQ(other->longestTyped, 9U);
    const auto terminal = rowOf(u"tERM");
    EXPECT_TRUE(isKnown && terminal->typesBeyondBmp && terminal->pastesPrimary);
    EXPECT_EQ(terminal->pasteKeys, (Keystrokes{{0, KeyCode::Help, EventFlag::Shift}}));
    EXPECT_EQ(terminal->copyKeys, Keystrokes());
    EXPECT_EQ(rowOf(u"tea")->afterErasingDelay, 0.5);
    EXPECT_EQ(rowOf(u"term-1")->blockLength, 3U) << "the longest beginning";

    const auto own = R"({"TEA": {"family": "new", "pasteKeys": ["Control+Alt+Super++", "a", "A"]}})";
    ASSERT_TRUE(settings.setOwnRows(own, "own").ok());
    EXPECT_TRUE(rowOf(u"tea")->pastesPrimary);
    const EventFlags three = EventFlag::Control | EventFlag::Option | EventFlag::Command;
    EXPECT_EQ(rowOf(u"tea")->pasteKeys, (Keystrokes{{u'+', KeyCode::None, three}, {u'a'}, {u'A'}}));
    EXPECT_EQ(settings.setOwnRows(R"({"a": {"family": "x"}})", "own").error().message,
              "own: at $.a.family: expected one of new old");
    EXPECT_FALSE(rowOf(u"tea")->pastesPrimary) << "what cannot be read replaces what was there";
}

}  // namespace
}  // namespace plume

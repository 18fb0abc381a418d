#include "input/delivery/ContextInputResolver.h"

#include <gtest/gtest.h>

#include "ports/simulated/SimulatedAccessibility.h"
#include "ports/simulated/SimulatedProcessManager.h"
#include "tests/input/delivery/RecordingPoster.h"

namespace plume {
namespace {

using enum InputFlag;
using Element = std::shared_ptr<UIElement>;

class ContextInputResolverTest : public ::testing::Test {
  protected:
    void activate(const char16_t* identifier) { processes.setFrontProcess(processes.launch(identifier)); }
    bool pastes(const SnippetExpandedContent::Content& content) {
        const SnippetExpandedContent expanded(content);
        resolver.prepareSending(&expanded);
        return resolver.setting()->has(UseClipboard);
    }
    // An element with the focus, inside of others from the innermost to the outermost.
    std::shared_ptr<SimulatedUIElement> focus(const std::vector<std::shared_ptr<SimulatedUIElement>>& chain) {
        for (std::size_t i = 0; i + 1 < chain.size(); ++i) chain[i]->setAttribute("AXParent", Element(chain[i + 1]));
        const auto application = std::make_shared<SimulatedUIElement>();
        application->setAttribute("AXFocusedUIElement", Element(chain.front()));
        accessibility.setFrontApplicationElement(application);
        return chain.front();
    }
    static std::shared_ptr<SimulatedUIElement> element(const char* attribute, std::u16string value) {
        auto made = std::make_shared<SimulatedUIElement>();
        made->setAttribute(attribute, std::move(value));
        return made;
    }

    SimulatedProcessManager processes;
    BundleIdentifierResolver identifiers{processes};
    SimulatedAccessibility accessibility;
    RecordingPoster poster;
    ContextInputResolver resolver{processes, identifiers, accessibility, poster};
};

TEST_F(ContextInputResolverTest, ChoosesBetweenTypingAndPasting) {
    struct Case {
        const char* about;
        const char16_t* application;
        std::u16string content;
        bool pastes;
    };
    const Case cases[] = {
        {"no line feed where lines are pasted", u"com.microsoft.Word", u"a\rb", false},
        {"lines elsewhere", u"editor", u"a\nb", false},
        {"long text that the user has typed", u"editor", std::u16string(1000, u'x'), false},
        {"a key is held, but the text is short", u"editor", std::u16string(20, u'x'), false},
        {"no key produces it", u"editor", u"a\u4E00", true},
    };
    poster.untypeable = u'\u4E00';
    for (const Case& c : cases) {
        activate(c.application);
        poster.held.clear();
        if (c.content.size() == 20) poster.held = {KeyCode::A};
        EXPECT_EQ(pastes(c.content), c.pastes) << c.about;
        EXPECT_EQ(resolver.contextBundleIdentifier(), c.application) << c.about;
    }
}

TEST_F(ContextInputResolverTest, TheNewLineRuleStaysInAFamilyAndWhatNoKeyProducesDoesNot) {
    activate(u"com.jetbrains.clion");
    poster.untypeable = u'\u4E00';
    EXPECT_TRUE(pastes(u"\u4E00"));
    EXPECT_FALSE(pastes(u"text"));
    EXPECT_TRUE(pastes(u"a\nb"));
    EXPECT_TRUE(pastes(u"text"));
}

TEST_F(ContextInputResolverTest, PastesWhatAnApplicationDoesNotTakeTypedUnlessNoKeyPastes) {
    auto setting = std::make_shared<ContextInputSetting>();
    setting->longestTyped = 3;
    setting->typesBeyondBmp = false;
    poster.untypeable = u'\u4E00';
    for (const bool canPaste : {true, false}) {
        if (!canPaste) setting->pasteKeys = Keystrokes();
        resolver.applicationSettings.set(u"editor", std::make_shared<ContextInputSetting>(*setting));
        activate(u"editor");
        EXPECT_FALSE(pastes(u"abc"));
        for (const char16_t* text : {u"abcd", u"\U0001F600", u"\u4E00"}) EXPECT_EQ(pastes(text), canPaste);
        EXPECT_EQ(resolver.setting()->blockLength, canPaste ? 0U : 2U) << "in portions that wait for free key codes";
        EXPECT_EQ(pastes(AttributedString(u"rich")), canPaste);
    }
}

TEST_F(ContextInputResolverTest, ErasingAloneFollowsThePreference) {
    activate(u"editor");
    resolver.preferences.useClipboardForLongText = true;
    resolver.preferences.longTextLength = 0;
    resolver.prepareSending(nullptr);
    EXPECT_FALSE(resolver.setting()->has(UseClipboard));
    resolver.preferences.useClipboard = true;
    resolver.prepareSending(nullptr);
    EXPECT_TRUE(resolver.setting()->has(UseClipboard));
}

TEST_F(ContextInputResolverTest, PastesIntoTheSearchFieldOfAHelpMenu) {
    activate(u"editor");
    focus({element("AXSubrole", u"AXSearchField"), element("AXRole", u"AXGroup")});
    EXPECT_FALSE(pastes(u"text"));
    focus({element("AXSubrole", u"AXSearchField"), element("AXRole", u"AXMenuItem")});
    EXPECT_TRUE(pastes(u"text"));
    // The user's own list replaces what was found out.
    resolver.preferences.useClipboard = true;
    resolver.preferences.useClipboardIn = 1;
    resolver.preferences.useClipboardApplications = {u"editor"};
    EXPECT_FALSE(pastes(u"text"));
}

TEST_F(ContextInputResolverTest, PastesIntoTheDocumentEditorInTheBrowser) {
    activate(u"com.apple.Safari");
    const auto page = element("AXRole", u"AXWebArea");
    focus({element("AXRole", u"AXTextArea"), page, element("AXRole", u"AXWindow")});
    page->setAttribute("AXURL", std::u16string(u"https://example.org/"));
    EXPECT_FALSE(pastes(u"text"));
    page->setAttribute("AXURL", std::u16string(u"https://docs.google.com/document/d/1"));
    EXPECT_TRUE(pastes(u"text"));
    EXPECT_EQ(resolver.setting()->afterPastingDelay, 0.05);
    activate(u"editor");
    EXPECT_FALSE(pastes(u"text"));
}

TEST_F(ContextInputResolverTest, AnElementThatIsItsOwnAncestorEndsTheSearch) {
    activate(u"com.apple.Safari");
    const auto odd = element("AXRole", u"AXGroup");
    focus({odd})->setAttribute("AXParent", Element(odd));
    EXPECT_FALSE(pastes(u"text"));
    odd->removeAttribute("AXParent");
}

TEST_F(ContextInputResolverTest, SheetsTakeEventsAtTheEarlierPlaceOnly) {
    const auto field = std::make_shared<SimulatedUIElement>();
    field->setAttribute("AXTopLevelUIElement", Element(element("AXRole", u"AXSheet")));
    focus({field});
    activate(u"com.apple.TextEdit");
    resolver.refresh();
    EXPECT_EQ(resolver.setting()->flags, InputFlags());
    resolver.listenAtAnnotatedSession = true;
    resolver.refresh();
    EXPECT_EQ(resolver.setting()->flags, PostToSessionEventTap | UseClipboard);
    activate(u"editor");
    resolver.refresh();
    EXPECT_EQ(resolver.setting()->flags, InputFlags());
}

}  // namespace
}  // namespace plume

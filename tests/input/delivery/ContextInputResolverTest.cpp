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

struct ChoiceCase {
    const char* about;
    const char16_t* application;
    SnippetExpandedContent::Content content;
    bool pastes;
    DeliveryPreferences preferences = {};
    bool holdsKeyA = false;
};

DeliveryPreferences clipboard(std::int64_t in, std::vector<std::u16string> listed) {
    DeliveryPreferences preferences;
    preferences.useClipboard = true;
    preferences.useClipboardIn = in;
    preferences.useClipboardApplications = std::move(listed);
    return preferences;
}

DeliveryPreferences longText(std::int8_t length) {
    DeliveryPreferences preferences;
    preferences.useClipboardForLongText = true;
    preferences.longTextLength = length;
    return preferences;
}

std::u16string x(std::size_t length) {
    return std::u16string(length, u'x');
}

TEST_F(ContextInputResolverTest, ChoosesBetweenTypingAndPasting) {
    const ChoiceCase cases[] = {
        {"plain text", u"editor", u"text", false},
        {"rich text", u"editor", AttributedString(u"text"), true},
        {"an application of the table", u"net.ichi2.anki", u"text", true},
        {"the user pastes everywhere", u"editor", u"text", true, clipboard(0, {})},
        {"except here", u"editor", u"text", false, clipboard(1, {u"editor"})},
        {"except elsewhere", u"editor", u"text", true, clipboard(1, {u"other"})},
        {"only here", u"editor", u"text", true, clipboard(2, {u"editor"})},
        {"only elsewhere", u"editor", u"text", false, clipboard(2, {u"other"})},
        {"lines where they are pasted", u"com.microsoft.Word", u"a\nb", true},
        {"other texts there", u"com.microsoft.Word", u"a\rb", false},
        {"lines elsewhere", u"editor", u"a\nb", false},
        {"100 units are not long", u"editor", x(100), false, longText(100)},
        {"101 are", u"editor", x(101), true, longText(100)},
        {"nothing is long below 0", u"editor", x(1000), false, longText(-56)},
        {"the user types all long text", u"editor", x(1000), false},
        {"the key is held", u"editor", x(21), true, {}, true},
        {"for a shorter text", u"editor", x(20), false, {}, true},
        {"no key produces it", u"editor", u"a\u4E00", true},
    };
    poster.untypeable = u'\u4E00';
    for (const ChoiceCase& c : cases) {
        activate(c.application);
        resolver.preferences = c.preferences;
        poster.held = c.holdsKeyA ? std::set<KeyCode>{KeyCode::A} : std::set<KeyCode>{};
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

TEST_F(ContextInputResolverTest, ErasingAloneFollowsThePreference) {
    activate(u"editor");
    resolver.preferences = longText(0);
    resolver.prepareSending(nullptr);
    EXPECT_FALSE(resolver.setting()->has(UseClipboard));
    resolver.preferences = clipboard(0, {});
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
    resolver.preferences = clipboard(1, {u"editor"});
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

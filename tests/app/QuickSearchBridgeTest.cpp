// The quick-search window between the thread of the keys and its own: who has the keyboard when, and what is sent into
// which window.
#include "app/QuickSearchBridge.h"

#include <gmock/gmock.h>

#include "tests/app/BridgeTest.h"

namespace plume {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

class NotedSearchWindow final : public QuickSearchView {
  public:
    void setEvents(Events events) override { told = std::move(events); }
    void show(const QuickSearchOpening& how) override {
        isVisible = true;
        opened.push_back(how);
        told.placed(Frame);
        told.shown(window);
    }
    void close() override { isVisible = false; }

    static constexpr Rectangle Frame{{1, 2}, {620, 430}};
    std::uint32_t window = 0;
    Events told;
    bool isVisible = false;
    std::vector<QuickSearchOpening> opened;
};

ZDKeyEventArgs pressed(KeyCode code, char16_t character = 0) {
    ZDKeyEventArgs key;
    key.key = code;
    key.c = character;
    return key;
}

class QuickSearchBridgeTest : public BridgeTest {
  protected:
    QuickSearchBridgeTest() {
        view.window = ownWindow();
        bridge.setSnippetSelectedAction([this] {
            EXPECT_TRUE(keysAreHeld()) << "what is typed now would be before the snippet";
            sent.push_back(bridge.selectedSnippet());
            front.push_back(*desk.processes.frontProcess());
        });
        settle();
    }
    void press(ZDKeyEventArgs key) { bridge.keyPressed(key); }
    void pressShortcut(const ZDKeyEventArgs& key) {
        ZDUnregisteredHotKeyPressedEventArgs shortcut;
        static_cast<ZDKeyEventArgs&>(shortcut) = key;
        bridge.shortcutPressed(shortcut);
    }
    void open() {
        bridge.showWindowAtCaret();
        pass(0.01);
        ASSERT_TRUE(view.isVisible);
        ASSERT_EQ(desk.processes.frontProcess(), desk.processes.currentProcess());
    }
    // As the window does it.
    void choose(const std::shared_ptr<Snippet>& chosen) {
        view.isVisible = false;
        bridge.choose(chosen);
    }

    NotedSearchWindow view;
    std::u16string typed;
    std::vector<std::string> reports;
    std::vector<std::shared_ptr<Snippet>> sent;
    std::vector<ProcessSerialNumber> front;  // when something was sent
    const std::shared_ptr<Snippet> snippet = std::make_shared<Snippet>(u"sig", u"Regards");
    QuickSearchBridge bridge{{.view = [this]() -> QuickSearchView& { return view; },
                              .tapLoop = desk.loop,
                              .mainLoop = main,
                              .accessibility = desk.accessibility,
                              .processManager = desk.processes,
                              .holdUserKeys = [this](double seconds) { return desk.service.holdUserKeys(seconds); },
                              .typedQuery = [this] { return typed; },
                              .report = [this](const std::string& sentence) { reports.push_back(sentence); }}};
};

TEST_F(QuickSearchBridgeTest, KeepsKeysBackUntilTheWindowHasTheKeyboard) {
    desk.processes.setFollowsActivation(false);
    bridge.showWindowAtCaret();
    EXPECT_TRUE(bridge.windowVisible());
    EXPECT_TRUE(keysAreHeld()) << "from the hot key on";
    pass(0.2);
    EXPECT_TRUE(keysAreHeld());
    desk.processes.setFollowsActivation(true);
    pass(0.2);
    EXPECT_EQ(desk.processes.frontProcess(), desk.processes.currentProcess()) << "it was asked for again";
    EXPECT_FALSE(keysAreHeld());
    EXPECT_EQ(bridge.windowFrame(), NotedSearchWindow::Frame);
}

// A key whose release is kept back for longer begins to repeat.
TEST_F(QuickSearchBridgeTest, KeepsKeysBackForAMomentAtMost) {
    desk.processes.setFollowsActivation(false);
    bridge.showWindowAtCaret();
    pass(0.29);
    EXPECT_TRUE(keysAreHeld());
    pass(0.02);
    EXPECT_FALSE(keysAreHeld());
}

TEST_F(QuickSearchBridgeTest, SendsIntoTheWindowThatHadTheKeyboard) {
    typed = u"si";
    open();
    EXPECT_EQ(view.opened.back().query, u"si");
    EXPECT_TRUE(view.opened.back().place);
    choose(snippet);
    EXPECT_TRUE(keysAreHeld());
    EXPECT_FALSE(bridge.windowVisible());
    EXPECT_EQ(bridge.windowFrame(), Rectangle());
    pass(0.01);
    EXPECT_THAT(sent, ElementsAre(snippet));
    EXPECT_THAT(front, ElementsAre(editor));
    EXPECT_EQ(bridge.typedText(), u"si") << "which gives way to the snippet";
    EXPECT_EQ(bridge.selectedSnippet(), nullptr) << "it is sent once";
    EXPECT_FALSE(keysAreHeld());
    EXPECT_THAT(reports, IsEmpty());

    typed = u"";
    open();
    EXPECT_EQ(view.opened.back().query, u"");
    EXPECT_EQ(bridge.typedText(), std::nullopt);
}

TEST_F(QuickSearchBridgeTest, SendsNothingIntoAnotherWindow) {
    const auto other = desk.processes.launch(u"other");
    const struct {
        const char* what;
        std::function<void()> happens;
    } cases[] = {
        {"refused", [&] { desk.processes.setFollowsActivation(false); }},
        {"another in front",
         [&] {
             desk.processes.setFollowsActivation(false);
             desk.processes.setFrontProcess(other);
         }},
        {"another window of the same program",
         [&] {
             desk.processes.setFrontProcess(editor);
             desk.processes.setDialogIsInFront(true);
         }},
        {"gone", [&] { desk.processes.terminate(editor); }},
    };
    for (const auto& each : cases) {
        SCOPED_TRACE(each.what);
        desk.processes.setFollowsActivation(true);
        desk.processes.setDialogIsInFront(false);
        desk.processes.setFrontProcess(editor);
        open();
        each.happens();
        choose(snippet);
        pass(0.9);
        EXPECT_THAT(reports, IsEmpty()) << "it may still come";
        pass(0.2);
        EXPECT_THAT(std::exchange(reports, {}), ElementsAre(HasSubstr("was not sent: the window")));
        EXPECT_FALSE(keysAreHeld());
    }
    EXPECT_THAT(sent, IsEmpty());
}

TEST_F(QuickSearchBridgeTest, SendsNothingWhereNobodyHadTheKeyboard) {
    desk.processes.setFrontProcess(std::nullopt);
    open();
    choose(snippet);
    pass(0.01);
    EXPECT_THAT(reports, ElementsAre(HasSubstr("not sent")));
    EXPECT_THAT(sent, IsEmpty());
    EXPECT_FALSE(keysAreHeld());
}

TEST_F(QuickSearchBridgeTest, SaysSoWhenTheChosenSnippetIsGone) {
    open();
    choose(nullptr);
    pass(0.01);
    EXPECT_THAT(reports, ElementsAre(HasSubstr("no longer in your library")));
    EXPECT_EQ(desk.processes.frontProcess(), editor);
    EXPECT_THAT(sent, IsEmpty());
    EXPECT_FALSE(keysAreHeld());
}

TEST_F(QuickSearchBridgeTest, LeavesTheKeyboardToAnotherWindowOfItsOwn) {
    open();
    view.told.replaced();
    pass(0.01);
    EXPECT_FALSE(bridge.windowVisible());
    EXPECT_FALSE(keysAreHeld());
    EXPECT_EQ(desk.processes.frontProcess(), desk.processes.currentProcess());
}

TEST_F(QuickSearchBridgeTest, GivesTheKeyboardBackWhenItsUserClosesIt) {
    open();
    view.told.closed();
    desk.loop.runReady();
    EXPECT_FALSE(bridge.windowVisible());
    EXPECT_TRUE(keysAreHeld());
    pass(0.01);
    EXPECT_EQ(desk.processes.frontProcess(), editor);
    EXPECT_FALSE(keysAreHeld());
    // What is told twice, or late, changes nothing.
    view.told.closed();
    view.told.placed({{5, 5}, {5, 5}});
    view.told.shown(view.window);
    pass(0.01);
    EXPECT_EQ(desk.processes.frontProcess(), editor);
    EXPECT_EQ(bridge.windowFrame(), Rectangle());
    bridge.choose(snippet);
    pass(2);
    EXPECT_THAT(sent, IsEmpty());
}

// By a click in another window, say, which has the keyboard then.
TEST_F(QuickSearchBridgeTest, LeavesTheKeyboardWhereItIsWhenItIsClosedFromOutside) {
    open();
    const auto other = desk.activate(u"other");
    bridge.close();
    pass(0.1);
    EXPECT_FALSE(view.isVisible);
    EXPECT_EQ(desk.processes.frontProcess(), other);
    EXPECT_FALSE(keysAreHeld());

    bridge.showWindowAtCaret();
    EXPECT_TRUE(keysAreHeld());
    const auto openings = view.opened.size();
    bridge.close();
    pass(0.1);
    EXPECT_EQ(view.opened.size(), openings) << "closed before it was open";
    EXPECT_FALSE(keysAreHeld());
}

TEST_F(QuickSearchBridgeTest, PicksByDigitWhileAnotherWindowHasTheKeyboard) {
    open();
    bridge.setFirstRows({snippet, nullptr});
    EXPECT_EQ(bridge.snippetAtIndex(0), nullptr) << "the digit is typed into the field";
    desk.processes.setFrontProcess(editor);
    EXPECT_EQ(bridge.snippetAtIndex(0), snippet);
    EXPECT_EQ(bridge.snippetAtIndex(1), nullptr);
    EXPECT_EQ(bridge.snippetAtIndex(2), nullptr);
    bridge.showWindowAtTopRightCorner();
    EXPECT_EQ(bridge.snippetAtIndex(0), nullptr) << "rows of the search before";
}

TEST_F(QuickSearchBridgeTest, MovedToTheCornerItStillKnowsItsTarget) {
    open();
    bridge.showWindowAtTopRightCorner();
    pass(0.01);
    EXPECT_FALSE(view.opened.back().place);
    choose(snippet);
    pass(0.01);
    EXPECT_THAT(front, ElementsAre(editor));
}

// A menu opens it while what was chosen before is on its way.
TEST_F(QuickSearchBridgeTest, OpenedAgainItLosesNothing) {
    open();
    desk.processes.setFollowsActivation(false);
    choose(snippet);
    pass(0.1);
    bridge.showWindowAtTopRightCorner();
    pass(0.1);
    desk.processes.setFollowsActivation(true);
    pass(0.5);
    EXPECT_THAT(sent, ElementsAre(snippet));
    EXPECT_THAT(front, ElementsAre(editor));

    open();
    desk.processes.setFollowsActivation(false);
    view.told.closed();
    pass(0.1);
    bridge.showWindowAtTopRightCorner();
    desk.processes.setFollowsActivation(true);
    pass(0.5);
    sent.clear();
    choose(snippet);
    pass(0.1);
    EXPECT_THAT(sent, ElementsAre(snippet));
    EXPECT_EQ(front.back(), editor) << "not into its own window";
}

TEST_F(QuickSearchBridgeTest, HoldsWhatFollowsAKeyThatMayEndTheSearch) {
    const struct {
        const char* what;
        ZDKeyEventArgs key;
        bool isShortcut;
        bool isHeld;
    } cases[] = {
        {"a letter", pressed(KeyCode::A, u'a'), false, false},
        {"Return", pressed(KeyCode::Return, u'\r'), false, true},
        {"Enter", pressed(KeyCode::KeypadEnter), false, true},
        {"Escape", pressed(KeyCode::Escape), false, true},
        {"a digit", pressed(KeyCode::Digit1, u'1'), false, true},
        {"a digit with Shift", pressed(KeyCode::Digit1, u'!'), false, true},
        {"a digit with Control", pressed(KeyCode::Digit0), true, true},
        {"Control+W", pressed(KeyCode::W, u'w'), true, true},
        {"Control+E", pressed(KeyCode::E, u'e'), true, true},
        {"w", pressed(KeyCode::W, u'w'), false, false},
        {"Control+A", pressed(KeyCode::A, u'a'), true, false},
    };
    open();
    for (const auto& each : cases) {
        SCOPED_TRACE(each.what);
        each.isShortcut ? pressShortcut(each.key) : press(each.key);
        EXPECT_FALSE(keysAreHeld()) << "the key itself goes to the window";
        pass(0);
        EXPECT_EQ(keysAreHeld(), each.isHeld);
        view.told.stayed();
        settle();
        EXPECT_FALSE(keysAreHeld());
    }
    press(pressed(KeyCode::Return));
    pass(1.1);
    EXPECT_FALSE(keysAreHeld()) << "a window that does not answer holds nobody up";
    desk.processes.setFrontProcess(editor);
    press(pressed(KeyCode::Return));
    pass(0);
    EXPECT_FALSE(keysAreHeld()) << "the key is another window's";
}

TEST_F(QuickSearchBridgeTest, HoldsAKeyThatComesBeforeTheLoopHasHadTime) {
    open();
    press(pressed(KeyCode::Return));
    EXPECT_FALSE(keysAreHeld());
    press(pressed(KeyCode::A, u'a'));
    EXPECT_TRUE(keysAreHeld());
    view.told.stayed();
    settle();
    EXPECT_FALSE(keysAreHeld());
}

// Both threads hear of a key at the same moment.
TEST_F(QuickSearchBridgeTest, AnAnswerThatComesBeforeTheHoldEndsIt) {
    open();
    press(pressed(KeyCode::Escape));
    view.told.stayed();
    settle();
    EXPECT_FALSE(keysAreHeld());
}

}  // namespace
}  // namespace plume

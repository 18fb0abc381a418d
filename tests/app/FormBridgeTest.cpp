// A form between the thread of the keys and its own: who has the keyboard when, and what is sent into which window and
// field.
#include "app/FormBridge.h"

#include <gmock/gmock.h>

#include "tests/app/BridgeTest.h"

namespace plume {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

class NotedForms final : public FormView {
  public:
    void prepare(Id form, std::shared_ptr<SnippetExpandedContent> content, Events events) override {
        isOpen = true;
        id = form;
        prepared = std::move(content);
        told = std::move(events);
    }
    void show(Id form, const CaretPlace& where) override {
        EXPECT_EQ(form, id);
        places.push_back(where);
        if (comesAtOnce) told.shown(window);
    }
    void close(Id form) override {
        EXPECT_EQ(form, id);
        isOpen = false;
    }
    void keepUnsent(Id form, const std::string& reason) override {
        EXPECT_EQ(form, id);
        kept.push_back(reason);
    }

    std::uint32_t window = 0;
    bool comesAtOnce = true;
    bool isOpen = false;
    Id id = 0;
    Events told;
    std::shared_ptr<SnippetExpandedContent> prepared;
    std::vector<CaretPlace> places;
    std::vector<std::string> kept;
};

// What the engine does when a form ends.
class NotedTarget final : public FieldsEditor::Target {
  public:
    void fieldsEditorWillClose(FieldsEditor& editor) override {
        events.emplace_back("close");
        onClose(editor);
    }
    void fieldsEditorAction(FieldsEditor& editor) override {
        events.emplace_back("send");
        onSend(editor);
    }

    std::vector<std::string> events;
    std::function<void(FieldsEditor&)> onClose = [](FieldsEditor&) {};
    std::function<void(FieldsEditor&)> onSend = [](FieldsEditor&) {};
};

class FormBridgeTest : public BridgeTest {
  protected:
    FormBridgeTest() {
        view.window = ownWindow();
        desk.accessibility.setFrontApplicationSource([this] { return isTold ? application : nullptr; });
        focus(body);
        target.onSend = [this](FieldsEditor& form) {
            EXPECT_TRUE(keysAreHeld()) << "what is typed now would be before the text";
            EXPECT_EQ(desk.processes.frontProcess(), editor);
            EXPECT_EQ(form.content(), content);
        };
    }
    ~FormBridgeTest() override {
        bridge = nullptr;
        settle();
        EXPECT_FALSE(view.isOpen);
    }

    void focus(const std::shared_ptr<SimulatedUIElement>& field) {
        application->setAttribute("AXFocusedUIElement", std::shared_ptr<UIElement>(field));
    }
    void make() {
        bridge = std::make_unique<FormBridge>(
            7, content, target,
            FormBridge::Dependencies{[this]() -> FormView& { return view; }, desk.loop, main, desk.accessibility,
                                     desk.processes, desk.service});
        settle();
    }
    void open() {
        make();
        bridge->show();
        pass(0.01);
        ASSERT_EQ(desk.processes.frontProcess(), desk.processes.currentProcess());
    }
    // As the window does it, which is gone then.
    void accept() {
        view.told.accepted();
        pass(0.01);
    }
    void press(KeyCode code) {
        desk.keyDown(code, code == KeyCode::A ? u"a" : u"");
        pass(0.001);
    }

    const std::shared_ptr<SimulatedUIElement> application = std::make_shared<SimulatedUIElement>();
    const std::shared_ptr<SimulatedUIElement> body = std::make_shared<SimulatedUIElement>();
    const std::shared_ptr<SimulatedUIElement> subject = std::make_shared<SimulatedUIElement>();
    bool isTold = true;
    NotedForms view;
    NotedTarget target;
    const std::shared_ptr<SnippetExpandedContent> content =
        std::make_shared<SnippetExpandedContent>(std::u16string(u"Dear "));
    std::unique_ptr<FormBridge> bridge;
};

TEST_F(FormBridgeTest, KeepsKeysBackUntilTheFormHasTheKeyboard) {
    view.comesAtOnce = false;
    make();
    EXPECT_EQ(view.prepared, content) << "what takes time begins before the form is asked for";
    EXPECT_TRUE(keysAreHeld());
    bridge->show();
    pass(2);
    EXPECT_THAT(view.places, testing::SizeIs(1));
    EXPECT_TRUE(keysAreHeld()) << "a cold start may take its time";
    desk.processes.setFollowsActivation(false);
    view.told.shown(view.window);
    pass(0.2);
    EXPECT_TRUE(keysAreHeld()) << "it stands there, and keys go elsewhere";
    desk.processes.setFollowsActivation(true);
    pass(0.2);
    EXPECT_EQ(desk.processes.frontProcess(), desk.processes.currentProcess());
    EXPECT_FALSE(keysAreHeld());
}

TEST_F(FormBridgeTest, GivesKeysBackWhenNoFormComes) {
    view.comesAtOnce = false;
    make();
    bridge->show();
    pass(2.9);
    EXPECT_TRUE(keysAreHeld());
    pass(0.2);
    EXPECT_FALSE(keysAreHeld());
}

TEST_F(FormBridgeTest, SendsIntoTheWindowThatHadTheKeyboard) {
    open();
    accept();
    EXPECT_THAT(target.events, ElementsAre("close", "send"));
    EXPECT_FALSE(keysAreHeld());
    EXPECT_THAT(view.kept, IsEmpty());
}

TEST_F(FormBridgeTest, MayGoWhenItSaysThatItCloses) {
    open();
    target.onClose = [this](FieldsEditor&) { desk.loop.perform([this] { bridge = nullptr; }); };
    accept();
    EXPECT_THAT(target.events, ElementsAre("close", "send"));
    settle();
    EXPECT_FALSE(view.isOpen);
    EXPECT_FALSE(keysAreHeld());
}

TEST_F(FormBridgeTest, GivesTheKeyboardBackWhenTheUserCancels) {
    open();
    view.told.cancelled();
    pass(0.01);
    EXPECT_EQ(desk.processes.frontProcess(), editor);
    EXPECT_THAT(target.events, ElementsAre("close"));
}

TEST_F(FormBridgeTest, KeepsTheTextWhenTheWindowIsGone) {
    open();
    desk.processes.terminate(editor);
    accept();
    EXPECT_THAT(view.kept, IsEmpty()) << "it may come yet";
    pass(1);
    EXPECT_THAT(view.kept, ElementsAre(HasSubstr("window")));
    EXPECT_THAT(target.events, IsEmpty());
    EXPECT_FALSE(keysAreHeld());
    EXPECT_TRUE(view.isOpen);

    view.told.cancelled();
    pass(0.01);
    EXPECT_THAT(target.events, ElementsAre("close")) << "the user does not want it any more";
}

TEST_F(FormBridgeTest, TriesAgainWhenTheUserSaysSo) {
    open();
    desk.processes.setFollowsActivation(false);
    accept();
    pass(1);
    ASSERT_THAT(view.kept, testing::SizeIs(1));
    accept();
    pass(1);
    EXPECT_THAT(view.kept, testing::SizeIs(2)) << "and is told again that it did not work";
    desk.processes.setFollowsActivation(true);
    focus(subject);
    accept();
    EXPECT_THAT(target.events, ElementsAre("close", "send")) << "into the field that the user has chosen meanwhile";
}

TEST_F(FormBridgeTest, KeepsTheTextWhenAnotherFieldHasTheFocus) {
    open();
    focus(subject);
    accept();
    pass(0.1);
    EXPECT_THAT(target.events, IsEmpty());
    EXPECT_THAT(view.kept, IsEmpty()) << "the program may tell late";
    pass(0.3);
    EXPECT_THAT(view.kept, ElementsAre(HasSubstr("field")));
    EXPECT_THAT(target.events, IsEmpty());
}

TEST_F(FormBridgeTest, SendsWhenTheProgramTellsLateWhereItsFocusIs) {
    open();
    focus(subject);
    accept();
    pass(0.06);
    EXPECT_THAT(target.events, IsEmpty());
    focus(body);
    pass(0.06);
    EXPECT_THAT(target.events, ElementsAre("close", "send"));
}

TEST_F(FormBridgeTest, SendsWhenTheProgramTellsNothing) {
    isTold = false;
    open();
    isTold = true;
    accept();
    EXPECT_THAT(target.events, ElementsAre("close", "send")) << "nobody knows which field it was";
}

TEST_F(FormBridgeTest, HoldsKeysAgainWhileALostFormComesBack) {
    open();
    EXPECT_FALSE(keysAreHeld());
    view.told.lost();
    desk.processes.setFrontProcess(editor);
    settle();
    EXPECT_TRUE(keysAreHeld()) << "they are the form's, whoever has the keyboard now";
    view.told.shown(view.window);
    pass(0.01);
    EXPECT_EQ(desk.processes.frontProcess(), desk.processes.currentProcess());
    EXPECT_FALSE(keysAreHeld());
    accept();
    EXPECT_THAT(target.events, ElementsAre("close", "send"));
}

TEST_F(FormBridgeTest, KeepsBackWhatFollowsAKeyThatMayEndIt) {
    open();
    press(KeyCode::A);
    EXPECT_FALSE(keysAreHeld());
    for (const KeyCode key : {KeyCode::Return, KeyCode::KeypadEnter, KeyCode::Escape}) {
        press(key);
        EXPECT_TRUE(keysAreHeld());
        view.told.stayed();
        settle();
        EXPECT_FALSE(keysAreHeld()) << "a new line in a long field";
    }
    desk.keyDown(KeyCode::Return);
    EXPECT_FALSE(keysAreHeld()) << "that is the form's";
    desk.keyDown(KeyCode::A, u"a");
    EXPECT_TRUE(keysAreHeld()) << "so soon that the loop was not there in between";
    pass(0.31);
    EXPECT_FALSE(keysAreHeld()) << "nobody answered";

    desk.processes.setFrontProcess(editor);
    press(KeyCode::Return);
    EXPECT_FALSE(keysAreHeld()) << "it is another program's";
}

}  // namespace
}  // namespace plume

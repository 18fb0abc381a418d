// The X11 port, put together as the program does it, keeps what the platform's headers promise: the suites of
// tests/contract on one rig for all of them.
//
// The test's own thread is the tap thread: the loop runs while a test waits, and at no other time.
#include <chrono>
#include <future>
#include <map>

#include "Foundation/Strings.h"
#include "app/linux/LinuxPort.h"
#include "ports/dbus/SystemSleep.h"
#include "testing/rig/Deadline.h"
#include "testing/rig/DesktopRig.h"
#include "testing/rig/FakeFcitx.h"
#include "testing/rig/FakeIbus.h"
#include "testing/rig/NoticeBoard.h"
#include "testing/rig/SelectionClients.h"
#include "testing/rig/XcbReply.h"
#include "tests/contract/ContractDesk.h"
#include "tests/support/RunUntil.h"

namespace plume::rig {

namespace {

constexpr Milliseconds Bound{10'000};
constexpr double Step = 0.005;  // seconds between two looks at a condition

// The keys that the suites press, as a US keyboard has them.
const std::map<KeyCode, int> Keycodes{{KeyCode::A, 38},
                                      {KeyCode::B, 56},
                                      {KeyCode::C, 54},
                                      {KeyCode::Shift, static_cast<int>(Key::LeftShift)},
                                      {KeyCode::Control, static_cast<int>(Key::LeftControl)}};

// What is expensive to bring up, and what a process can have only once.
struct Desktop {
    Desktop() {
        rig.session().join();
        notices = std::make_unique<NoticeBoard>();
        auto opened = LinuxPort::open(mainLoop, rig.server().display());
        if (!opened) throw RigError(opened.error().message);
        port = std::move(opened).value();
    }

    DesktopRig rig;
    std::unique_ptr<TargetProgram> second = rig.startTarget(TargetKind::GtkTextView);
    std::unique_ptr<TargetProgram> first = rig.startTarget(TargetKind::GtkTextView);
    std::unique_ptr<NoticeBoard> notices;
    PollRunLoop mainLoop;
    std::unique_ptr<LinuxPort> port;
};

class DesktopEnvironment final : public testing::Environment {
  public:
    void SetUp() override { desktop_ = std::make_unique<Desktop>(); }
    void TearDown() override { desktop_.reset(); }

    static inline std::unique_ptr<Desktop> desktop_;
};

const testing::Environment* const TheEnvironment = testing::AddGlobalTestEnvironment(new DesktopEnvironment);

// Covers the whole screen, unseen, and takes the clicks: they would open menus and move the insertion point.
class ClickPad {
  public:
    explicit ClickPad(XClient& client)
        : connection_(client.connection()), client_(client), window_(xcb_generate_id(connection_)) {
        const std::uint32_t values[] = {1, XCB_EVENT_MASK_BUTTON_PRESS};
        xcb_create_window(connection_, 0, window_, client.root(), 0, 0, client.screen().width_in_pixels,
                          client.screen().height_in_pixels, 0, XCB_WINDOW_CLASS_INPUT_ONLY, XCB_COPY_FROM_PARENT,
                          XCB_CW_OVERRIDE_REDIRECT | XCB_CW_EVENT_MASK, values);
        xcb_map_window(connection_, window_);
        client_.focusedWindow();  // the answer comes when it is there
    }
    ~ClickPad() {
        xcb_destroy_window(connection_, window_);
        client_.focusedWindow();
    }
    ClickPad(const ClickPad&) = delete;
    ClickPad& operator=(const ClickPad&) = delete;

  private:
    xcb_connection_t* const connection_;
    XClient& client_;
    const xcb_window_t window_;
};

class X11Desk final : public ContractDesk {
  public:
    X11Desk() {
        activate(Program::First);
        // Keys of the test before may be on their way still: when this one has come, they have.
        desktop_.rig.keyboard().type("x");
        const bool isReady = runUntil([this] { return text(Program::First).ends_with(u'x') && isInFront(); });
        if (!isReady) throw RigError("the program in front is not known, or takes no keys");
        desktop_.first->clear();
        desktop_.second->clear();
    }
    ~X11Desk() override {
        desktop_.rig.keyboard().releaseAll();
        setKeyboardHeldElsewhere(false);
        mouseTap().remove();
        keyboardTap().remove();
        pasteboard().declareTypes({}, nullptr);
    }

    Pasteboard& pasteboard() override { return ports_.pasteboard; }
    KeyboardTap& keyboardTap() override { return ports_.keyboardTap; }
    EventPoster& poster() override { return ports_.poster; }
    ProcessManager& processManager() override { return ports_.processManager; }
    InputSources& inputSources() override { return ports_.inputSources; }
    Accessibility& accessibility() override { return ports_.accessibility; }
    SecureInput& secureInput() override { return ports_.secureInput; }
    SystemHotKeys& systemHotKeys() override { return ports_.systemHotKeys; }
    MouseTap& mouseTap() override { return ports_.mouseTap; }
    Notices& notices() override { return ports_.notices; }
    bool canHoldUserKeys() override { return true; }

    bool runUntil(const std::function<bool()>& condition) override {
        PollRunLoop& loop = desktop_.port->tapLoop();
        const Deadline deadline(Bound);
        do {
            const Timer look = loop.performAfterDelay(Step, [&loop] { loop.stop(); });
            loop.run();
            desktop_.mainLoop.perform([this] { desktop_.mainLoop.stop(); });
            desktop_.mainLoop.run();
            if (condition()) return true;
        } while (!deadline.passed());
        return false;
    }

    // The server has taken the key when these return: whoever may read it then, will.
    void press(KeyCode keyCode) override {
        desktop_.rig.keyboard().press(Keycodes.at(keyCode));
        desktop_.rig.keyboard().sync();
    }
    void release(KeyCode keyCode) override {
        desktop_.rig.keyboard().release(Keycodes.at(keyCode));
        desktop_.rig.keyboard().sync();
    }
    void click(Button button, Point place) override {
        const ClickPad pad(desktop_.rig.client());
        desktop_.rig.click(static_cast<int>(place.x), static_cast<int>(place.y), static_cast<int>(button) + 1);
    }
    void activate(Program program) override { target(program).activate(); }
    std::u16string text(Program program) override { return fromUtf8(target(program).text()); }
    void copyElsewhere(const std::u16string& text) override {
        const SelectionData data{.type = "UTF8_STRING", .bytes = toUtf8(text)};
        elsewhere_ = std::make_unique<ForeignOwner>(display(), SelectionOffer{{"UTF8_STRING", data}});
    }
    // On a thread of its own: Plume may have to answer.
    std::optional<std::u16string> readElsewhere() override {
        auto answer = std::async(std::launch::async, [this] {
            SelectionRequestor reader(display());
            reader.targets("CLIPBOARD");
            return reader.request("CLIPBOARD", "UTF8_STRING");
        });
        runUntil([&] { return answer.wait_for(std::chrono::seconds(0)) == std::future_status::ready; });
        const auto data = answer.get();
        return data ? std::optional(fromUtf8(data->bytes)) : std::nullopt;
    }
    void setKeyboardHeldElsewhere(bool held) override {
        XClient& other = desktop_.rig.client();
        if (!held) {
            xcb_ungrab_keyboard(other.connection(), XCB_CURRENT_TIME);
            other.focusedWindow();  // the answer comes when it is done
            return;
        }
        other.await("another program's taking the keyboard", Bound, [&] {
            constexpr std::uint8_t Async = XCB_GRAB_MODE_ASYNC;
            const auto cookie = xcb_grab_keyboard(other.connection(), 0, other.root(), XCB_CURRENT_TIME, Async, Async);
            const XcbOwned<xcb_grab_keyboard_reply_t> reply(
                xcb_grab_keyboard_reply(other.connection(), cookie, nullptr));
            return reply && reply->status == XCB_GRAB_STATUS_SUCCESS;
        });
    }

    std::optional<std::string> notice(const std::string& title) override { return desktop_.notices->body(title); }
    void pressNoticeButton(const std::string& title, const std::string& label) override {
        desktop_.notices->press(title, label);
    }

  private:
    TargetProgram& target(Program program) const {
        return program == Program::First ? *desktop_.first : *desktop_.second;
    }
    const std::string& display() { return desktop_.rig.server().display(); }
    bool isInFront() {
        const auto process = processManager().frontProcess();
        const auto application = process ? processManager().runningApplication(*process) : std::nullopt;
        return application && application->processIdentifier == desktop_.first->pid();
    }

    Desktop& desktop_ = *DesktopEnvironment::desktop_;
    const Composition::Ports ports_ = desktop_.port->ports();
    std::unique_ptr<ForeignOwner> elsewhere_;
};

const ContractPort<ContractDesk> Desk{"X11", [] { return std::make_unique<X11Desk>(); }};

TEST(InputMethodTest, IsNamedInPlaceOfTheLayoutWhileItsEngineWorks) {
    Desktop& desktop = *DesktopEnvironment::desktop_;
    const auto& identifier = desktop.port->ports().inputSources.currentInputSourceIdentifier();
    const auto becomes = [&](const std::u16string& expected) {
        return test::runUntil(desktop.port->tapLoop(), [&] { return identifier == expected; });
    };
    ASSERT_EQ(identifier, u"us");
    for (const bool comesBack : {false, true}) {
        FakeIbus ibus(desktop.rig, "libpinyin");
        EXPECT_TRUE(becomes(u"ibus:libpinyin")) << comesBack;
        ibus.setEngine("xkb:de::ger");
        EXPECT_TRUE(becomes(u"us"));
        ibus.setEngine("anthy");
        EXPECT_TRUE(becomes(u"ibus:anthy"));
    }
    EXPECT_TRUE(becomes(u"us")) << "IBus has gone";
    for (const bool comesBack : {false, true}) {
        FakeFcitx fcitx("pinyin");
        EXPECT_TRUE(becomes(u"fcitx:pinyin")) << comesBack;
        fcitx.setEngine("keyboard-de");
        EXPECT_TRUE(becomes(u"us"));
        fcitx.setEngine("hangul");
        EXPECT_TRUE(becomes(u"fcitx:hangul"));
        fcitx.loseFocus();
        EXPECT_TRUE(becomes(u"us"));
        fcitx.setEngine("hangul");
        EXPECT_TRUE(becomes(u"fcitx:hangul"));
    }
    EXPECT_TRUE(becomes(u"us")) << "Fcitx has gone";
}

template <typename Fake>
void expectOutcomes(Fake& fake, bool tellsComposing) {
    PollRunLoop loop;
    const auto stop = [&loop] { loop.stop(); };
    InputMethodWatch watch(
        DesktopEnvironment::desktop_->rig.server().display(), loop, [&](const auto& /*engine*/) { stop(); }, stop);
    InputMethod& method = watch.inputMethod();
    ASSERT_TRUE(test::runUntil(loop, [&] { return method.takesText(); }) && method.isIdle());
    struct Case {
        const char* text;
        bool passes;
    };
    for (const Case& c : {Case{"\xE4\xBD\xA0", false}, Case{"", true}, Case{"\xED\x95\x9C", true}, Case{"", false}}) {
        method.announceKey(57, false);
        fake.putElsewhere("y");
        fake.takeKey(30, "x", true);  // somebody else's, which says nothing about the key
        loop.run();
        EXPECT_EQ(method.next().value_or(InputMethod::Outcome()).text, u"x");
        EXPECT_FALSE(method.next() || method.isIdle());
        fake.takeKey(57, c.text, c.passes);
        loop.run();
        method.settle();
        const auto outcome = method.next();
        ASSERT_TRUE(outcome && !outcome->unknown);
        EXPECT_EQ(outcome->text, fromUtf8(c.text));
        EXPECT_EQ(outcome->keyPassed, c.passes);
        EXPECT_EQ(outcome->composing, tellsComposing && outcome->text.empty() && !c.passes);
        EXPECT_TRUE(!method.next() && method.isIdle());
    }
    method.announceKey(57, false);
    fake.takeKey(57, "late", false, Milliseconds(200));
    method.settle();
    EXPECT_EQ(method.next().value_or(InputMethod::Outcome()).text, u"late");
    method.announceKey(57, true);
    method.settle();
    EXPECT_TRUE(!method.next() && method.isIdle() && method.takesText()) << "a menu may have taken it";
    method.announceKey(57, false);
    method.settle();
    const auto outcome = method.next();
    EXPECT_TRUE(outcome && outcome->unknown);
    EXPECT_FALSE(method.takesText()) << "the key went to no engine";
}

TEST(InputMethodTest, TellsWhatBecomesOfKeys) {
    FakeIbus ibus(DesktopEnvironment::desktop_->rig, "anthy");
    expectOutcomes(ibus, false);
}

TEST(InputMethodTest, TellsWhatFcitxMakesOfKeys) {
    FakeFcitx fcitx("hangul");
    expectOutcomes(fcitx, true);
}

TEST(SystemSleepTest, TellsWhatTheLoginManagerSays) {
    setenv("DBUS_SYSTEM_BUS_ADDRESS", sessionBusAddress().c_str(), 1);
    const BusConnection manager = openBus(sessionBusAddress());
    dbus_bus_request_name(manager.get(), "org.freedesktop.login1", 0, nullptr);
    PollRunLoop loop;
    std::optional<bool> told;
    const SystemSleep sleep(loop, [&](bool sleeps) { told = sleeps; });
    for (const bool sleeps : {true, false}) {
        const dbus_bool_t word = sleeps ? TRUE : FALSE;
        const Deadline deadline(Bound);
        do {  // until somebody listens
            const BusMessage signal(dbus_message_new_signal("/org/freedesktop/login1", "org.freedesktop.login1.Manager",
                                                            "PrepareForSleep"));
            dbus_message_append_args(signal.get(), DBUS_TYPE_BOOLEAN, &word, DBUS_TYPE_INVALID);
            dbus_connection_send(manager.get(), signal.get(), nullptr);
            dbus_connection_flush(manager.get());
            const Timer look = loop.performAfterDelay(Step, [&loop] { loop.stop(); });
            loop.run();
        } while (told != sleeps && !deadline.passed());
        EXPECT_EQ(told, sleeps);
    }
}

// As the server tells of a screen that is turned.
TEST(LinuxPortTest, FollowsTheHeightOfTheScreen) {
    X11Desk desk;
    XClient& client = DesktopEnvironment::desktop_->rig.client();
    const xcb_screen_t& screen = client.screen();
    EXPECT_EQ(desk.accessibility().mainScreenHeight(), screen.height_in_pixels);
    for (const std::uint16_t height : {std::uint16_t{2'000}, screen.height_in_pixels}) {
        xcb_configure_notify_event_t resized{};
        resized.response_type = XCB_CONFIGURE_NOTIFY;
        resized.event = resized.window = screen.root;
        resized.width = screen.width_in_pixels;
        resized.height = height;
        xcb_send_event(client.connection(), 0, screen.root, XCB_EVENT_MASK_STRUCTURE_NOTIFY,
                       reinterpret_cast<const char*>(&resized));
        xcb_flush(client.connection());
        EXPECT_TRUE(desk.runUntil([&] { return desk.accessibility().mainScreenHeight() == height; }));
    }
}

}  // namespace

}  // namespace plume::rig

namespace plume {

using rig::Desk;
INSTANTIATE_TEST_SUITE_P(X11, PasteboardContract, testing::Values(Desk));
INSTANTIATE_TEST_SUITE_P(X11, KeyboardContract, testing::Values(Desk));
INSTANTIATE_TEST_SUITE_P(X11, ProcessManagerContract, testing::Values(Desk));
INSTANTIATE_TEST_SUITE_P(X11, InputSourcesContract, testing::Values(Desk));
INSTANTIATE_TEST_SUITE_P(X11, AccessibilityContract, testing::Values(Desk));
INSTANTIATE_TEST_SUITE_P(X11, SecureInputContract, testing::Values(Desk));
INSTANTIATE_TEST_SUITE_P(X11, SystemHotKeysContract, testing::Values(Desk));
INSTANTIATE_TEST_SUITE_P(X11, MouseTapContract, testing::Values(Desk));
INSTANTIATE_TEST_SUITE_P(X11, NoticesContract, testing::Values(Desk));

}  // namespace plume

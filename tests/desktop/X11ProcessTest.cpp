// Who has the keyboard, who may have it, and the keys that the server itself keeps for Plume.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <chrono>
#include <condition_variable>
#include <csignal>
#include <fstream>
#include <mutex>

#include "Foundation/Strings.h"
#include "ports/x11/keyboard/X11SecureInput.h"
#include "ports/x11/keyboard/X11SystemHotKeys.h"
#include "ports/x11/windows/DesktopFiles.h"
#include "ports/x11/windows/X11ProcessManager.h"
#include "testing/rig/DesktopRig.h"
#include "testing/rig/SessionThread.h"

namespace plume::rig {

namespace {

namespace fs = std::filesystem;

void writeFile(const fs::path& path, const std::string& text) {
    fs::create_directories(path.parent_path());
    std::ofstream(path) << text;
}

std::string desktopEntry(const std::string& lines) {
    return "# a comment\n[Desktop Entry]\nType=Application\n" + lines + "\n[Desktop Action new]\nName=New\n";
}

// ---- Desktop files ----

TEST(DesktopFiles, AreFoundInTheOrderOfWhatTellsMost) {
    const PrivateDirectory directory;
    const fs::path applications = directory.path() / "applications";
    writeFile(applications / "by-class.desktop", desktopEntry("Name=A\nStartupWMClass=Class"));
    writeFile(applications / "by-instance.desktop", desktopEntry("Name=B\nStartupWMClass=instance"));
    writeFile(applications / "org.gtk.App.desktop", desktopEntry("Name=C"));
    writeFile(applications / "Editor.desktop", desktopEntry("Name=D\nExec=/usr/bin/python3 editor"));
    writeFile(applications / "kde/viewer.desktop", desktopEntry("Name=E\nExec=python3 viewer"));
    writeFile(applications / "by-program.desktop", desktopEntry("Name=F\nExec=env LANG=C \"/opt/tool\" %U"));
    writeFile(applications / "broken.desktop", std::string("=\n[\n[Desktop Entry]\n=x\nName\n Exec = \n\0", 36));
    const DesktopFiles files({directory.path(), directory.path() / "missing"}, "de_DE.UTF-8");

    struct Case {
        WindowIdentity window;
        std::string identifier;
    };
    const Case cases[] = {
        {{"Class", "instance", "org.gtk.App", "tool"}, "by-class"},
        {{"class", "", "", ""}, "by-class"},
        {{"Other", "instance", "org.gtk.App", "tool"}, "by-instance"},
        {{"Editor", "other", "org.gtk.App", "tool"}, "org.gtk.App"},
        {{"editor", "kde-viewer", "", "tool"}, "Editor"},
        {{"Other", "kde-viewer", "", "tool"}, "kde-viewer"},
        {{"Other", "other", "", "tool"}, "by-program"},
        {{"Other", "other", "", "python3"}, ""},
        {{"", "", "", ""}, ""},
    };
    for (const Case& one : cases) {
        const DesktopFile* const file = files.find(one.window);
        EXPECT_EQ(file ? file->identifier : "", one.identifier) << one.window.windowClass << one.window.windowInstance;
    }
}

TEST(DesktopFiles, TheUsersOwnFilesAndLanguageCome) {
    const PrivateDirectory user;
    const PrivateDirectory system;
    writeFile(user.path() / "applications/app.desktop", desktopEntry("Name=Mine\nName[de]=Meins\nName[de_AT]=Mein's"));
    writeFile(system.path() / "applications/app.desktop", desktopEntry("Name=Theirs"));
    const auto nameIn = [&](const char* locale) {
        return DesktopFiles({user.path(), system.path()}, locale).find({"App", "", "", ""})->name;
    };
    EXPECT_EQ(nameIn("de_AT.UTF-8"), "Mein's");
    EXPECT_EQ(nameIn("de_DE@euro"), "Meins");
    EXPECT_EQ(nameIn("C"), "Mine");
}

// ---- Processes ----

class X11ProcessTest : public testing::Test {
  protected:
    static void SetUpTestSuite() { rig_ = std::make_unique<DesktopRig>(); }
    static void TearDownTestSuite() { rig_.reset(); }

    void SetUp() override {
        const fs::path applications = rig_->directory() / "share/applications";
        writeFile(applications / "org.example.Writer.desktop",
                  desktopEntry("Name=Example Writer\nStartupWMClass=qt_target"));
        writeFile(applications / "example-term.desktop", desktopEntry("Name=Example Terminal\nStartupWMClass=XTerm"));
        const auto files = std::make_shared<const DesktopFiles>(std::vector{rig_->directory() / "share"}, "C");
        thread_ = std::make_unique<SessionThread>(rig_->server().display());
        processes_ = thread_->run([&] { return std::make_unique<X11ProcessManager>(thread_->session(), files); });
    }
    void TearDown() override {
        thread_->end();
        processes_.reset();
    }

    std::optional<ProcessSerialNumber> front() {
        return thread_->run([&] { return processes_->frontProcess(); });
    }
    std::optional<RunningApplication> application(ProcessSerialNumber process) {
        return thread_->run([&] { return processes_->runningApplication(process); });
    }
    ProcessSerialNumber awaitFront(const TargetProgram& target) {
        rig_->client().await("the program in front", Milliseconds(10'000), [&] {
            const auto process = front();
            return process && process->lowLongOfPSN == static_cast<std::uint32_t>(target.pid());
        });
        return *front();
    }

    static inline std::unique_ptr<DesktopRig> rig_;
    std::unique_ptr<SessionThread> thread_;
    std::unique_ptr<X11ProcessManager> processes_;
};

TEST_F(X11ProcessTest, NamesTheProgramInFrontAndForgetsItWhenItEnds) {
    struct Case {
        TargetKind kind;
        std::u16string identifier;
        std::u16string name;
    };
    const Case cases[] = {{TargetKind::GtkTextView, u"Gtk_target", u"Gtk_target"},
                          {TargetKind::QtTextEdit, u"org.example.Writer", u"Example Writer"},
                          {TargetKind::Xterm, u"example-term", u"Example Terminal"}};
    std::vector<std::unique_ptr<TargetProgram>> targets;
    std::vector<ProcessSerialNumber> numbers;
    for (const Case& one : cases) {
        targets.push_back(rig_->startTarget(one.kind));
        numbers.push_back(awaitFront(*targets.back()));
        const auto found = application(numbers.back());
        ASSERT_TRUE(found);
        EXPECT_EQ(found->processIdentifier, targets.back()->pid());
        EXPECT_EQ(found->bundleIdentifier, one.identifier);
        EXPECT_EQ(found->localizedName, one.name);
        EXPECT_TRUE(found->executableURL);
    }
    const auto ended = numbers.front();
    targets.erase(targets.begin());
    rig_->client().await("its end", Milliseconds(10'000), [&] { return !application(ended); });
}

TEST_F(X11ProcessTest, NamesProgramsThatAreKnownToTakeKeys) {
    const fs::path tool = rig_->directory() / "autokey-headless";  // longer than the system tells
    fs::copy_file("/bin/sleep", tool);
    const auto program = rig_->session().start({tool.string(), "60"}, "coreutils");
    std::vector<EventTapInformation> taps;
    rig_->client().await("it runs", Milliseconds(10'000), [&] {
        taps = thread_->run([&] { return processes_->eventTaps(); });
        return !taps.empty();
    });
    ASSERT_EQ(taps.size(), 1U);
    EXPECT_TRUE(taps.front().isActiveFilter);
    EXPECT_EQ(taps.front().tappingProcess.processIdentifier, program->pid());
    EXPECT_EQ(taps.front().tappingProcess.executableURL, fromUtf8(tool.string()));
}

TEST_F(X11ProcessTest, TypingMakesNobodyLookAgain) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    const auto process = awaitFront(*target);
    const auto lookUps = [this] { return thread_->run([this] { return processes_->lookUps(); }); };
    const int before = lookUps();
    rig_->keyboard().type("typing changes nothing");
    EXPECT_EQ(target->awaitText("typing changes nothing"), "typing changes nothing");
    EXPECT_EQ(front(), process);
    EXPECT_TRUE(application(process));
    EXPECT_EQ(lookUps(), before);
}

TEST_F(X11ProcessTest, AHungProgramInFrontIsNotWaitedFor) {
    const auto hung = rig_->startTarget(TargetKind::QtTextEdit);
    const auto other = rig_->startTarget(TargetKind::GtkTextView);
    kill(hung->pid(), SIGSTOP);
    for (const auto* target : {hung.get(), other.get(), hung.get()}) {
        rig_->client().activate(target->window());
        EXPECT_TRUE(application(awaitFront(*target)));
    }
    kill(hung->pid(), SIGCONT);
}

// ---- Without a window manager ----

class BareServerTest : public testing::Test {
  protected:
    BareServerTest() : server_(directory_, {}, privateEnvironment(directory_)), client_(server_.display()) {}

    xcb_window_t makeWindow(xcb_window_t parent, const std::string& windowClass) {
        auto* const connection = client_.connection();
        const xcb_window_t window = xcb_generate_id(connection);
        xcb_create_window(connection, XCB_COPY_FROM_PARENT, window, parent, 0, 0, 10, 10, 0,
                          XCB_WINDOW_CLASS_INPUT_OUTPUT, XCB_COPY_FROM_PARENT, 0, nullptr);
        setClass(window, windowClass);
        xcb_map_window(connection, window);
        return window;
    }
    void setClass(xcb_window_t window, const std::string& windowClass) {
        if (windowClass.empty()) return;
        const std::string bytes = std::string("instance") + '\0' + windowClass + '\0';
        xcb_change_property(client_.connection(), XCB_PROP_MODE_REPLACE, window, XCB_ATOM_WM_CLASS, XCB_ATOM_STRING, 8,
                            static_cast<std::uint32_t>(bytes.size()), bytes.data());
    }
    void focus(xcb_window_t window) {
        xcb_set_input_focus(client_.connection(), XCB_INPUT_FOCUS_NONE, window, XCB_CURRENT_TIME);
        EXPECT_EQ(client_.focusedWindow(), window);
    }

    PrivateDirectory directory_;
    XServer server_;
    XClient client_;
};

TEST_F(BareServerTest, TheFocusTellsTheProgramInFront) {
    SessionThread thread(server_.display());
    const auto files = std::make_shared<const DesktopFiles>(std::vector<fs::path>(), "C");
    auto processes = thread.run([&] { return std::make_unique<X11ProcessManager>(thread.session(), files); });
    const auto frontIdentifier = [&] {
        return thread.run([&]() -> std::optional<std::u16string> {
            const auto process = processes->frontProcess();
            const auto application = process ? processes->runningApplication(*process) : std::nullopt;
            return application ? application->bundleIdentifier : std::nullopt;
        });
    };
    const auto awaitIdentifier = [&](const std::optional<std::u16string>& expected) {
        client_.await("the program in front", Milliseconds(10'000), [&] { return frontIdentifier() == expected; });
    };
    awaitIdentifier(std::nullopt);
    const xcb_window_t first = makeWindow(client_.root(), "First");
    const xcb_window_t inner = makeWindow(makeWindow(first, ""), "");
    const xcb_window_t second = makeWindow(client_.root(), "Second");
    focus(inner);
    awaitIdentifier(u"First");
    focus(second);
    awaitIdentifier(u"Second");
    const int lookUps = processes->lookUps();
    EXPECT_EQ(frontIdentifier(), u"Second");
    EXPECT_EQ(processes->lookUps(), lookUps);
    const auto process = thread.run([&] { return processes->frontProcess(); });
    focus(first);
    awaitIdentifier(u"First");
    thread.run([&] { processes->bringToFront(*process); });
    awaitIdentifier(u"Second");
    xcb_destroy_window(client_.connection(), second);
    xcb_flush(client_.connection());
    awaitIdentifier(std::nullopt);
    thread.end();
    processes.reset();
}

TEST_F(BareServerTest, AnObserverHearsEventsUntilItsSubscriptionEnds) {
    SessionThread thread(server_.display());
    int heard = 0;
    thread.run([&] {
        X11Session& session = thread.session();
        Subscription observer = session.addObserver(XCB_PROPERTY_NOTIFY, [&](const auto&) { ++heard; });
        session.serverTime();  // which changes a property
        observer.end();
        session.serverTime();
    });
    EXPECT_EQ(heard, 1);
}

// ---- Secure input ----

TEST_F(BareServerTest, APasswordFieldIsSecure) {
    bool isPassword = false;
    const auto secure = std::move(X11SecureInput::open(server_.display(), [&] { return isPassword; })).value();
    EXPECT_FALSE(secure->isSecureEventInputEnabled());
    isPassword = true;
    EXPECT_TRUE(secure->isSecureEventInputEnabled());
}

// ---- Hot keys ----

class X11HotKeyTest : public X11ProcessTest {
  protected:
    static constexpr KeyModifiers ControlShift = KeyModifier::Control | KeyModifier::Shift;

    std::unique_ptr<X11SystemHotKeys> make(SessionThread& thread) {
        return thread.run([&] {
            keyboards_.push_back(valueOrThrow(XkbKeyboard::open(thread.session().connection())));
            keyboards_.back()->listenTo(thread.session());
            return std::make_unique<X11SystemHotKeys>(thread.session(), *keyboards_.back());
        });
    }
    std::function<void()> counting(char name) {
        return [this, name] {
            const std::lock_guard lock(mutex_);
            heard_ += name;
            changed_.notify_all();
        };
    }
    std::string awaitHeard(std::size_t count) {
        std::unique_lock lock(mutex_);
        changed_.wait_for(lock, std::chrono::seconds(10), [&] { return heard_.size() >= count; });
        return heard_;
    }

    std::vector<std::unique_ptr<XkbKeyboard>> keyboards_;
    std::mutex mutex_;
    std::condition_variable changed_;
    std::string heard_;
};

TEST_F(X11HotKeyTest, CapsLockDoesNotMatterAndAHeldKeyCountsOnce) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    auto hotKeys = make(*thread_);
    ASSERT_TRUE(thread_->run([&] { return hotKeys->registerHotKey(1, KeyCode::H, ControlShift, counting('h')).ok(); }));
    Subscription presses = thread_->run(
        [&] { return thread_->session().addHandler(XCB_KEY_PRESS, [&](const auto&) { counting('.')(); }); });
    TestKeyboard& keyboard = rig_->keyboard();
    keyboard.tap(Key::CapsLock);
    keyboard.chord({Key::LeftControl, Key::LeftShift}, U'h');
    EXPECT_EQ(awaitHeard(2), "h.");
    keyboard.tap(Key::CapsLock);
    keyboard.press(Key::LeftControl);
    keyboard.press(Key::LeftShift);
    keyboard.press(keyboard.keycodeOf(U'h'));
    EXPECT_EQ(awaitHeard(6).substr(0, 6), "h.h...") << "a held key repeats, a hot key does not";
    keyboard.releaseAll();
    thread_->run([&] {
        presses.end();
        hotKeys.reset();
    });
}

TEST_F(X11HotKeyTest, FollowsTheLayout) {
    auto hotKeys = make(*thread_);
    const auto take = [&] { return hotKeys->registerHotKey(1, KeyCode::Escape, ControlShift, counting('e')).ok(); };
    ASSERT_TRUE(thread_->run(take));
    const auto setOption = [](const std::string& option) {
        const auto program = rig_->session().start({"setxkbmap", "-option", option}, "x11-xkb-utils");
        EXPECT_EQ(program->waitForExit(Milliseconds(10'000)), 0);
    };
    setOption("caps:swapescape");
    rig_->client().await("the hot key has moved with Escape", Milliseconds(10'000), [&] {
        rig_->keyboard().chord({Key::LeftControl, Key::LeftShift}, Key::CapsLock);
        return !awaitHeard(0).empty();
    });
    setOption("");
    thread_->run([&] { hotKeys.reset(); });
}

TEST_F(X11HotKeyTest, ACombinationThatIsTakenIsRefused) {
    SessionThread other(rig_->server().display());
    auto theirs = make(other);
    auto ours = make(*thread_);
    const auto take = [&](SessionThread& thread, X11SystemHotKeys& hotKeys, SystemHotKeys::Id id, KeyCode key) {
        return thread.run([&] {
            const auto result = hotKeys.registerHotKey(id, key, ControlShift, counting('x'));
            return result.ok() ? std::string() : result.error().message;
        });
    };
    EXPECT_EQ(take(other, *theirs, 1, KeyCode::K), "");
    EXPECT_THAT(take(*thread_, *ours, 1, KeyCode::K), testing::HasSubstr("Another program"));
    EXPECT_EQ(take(*thread_, *ours, 1, KeyCode::L), "");
    EXPECT_THAT(take(*thread_, *ours, 2, KeyCode::L), testing::HasSubstr("Another hot key"));
    EXPECT_THAT(take(*thread_, *ours, 3, KeyCode::None), testing::HasSubstr("no key"));
    EXPECT_EQ(take(*thread_, *ours, 1, KeyCode::L), "") << "in place of what was there";
    other.run([&] {
        theirs.reset();
        keyboards_.front().reset();
    });
    rig_->client().await("the other's letting go", Milliseconds(10'000),
                         [&] { return take(*thread_, *ours, 4, KeyCode::K).empty(); });
    thread_->run([&] { ours.reset(); });
}

}  // namespace

}  // namespace plume::rig

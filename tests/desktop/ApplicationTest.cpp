// The application on a whole desktop, as people use it: its windows, its icon, and what it is told from elsewhere while
// it runs.
#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <span>
#include <string>

#include "testing/rig/BusService.h"
#include "testing/rig/XcbReply.h"
#include "tests/desktop/ApplicationDesktop.h"

namespace plume::rig {

namespace {

using ApplicationTest = ApplicationDesktop;

// ---- Start and end ----

TEST_F(ApplicationTest, WelcomesWhoeverIsNewAndExpandsInThatWindow) {
    start();
    ASSERT_TRUE(comesToFront("Welcome to Plume")) << log();
    const auto tries = [&] {
        rig_.keyboard().chord({Key::LeftControl}, U'a');
        rig_.keyboard().type("btw ");
        return waitUntil([&] { return reader().text(plume_->process().pid(), "Type here:") == "by the way "; },
                         Milliseconds(1'000));
    };
    EXPECT_TRUE(waitUntil(tries, Bound)) << log();
    const auto target = rig_.startTarget(TargetKind::QtTextEdit);
    expectSoon(*target, "x btw ", "x by the way ");
    EXPECT_TRUE(stateHas("\"enabled\": true"));
    plume_ = nullptr;
    start();
    expectSoon(*target, "x btw ", "x by the way ");
    EXPECT_TRUE(hasFocus(nameOf(target->kind()))) << "nobody is welcomed twice";
}

TEST_F(ApplicationTest, EndsAtOnceAndKeepsWhatWasAddedLast) {
    keepLibrary();
    const auto end = [&](bool byCommand) {
        byCommand ? static_cast<void>(command({"quit"})) : static_cast<void>(kill(plume_->process().pid(), SIGTERM));
        EXPECT_EQ(plume_->process().waitForExit(Milliseconds(1'000)), 0) << log();
    };
    for (const bool byCommand : {true, false}) {
        start();
        const std::string abbreviation = byCommand ? "one;" : "two;";
        command({"add", abbreviation, "kept " + abbreviation});
        end(byCommand);
        EXPECT_EQ(command({"expand", abbreviation}), "kept " + abbreviation + "\n");
    }
    EXPECT_EQ(runPlume(rig_, {"status"}).status, 1);
}

// As where a desktop ends without a word.
TEST_F(ApplicationTest, EndsWithTheDisplayAndKeepsWhatWasAddedLast) {
    keepLibrary();
    start();
    command({"add", "last;", "kept"});
    rig_.server().crash();
    EXPECT_EQ(plume_->process().waitForExit(Milliseconds(5'000)), 1) << log();
    EXPECT_EQ(command({"expand", "last;"}), "kept\n");
}

TEST_F(ApplicationTest, ASecondStartShowsTheFirst) {
    keepLibrary();
    start();
    const auto target = rig_.startTarget(TargetKind::GtkTextView);
    for (int times = 0; times < 2; ++times) {
        EXPECT_EQ(runPlume(rig_, {}).status, 0);
        EXPECT_TRUE(comesToFront("Snippets")) << times << log();
        target->activate();
    }
    EXPECT_TRUE(plume_->process().isRunning());
    expectSoon(*target, "x ;sig", "x Kind regards, Jo");
}

// ---- Commands ----

TEST_F(ApplicationTest, CommandsHoldFromTheNextKeyOn) {
    keepLibrary();
    start();
    const auto target = rig_.startTarget(TargetKind::GtkTextView);
    expectSoon(*target, "x ;sig", "x Kind regards, Jo");
    EXPECT_EQ(command({"toggle"}), "off\n");
    expectAtOnce(*target, "x ;sig.", "x ;sig.");
    EXPECT_EQ(command({"toggle"}), "on\n");
    expectAtOnce(*target, "x ;sig", "x Kind regards, Jo");

    command({"add", "omw;", "on my way"});
    expectAtOnce(*target, "x omw;", "x on my way");
    command({"remove", "omw;"});
    expectAtOnce(*target, "x omw;.", "x omw;.");

    const auto file = rig_.directory() / "more.csv";
    std::ofstream(file) << "brb;,be right back,\n";
    EXPECT_TRUE(contains(command({"import", file}), "1 snippet"));
    expectAtOnce(*target, "x brb;", "x be right back");
}

TEST_F(ApplicationTest, AHotKeySetElsewhereWorksAtOnce) {
    keepLibrary();
    start();
    const auto target = rig_.startTarget(TargetKind::GtkTextView);
    expectSoon(*target, "x ;sig", "x Kind regards, Jo");
    command({"settings", "switchHotKey", "120"});  // F2
    const auto switchesOff = [&] {
        rig_.keyboard().tap(Key::F2);
        return waitUntil([&] { return stateHas("\"enabled\": false"); }, Milliseconds(1'000));
    };
    ASSERT_TRUE(waitUntil(switchesOff, Bound)) << log();
    expectAtOnce(*target, "x ;sig.", "x ;sig.");
    rig_.keyboard().tap(Key::F2);
    expectAtOnce(*target, "x ;sig", "x Kind regards, Jo");
}

// ---- Session bus ----

class ApplicationOnBusTest : public ApplicationTest {
  protected:
    static constexpr BusAddress Launcher{"org.plume.Plume", "/org/plume/Plume", "org.freedesktop.Application"};
    static constexpr BusAddress Plume{"org.plume.Plume", "/org/plume/Plume", "org.plume.Plume"};

    BusAnswer call(const BusMessage& message) {
        if (!bus_) bus_ = openBus(sessionBusAddress());
        BusAnswer answer(BusMessage(dbus_connection_send_with_reply_and_block(
            bus_.get(), message.get(), static_cast<int>(Bound.count()), nullptr)));
        EXPECT_TRUE(answer) << log();
        return answer;
    }
    // As launchers call an action: without parameters.
    static BusMessage activation(const std::string& action) {
        BusMessage call = newCall(Launcher, "ActivateAction", {action});
        DBusMessageIter values;
        DBusMessageIter none;
        dbus_message_iter_init_append(call.get(), &values);
        for (const char* type : {"v", "{sv}"}) {
            dbus_message_iter_open_container(&values, DBUS_TYPE_ARRAY, type, &none);
            dbus_message_iter_close_container(&values, &none);
        }
        return call;
    }

  private:
    BusConnection bus_;
};

TEST_F(ApplicationOnBusTest, LaunchersAndScriptsReachIt) {
    keepLibrary();
    start();
    call(activation("toggle"));
    const auto state = call(newCall(Plume, "State")).values().string().value_or("");
    EXPECT_TRUE(contains(state, "\"enabled\": false")) << state;
    EXPECT_EQ(call(newCall(Plume, "Version")).values().string().value_or("") + "\n", command({"--version"}));

    const auto file = rig_.directory() / "more snippets.csv";
    std::ofstream(file) << "brb;,be right back,\n";
    const std::string uri = "file://" + rig_.directory().string() + "/more%20snippets.csv";
    call(newCall(Launcher, "Open", {std::vector<std::string>{uri}, BusNoOptions{}}));
    ASSERT_TRUE(comesToFront("Restore / Import data from more snippets.csv")) << log();
    ASSERT_TRUE(click("Import"));
    EXPECT_TRUE(waitUntil([&] { return stateHas("\"snippets\": 3"); }, Bound)) << log();
    call(newCall(Launcher, "Activate", {BusNoOptions{}}));
    EXPECT_TRUE(comesToFront("Snippets")) << log();
}

// ---- Preferences ----

class ApplicationSettingsTest : public ApplicationTest {
  protected:
    void SetUp() override {
        ApplicationTest::SetUp();
        keepLibrary();
        start();
        target_ = rig_.startTarget(TargetKind::GtkTextView);
        expectSoon(*target_, "x ;sig", "x Kind regards, Jo");
    }

    // Clicks on these names on a page of the preferences, one after another, and goes back to the program.
    void change(const std::string& page, const std::vector<std::string>& controls) {
        command({"show", "preferences"});
        ASSERT_TRUE(comesToFront("Preferences")) << log();
        ASSERT_TRUE(click(page)) << page;
        for (const std::string& control : controls) ASSERT_TRUE(click(control)) << control;
        target_->activate();
    }

    std::unique_ptr<TargetProgram> target_;
};

TEST_F(ApplicationSettingsTest, AreInForceForWhatIsTypedNext) {
    const struct {
        const char* page;
        const char* control;
        const char* typed;
        const char* before;
        const char* after;
    } settings[] = {
        {"Correction", "Correct two capitals at the start of a word", "HEllo ", "HEllo ", "Hello "},
        {"Correction", "Begin every sentence with a capital", "1 one. two ", "1 one. two ", "1 one. Two "},
        {"Expansion", "Mixed case gives every word a capital", ";bRb", "be right back", "Be Right Back"},
        {"General", "Expand abbreviations", "1 ;sig.", "1 Kind regards, Jo.", "1 ;sig."},
        {"General", "Expand abbreviations", "1 ;sig.", "1 ;sig.", "1 Kind regards, Jo."},
    };
    for (const auto& setting : settings) {
        SCOPED_TRACE(setting.control);
        expectAtOnce(*target_, setting.typed, setting.before);
        change(setting.page, {setting.control});
        expectSoon(*target_, setting.typed, setting.after);
    }
}

TEST_F(ApplicationSettingsTest, SayWhetherTextsArePastedAndTheClipboardComesBack) {
    // What was pasted stays on the clipboard then.
    const auto isOnClipboard = [&] {
        expectAtOnce(*target_, "x ;sig", "x Kind regards, Jo");
        rig_.keyboard().chord({Key::LeftControl}, U'v');
        const std::string both = "x Kind regards, JoKind regards, Jo";
        return target_->awaitText(both, Milliseconds(1'000)) == both;
    };
    EXPECT_FALSE(isOnClipboard());
    change("Typing and clipboard", {"Paste texts instead of typing them", "Give back what was copied after a paste"});
    EXPECT_TRUE(waitUntil(isOnClipboard, Bound)) << log();
}

TEST_F(ApplicationSettingsTest, SayWhetherAClickEndsTheAbbreviation) {
    const auto expandsAroundClick = [&] {
        becomes(rig_, *target_, "x ;si", "x ;si");
        const XClient::Place place = rig_.client().placeOf(target_->window());
        rig_.click(place.x + place.width / 2, place.y + place.height / 2);
        rig_.keyboard().type("g");
        return target_->awaitText("x Kind regards, Jo", Milliseconds(1'000)) == "x Kind regards, Jo";
    };
    EXPECT_FALSE(expandsAroundClick()) << target_->text();
    change("Expansion", {"A mouse click ends the abbreviation"});
    EXPECT_TRUE(waitUntil(expandsAroundClick, Bound)) << target_->text();
}

TEST_F(ApplicationSettingsTest, StartAtTheNextLogin) {
    const auto entry = rig_.directory() / "home/.config/autostart/org.plume.Plume.desktop";
    for (const bool starts : {true, false}) {
        change("General", {"Start Plume when I log in"});
        EXPECT_TRUE(waitUntil([&] { return std::filesystem::exists(entry) == starts; }, Bound)) << starts;
    }
}

TEST_F(ApplicationTest, RecordsAHotKeyThatNoWindowGets) {
    keepLibrary();
    start();
    const auto target = rig_.startTarget(TargetKind::GtkTextView);
    expectSoon(*target, "x ;sig", "x Kind regards, Jo");
    command({"show", "preferences"});
    ASSERT_TRUE(comesToFront("Preferences")) << log();
    ASSERT_TRUE(click("Hot keys"));
    const auto records = [&] {
        if (!click("Switch expansion on and off")) return false;
        // The window would be closed by it.
        rig_.keyboard().chord({Key::LeftControl}, U'w');
        return waitUntil(
            [&] { return reader().text(plume_->process().pid(), "Switch expansion on and off") == "Ctrl+W"; },
            Milliseconds(1'000));
    };
    ASSERT_TRUE(waitUntil(records, Bound)) << log();
    EXPECT_TRUE(hasFocus("Preferences"));
    target->activate();
    EXPECT_EQ(target->text(), "x Kind regards, Jo");
    expectSoon(*target, "x ;sig", "x Kind regards, Jo");
    rig_.keyboard().chord({Key::LeftControl}, U'w');
    expectAtOnce(*target, "x ;sig.", "x ;sig.");
}

// ---- The desktop around it ----

TEST_F(ApplicationTest, HearsNothingWhileTheMachineSleeps) {
    keepLibrary();
    BusService manager(sessionBusAddress(), "org.freedesktop.login1", [](DBusMessage*) { return nullptr; });
    start({"DBUS_SYSTEM_BUS_ADDRESS=" + sessionBusAddress()});
    const auto target = rig_.startTarget(TargetKind::GtkTextView);
    expectSoon(*target, "x ;sig", "x Kind regards, Jo");
    // Again and again, as Plume may not listen yet.
    const auto holdsWhen = [&](dbus_bool_t sleeps, const std::string& expected) {
        const BusMessage signal(
            dbus_message_new_signal("/org/freedesktop/login1", "org.freedesktop.login1.Manager", "PrepareForSleep"));
        dbus_message_append_args(signal.get(), DBUS_TYPE_BOOLEAN, &sleeps, DBUS_TYPE_INVALID);
        return waitUntil(
            [&] {
                manager.send(signal);
                return rig::becomes(rig_, *target, "x ;sig.", expected, Milliseconds(1'000));
            },
            Bound);
    };
    EXPECT_TRUE(holdsWhen(TRUE, "x ;sig.")) << log();
    EXPECT_TRUE(holdsWhen(FALSE, "x Kind regards, Jo.")) << log();
}

class ApplicationInTrayTest : public ApplicationTest {
  protected:
    void SetUp() override {
        ApplicationTest::SetUp();
        keepLibrary();
        start();
        target_ = rig_.startTarget(TargetKind::GtkTextView);
    }

    void startTray() { tray_ = rig_.session().start({"trayer", "--widthtype", "request"}, "trayer"); }
    bool iconIs(bool shown) {
        const std::string expected = shown ? "\"icon\": true" : "\"icon\": false";
        return waitUntil([&] { return stateHas(expected); }, Bound);
    }

    // Plume's icon is the only one.
    void clickOnIcon() {
        XClient& client = rig_.client();
        for (const xcb_window_t window : client.managedWindows()) {
            if (client.property(window, "_NET_WM_NAME") != "panel") continue;
            const XClient::Place place = client.placeOf(window);
            return rig_.click(place.x + place.width / 2, place.y + place.height / 2);
        }
        ADD_FAILURE() << "there is no tray";
    }

    bool menusAre(int count, Milliseconds within = Bound) {
        return waitUntil([&] { return shownMenus() == count; }, within);
    }

    std::unique_ptr<TargetProgram> target_;
    std::unique_ptr<ChildProcess> tray_;

  private:
    // Windows that the window manager has nothing to do with.
    std::ptrdiff_t shownMenus() {
        XClient& client = rig_.client();
        auto* connection = client.connection();
        const auto tree = own(xcb_query_tree_reply(connection, xcb_query_tree(connection, client.root()), nullptr));
        const std::span windows(xcb_query_tree_children(tree.get()), tree->children_len);
        return std::ranges::count_if(windows, [&](xcb_window_t window) {
            const auto cookie = xcb_get_window_attributes(connection, window);
            const auto attributes = own(xcb_get_window_attributes_reply(connection, cookie, nullptr));
            const bool isShown = attributes && attributes->map_state == XCB_MAP_STATE_VIEWABLE;
            return isShown && client.property(window, "WM_CLASS").starts_with("plume");
        });
    }
};

TEST_F(ApplicationInTrayTest, OutlivesTheTrayAndFindsTheNext) {
    for (int trays = 0; trays < 2; ++trays) {
        startTray();
        ASSERT_TRUE(iconIs(true)) << log();
        ASSERT_EQ(kill(tray_->pid(), SIGKILL), 0);
        EXPECT_TRUE(iconIs(false)) << log();
        expectSoon(*target_, "x ;sig", "x Kind regards, Jo");
    }
}

TEST_F(ApplicationInTrayTest, SendsASnippetFromTheMenuIntoTheProgramInFront) {
    startTray();
    ASSERT_TRUE(iconIs(true)) << log();
    target_->activate();
    // The tray may still be making room for it.
    const auto opens = [&] {
        clickOnIcon();
        return menusAre(1, Milliseconds(2'000));
    };
    ASSERT_TRUE(waitUntil(opens, Bound)) << log();
    // The menu itself holds the keyboard, and Plume looks every three seconds whether somebody does.
    EXPECT_FALSE(waitUntil([&] { return stateHas("\"secureInput\": true"); }, Milliseconds(3'500)));
    for (const Key key : {Key::Down, Key::Down, Key::Right}) rig_.keyboard().tap(key);
    EXPECT_TRUE(menusAre(2)) << log();
    rig_.keyboard().tap(Key::Return);
    EXPECT_EQ(target_->awaitText("Kind regards, Jo"), "Kind regards, Jo") << log();
    EXPECT_TRUE(menusAre(0));
}

}  // namespace

}  // namespace plume::rig

#include "app/cli/Doctor.h"

#include <xcb/xinput.h>
#include <xcb/xtest.h>

#include <QCoreApplication>
#include <QDBusConnection>
#include <QDBusConnectionInterface>
#include <algorithm>
#include <array>
#include <chrono>
#include <cstdlib>
#include <filesystem>
#include <memory>
#include <ostream>
#include <set>
#include <string>
#include <system_error>
#include <thread>
#include <vector>

#include "app/cli/CommandLine.h"
#include "app/cli/Files.h"
#include "app/cli/InstanceLock.h"
#include "app/cli/LibraryChoice.h"
#include "app/cli/Version.h"
#include "ports/atspi/AtspiAccessibility.h"
#include "ports/atspi/AtspiSession.h"
#include "ports/posix/PollRunLoop.h"
#include "ports/posix/TerminalDevices.h"
#include "ports/x11/X11Session.h"
#include "ports/x11/clipboard/X11Pasteboard.h"
#include "ports/x11/keyboard/TapConnection.h"
#include "ports/x11/keyboard/X11SecureInput.h"

namespace plume {

namespace {

std::string environment(const char* name) {
    const char* const value = std::getenv(name);
    return value ? value : "";
}

// Other programs that take keys for themselves, by the names of their processes, and what they are.
struct Conflict {
    const char* program;
    const char* what;
};
constexpr std::array Conflicts = {
    Conflict{"autokey-gtk", "expands abbreviations, too"},
    Conflict{"autokey-qt", "expands abbreviations, too"},
    Conflict{"espanso", "expands abbreviations, too"},
    Conflict{"keyd", "rewrites keys"},
    Conflict{"kmonad", "rewrites keys"},
    Conflict{"kanata", "rewrites keys"},
    Conflict{"xremap", "rewrites keys"},
    Conflict{"xkeysnail", "rewrites keys"},
    Conflict{"input-remapper", "rewrites keys"},
    Conflict{"xcape", "presses keys by itself"},
};

// The names of all processes, cut off after 15 characters as the system keeps them.
std::set<std::string> runningPrograms() {
    std::set<std::string> names;
    std::error_code problem;
    for (const auto& entry : std::filesystem::directory_iterator("/proc", problem)) {
        if (const auto name = readWholeFile(entry.path() / "comm")) {
            names.insert(name.value().substr(0, name.value().find('\n')));
        }
    }
    return names;
}

std::string nameOfProcess(pid_t process) {
    const auto name = readWholeFile("/proc/" + std::to_string(process) + "/comm");
    return name ? name.value().substr(0, name.value().find('\n')) : std::string();
}

std::vector<std::uint32_t> numbersOf(XcbConnection& connection, xcb_window_t window, const char* property) {
    constexpr std::uint32_t Most = 4'096;
    const auto cookie =
        xcb_get_property(connection.get(), 0, window, connection.atom(property), XCB_GET_PROPERTY_TYPE_ANY, 0, Most);
    const XcbOwned<xcb_get_property_reply_t> reply(xcb_get_property_reply(connection.get(), cookie, nullptr));
    constexpr int Bits = 32;
    if (!reply || reply->format != Bits) return {};
    const auto* const first = static_cast<const std::uint32_t*>(xcb_get_property_value(reply.get()));
    return {first, first + reply->value_len};
}

// The processes that have windows, as far as these tell.
std::set<pid_t> processesWithWindows(XcbConnection& connection) {
    std::set<pid_t> processes;
    for (const xcb_window_t window : numbersOf(connection, connection.root(), "_NET_CLIENT_LIST")) {
        for (const std::uint32_t process : numbersOf(connection, window, "_NET_WM_PID")) {
            processes.insert(static_cast<pid_t>(process));
        }
    }
    return processes;
}

class Examination {
  public:
    explicit Examination(std::ostream& output) : output_(output) {}

    int run() {
        output_ << "plume " << Version << '\n';
        if (examineDisplay()) {
            examineKeyboard();
            examineClipboard();
            examineSecureInput();
        }
        examineAccessibility();
        if (session_) examinePasswordFields();
        examineInputMethods();
        if (session_) examineIcon();
        examineSounds();
        examineWatchdog();
        examineForms();
        examineScripts();
        examineConflicts();
        examineLibrary();
        output_ << (canRun_ ? "Plume can work here.\n" : "Plume cannot work here yet.\n");
        return canRun_ ? ExitStatus::Success : ExitStatus::MissingSystem;
    }

  private:
    void good(const char* part, const std::string& finding) { line("ok      ", part, finding); }
    // It works without, but not as well.
    void warn(const char* part, const std::string& finding) { line("warning ", part, finding); }
    void bad(const char* part, const std::string& finding) {
        canRun_ = false;
        line("MISSING ", part, finding);
    }
    void line(const char* mark, const char* part, const std::string& finding) {
        output_ << mark << part << ": " << finding << '\n';
    }

    bool examineDisplay() {
        auto opened = X11Session::open({}, loop_);
        if (!opened) {
            bad("display", opened.error().message);
            return false;
        }
        session_ = std::move(opened).value();
        good("display", session_->connection().displayName());
        if (!environment("WAYLAND_DISPLAY").empty()) {
            warn("session",
                 "this is a Wayland session: Plume hears only programs that run on its X server; choose a session "
                 "\"on Xorg\" when you log in to use it everywhere.");
        }
        return true;
    }

    void examineKeyboard() {
        const bool hears = session_->connection().extension(xcb_input_id) != nullptr;
        const bool types = session_->connection().extension(xcb_test_id) != nullptr;
        if (types) {
            good("synthesiser", "the XTEST extension is on");
        } else {
            bad("synthesiser", "the X server's XTEST extension is off; switch it on in its configuration.");
        }
        if (!hears) return bad("tap", "the X server's XInputExtension is off; switch it on in its configuration.");
        const auto checked = TapConnection::check({});
        if (checked) {
            good("tap", "the keyboard can be heard before other programs get its keys");
        } else if (types) {
            bad("tap", checked.error().message);
        }
    }

    void examineClipboard() {
        const auto pasteboard = X11Pasteboard::open(*session_);
        if (!pasteboard) return bad("clipboard", pasteboard.error().message);
        const auto types = pasteboard.value()->types();
        good("clipboard", types.empty() ? "works, and is empty" : "works, and its content can be read and given back");
    }

    void examineSecureInput() {
        const auto secureInput = X11SecureInput::open({}, [] { return false; });
        if (secureInput && secureInput.value()->isSecureEventInputEnabled()) {
            warn("keyboard",
                 "another program holds the keyboard just now: a menu, a password prompt, a lock screen. "
                 "Nothing expands while it does.");
        }
    }

    void examineAccessibility() {
        const AtspiAccessibility accessibility;
        constexpr int Tries = 75;
        for (int i = 0; i < Tries && accessibility.status() == AccessibilityStatus::Starting; ++i) {
            std::this_thread::sleep_for(std::chrono::milliseconds(20));
        }
        const AccessibilityStatus status = accessibility.status();
        const std::string sentence(sentenceOf(status));
        if (status == AccessibilityStatus::Working) return good("accessibility", sentence);
        warn("accessibility", sentence);
    }

    void examinePasswordFields() {
        const AccessibilityBus bus = findAccessibilityBus();
        if (bus.address.empty()) return;
        const std::set<pid_t> telling = processesOnBus(bus);
        std::set<std::string> silent;
        for (const pid_t process : processesWithWindows(session_->connection())) {
            // In a terminal, its device tells of hidden prompts.
            if (!telling.contains(process) && terminalDevicesBelow(process).empty()) {
                silent.insert(nameOfProcess(process));
            }
        }
        if (silent.empty()) return good("password fields", "every program that has a window now tells about its own");
        std::string names;
        for (const std::string& name : silent) names += (names.empty() ? "" : ", ") + name;
        warn("password fields",
             "Plume hears what is typed into those of programs that do not tell about them: " + names +
                 ". Chromium and what is built on it tell only if accessibility was on when they were started.");
    }

    // Their engines work inside the programs, behind the keys.
    void examineInputMethods() {
        const std::set<std::string> running = runningPrograms();
        for (const char* program : {"ibus-daemon", "fcitx5", "fcitx", "uim-xim"}) {
            if (!running.contains(program)) continue;
            if (program == std::string_view("ibus-daemon") || program == std::string_view("fcitx5")) {
                good("input method", std::string(program) +
                                         " is running: what its engines put into programs counts as "
                                         "typed, but not where programs reach them by XIM");
                continue;
            }
            good("input method",
                 std::string(program) +
                     " is running: while an engine of it turns keys into other text (Japanese, Chinese, "
                     "Korean), Plume hears the keys, not the text; switch Plume off meanwhile.");
        }
    }

    // Where it is missing, the command line and hot keys lead to everything.
    void examineIcon() {
        XcbConnection& connection = session_->connection();
        const auto cookie = xcb_get_selection_owner(connection.get(), connection.atom("_NET_SYSTEM_TRAY_S0"));
        const XcbOwned<xcb_get_selection_owner_reply_t> tray(
            xcb_get_selection_owner_reply(connection.get(), cookie, nullptr));
        if (tray && tray->owner != XCB_WINDOW_NONE) return good("icon", "the desktop has a tray for it");
        int count = 0;
        const QCoreApplication application(count, nullptr);
        const QDBusConnection bus = QDBusConnection::sessionBus();
        if (bus.isConnected() && bus.interface()->isServiceRegistered("org.kde.StatusNotifierWatcher")) {
            return good("icon", "the desktop's panel has a place for it");
        }
        warn(
            "icon",
            "the desktop has no place for it now; run plume again, or plume show preferences, to reach the windows. On "
            "GNOME an extension for AppIndicator icons adds one.");
    }

    void examineSounds() {
        std::error_code problem;
        if (std::filesystem::is_directory(soundFolder(), problem)) return good("sounds", "Plume's own are there");
        warn("sounds", soundFolder().string() + " is not there, so expansions are silent; install Plume again.");
    }

    void examineWatchdog() {
        const std::filesystem::path program = programFolder() / "plume-watchdog";
        std::error_code problem;
        if (std::filesystem::exists(program, problem)) {
            return good("watchdog", "frees the keyboard should Plume hang");
        }
        bad("watchdog", program.string() + " is not there; install Plume again.");
    }

    void examineForms() {
        std::error_code problem;
        if (std::filesystem::exists(programFolder() / "plume-form", problem)) {
            return good("forms", "fields are filled in where they stand in the text");
        }
        warn("forms", "plume-form is not installed, so fields are filled in in a plain window.");
    }

    void examineScripts() {
        std::error_code problem;
        if (std::filesystem::exists("/bin/bash", problem)) return good("scripts", "shell scripts can run");
        warn("scripts", "there is no /bin/bash, so shell scripts that are written for it may not work; install bash.");
    }

    void examineConflicts() {
        const std::set<std::string> running = runningPrograms();
        bool any = false;
        for (const Conflict& conflict : Conflicts) {
            constexpr std::size_t KeptLength = 15;
            if (!running.contains(std::string(conflict.program).substr(0, KeptLength))) continue;
            any = true;
            warn("other programs", std::string(conflict.program) + " is running and " + conflict.what +
                                       "; when keys get lost or come twice, end one of the two.");
        }
        if (!any) good("other programs", "none that is known to get in the way");
        if (InstanceLock::isTaken({})) good("instance", "Plume is already running on this display");
    }

    void examineLibrary() {
        const auto library =
            openLibrary(std::nullopt, [this](const std::string& sentence) { warn("library", sentence); });
        if (!library) return bad("library", library.error().message);
        std::size_t snippets = 0;
        for (const auto& group : library.value().groups) snippets += group->items().size();
        good("library", std::to_string(snippets) + " snippets in " + library.value().file.string());
    }

    std::ostream& output_;
    bool canRun_ = true;
    PollRunLoop loop_;
    std::unique_ptr<X11Session> session_;
};

}  // namespace

int examineDesktop(std::ostream& output) {
    return Examination(output).run();
}

}  // namespace plume

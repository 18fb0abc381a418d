#include "testing/rig/DesktopSession.h"

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <fstream>

#include "testing/rig/ReportPipe.h"

namespace plume::rig {

namespace {

constexpr Milliseconds StartBound{10'000};

// The only settings of the caller that programs of the desktop get: how to find programs and libraries, and how
// sanitizers report.
constexpr const char* Inherited[] = {"PATH",         "LD_LIBRARY_PATH", "TZ",           "TMPDIR",
                                     "ASAN_OPTIONS", "UBSAN_OPTIONS",   "TSAN_OPTIONS", "LSAN_OPTIONS"};

std::filesystem::path writePointerFocus(const PrivateDirectory& directory) {
    std::filesystem::path file = directory.path() / "openbox.xml";
    std::ofstream(file) << R"(<openbox_config xmlns="http://openbox.org/3.4/rc">
  <focus><followMouse>yes</followMouse><focusNew>yes</focusNew></focus>
</openbox_config>
)";
    return file;
}

}  // namespace

Environment privateEnvironment(const PrivateDirectory& directory) {
    Environment environment;
    for (const char* name : Inherited) {
        if (const char* value = std::getenv(name)) environment.push_back(std::string(name) + "=" + value);
    }
    const auto add = [&](const std::string& name, const std::string& value) {
        environment.push_back(name + "=" + value);
    };
    add("HOME", directory.makeFolder("home"));
    add("XDG_RUNTIME_DIR", directory.makeFolder("run"));
    add("XDG_CONFIG_HOME", directory.makeFolder("home/.config"));
    add("XDG_DATA_HOME", directory.makeFolder("home/.local/share"));
    add("XDG_CACHE_HOME", directory.makeFolder("home/.cache"));
    add("XDG_SESSION_TYPE", "x11");
    add("LANG", "C.UTF-8");
    add("GSETTINGS_BACKEND", "memory");
    add("GDK_BACKEND", "x11");
    add("QT_QPA_PLATFORM", "xcb");
    add("QT_LINUX_ACCESSIBILITY_ALWAYS_ON", "1");
    return environment;
}

DesktopSession::DesktopSession(const PrivateDirectory& directory, const XServer& server, WindowManager manager)
    : directory_(directory), environment_(privateEnvironment(directory)) {
    environment_.push_back("DISPLAY=" + server.display());
    XClient client(server.display());
    startBus();
    startAccessibility(client);
    startWindowManager(client, manager);
}

void DesktopSession::join() const {
    for (const std::string& line : environment_) {
        const auto end = line.find('=');
        setenv(line.substr(0, end).c_str(), line.substr(end + 1).c_str(), 1);
    }
}

void DesktopSession::startBus() {
    const auto program = requireProgram("dbus-daemon", "dbus-daemon");
    requireFile({"/usr/share/dbus-1/session.conf"}, "dbus-session-bus-common");
    ReportPipe address;
    const std::string wanted = "unix:path=" + (directory_.path() / "run" / "bus").string();
    bus_ = startProgram(program,
                        {"--session", "--nofork", "--nopidfile", "--nosyslog", "--address=" + wanted,
                         "--print-address=" + std::to_string(address.writer())},
                        {address.writer()});
    environment_.push_back("DBUS_SESSION_BUS_ADDRESS=" + address.awaitLine(*bus_, StartBound));
}

// The launcher publishes the accessibility bus on the root window once programs can use it.
void DesktopSession::startAccessibility(XClient& client) {
    const auto program =
        requireFile({"/usr/libexec/at-spi-bus-launcher", "/usr/lib/at-spi2-core/at-spi-bus-launcher"}, "at-spi2-core");
    requireFile({"/usr/libexec/at-spi2-registryd", "/usr/lib/at-spi2-core/at-spi2-registryd"}, "at-spi2-core");
    accessibility_ = startProgram(program, {"--launch-immediately"});
    client.await("the start of the accessibility bus", StartBound, [&] {
        if (!accessibility_->isRunning())
            throw RigError("the accessibility bus has ended:\n" + accessibility_->logTail());
        return !client.property(client.root(), "AT_SPI_BUS").empty();
    });
}

void DesktopSession::startWindowManager(XClient& client, WindowManager manager) {
    const std::string program = manager == WindowManager::Xfwm4 ? "xfwm4" : "openbox";
    const std::string name = manager == WindowManager::Xfwm4 ? "Xfwm4" : "Openbox";
    std::vector<std::string> arguments{"--sm-disable"};
    if (manager == WindowManager::Xfwm4) arguments = {"--sm-client-disable", "--compositor=off"};
    if (manager == WindowManager::OpenboxFollowingPointer) {
        arguments.insert(arguments.end(), {"--config-file", writePointerFocus(directory_)});
    }
    windowManager_ = startProgram(requireProgram(program, program), arguments);
    client.await("the start of " + program, StartBound, [&] {
        if (!windowManager_->isRunning()) throw RigError(program + " has ended:\n" + windowManager_->logTail());
        const std::string bytes = client.property(client.root(), "_NET_SUPPORTING_WM_CHECK");
        xcb_window_t window = XCB_WINDOW_NONE;
        if (bytes.size() >= sizeof window) std::memcpy(&window, bytes.data(), sizeof window);
        return window != XCB_WINDOW_NONE && client.property(window, "_NET_WM_NAME") == name;
    });
    awaitManaging(client);
}

// Openbox announces itself before it takes care of windows, and loses requests of windows that are quicker: it is ready
// once it has managed a window of ours and let it go.
void DesktopSession::awaitManaging(XClient& client) {
    auto* connection = client.connection();
    const xcb_window_t window = xcb_generate_id(connection);
    xcb_create_window(connection, XCB_COPY_FROM_PARENT, window, client.root(), 0, 0, 10, 10, 0,
                      XCB_WINDOW_CLASS_INPUT_OUTPUT, XCB_COPY_FROM_PARENT, 0, nullptr);
    const auto isManaged = [&] { return std::ranges::count(client.managedWindows(), window) > 0; };
    client.await("managing a window", StartBound, [&] {
        if (isManaged()) return true;
        xcb_map_window(connection, window);  // does nothing when it is mapped
        return false;
    });
    xcb_destroy_window(connection, window);
    client.await("letting a window go", StartBound, [&] { return !isManaged(); });
}

std::unique_ptr<ChildProcess> DesktopSession::start(const std::vector<std::string>& arguments,
                                                    const std::string& package) {
    const std::filesystem::path program = arguments.at(0);
    return startProgram(program.is_absolute() ? requireFile({program}, package) : requireProgram(program, package),
                        {arguments.begin() + 1, arguments.end()});
}

std::unique_ptr<ChildProcess> DesktopSession::startProgram(const std::filesystem::path& program,
                                                           std::vector<std::string> arguments,
                                                           const std::vector<int>& keptDescriptors) {
    arguments.insert(arguments.begin(), program);
    auto log = directory_.path() / program.filename();
    log += "." + std::to_string(++programs_) + ".output";
    return std::make_unique<ChildProcess>(ChildProcess::Start{
        .arguments = arguments, .environment = environment_, .log = log, .keptDescriptors = keptDescriptors});
}

}  // namespace plume::rig

#include "ports/x11/windows/X11ProcessManager.h"

#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <climits>
#include <csignal>
#include <cstring>
#include <filesystem>
#include <set>
#include <string_view>
#include <system_error>
#include <utility>

#include "Foundation/Strings.h"
#include "ports/x11/windows/KeyTools.h"

namespace plume {

namespace {

constexpr std::uint32_t LongestProperty = 1024;  // words
constexpr int DeepestWindow = 32;
constexpr int FocusAttempts = 4;
constexpr std::uint32_t AskedByPager = 2;
// What tells who is in front, of the root window and of the window in front.
constexpr std::string_view RootNames[] = {"_NET_ACTIVE_WINDOW", "_NET_SUPPORTING_WM_CHECK"};
constexpr std::string_view WindowNames[] = {"WM_CLASS", "_NET_WM_PID", "_GTK_APPLICATION_ID", "WM_CLIENT_MACHINE"};

std::string ownHostName() {
    std::array<char, HOST_NAME_MAX + 1> name{};
    gethostname(name.data(), name.size() - 1);
    return name.data();
}

// Requests are all sent before the first answer is waited for: they share one round trip.
class PropertyRequest {
  public:
    PropertyRequest(XcbConnection& connection, xcb_window_t window, std::string_view name)
        : connection_(connection.get()),
          cookie_(xcb_get_property(connection_, 0, window, connection.atom(name), XCB_GET_PROPERTY_TYPE_ANY, 0,
                                   LongestProperty)) {}

    std::string bytes() const {
        const XcbOwned<xcb_get_property_reply_t> reply(xcb_get_property_reply(connection_, cookie_, nullptr));
        if (!reply) return {};
        return {static_cast<const char*>(xcb_get_property_value(reply.get())),
                static_cast<std::size_t>(xcb_get_property_value_length(reply.get()))};
    }
    // The first of a list of 32-bit words; 0 when there is none.
    std::uint32_t word() const {
        const std::string value = bytes();
        std::uint32_t first = 0;
        if (value.size() >= sizeof first) std::memcpy(&first, value.data(), sizeof first);
        return first;
    }

  private:
    xcb_connection_t* connection_;
    xcb_get_property_cookie_t cookie_;
};

// The file that a process runs; empty when the system does not tell.
std::string executableOf(std::uint32_t process) {
    std::error_code error;
    return std::filesystem::read_symlink("/proc/" + std::to_string(process) + "/exe", error).string();
}

// WM_CLASS is two strings, each ended by a zero byte.
void readClass(const std::string& bytes, WindowIdentity& identity) {
    const auto end = bytes.find('\0');
    identity.windowInstance = bytes.substr(0, end);
    if (end == std::string::npos) return;
    identity.windowClass = bytes.substr(end + 1, bytes.find('\0', end + 1) - end - 1);
}

std::string withoutTrailingZero(std::string text) {
    text.resize(std::min(text.size(), text.find('\0')));
    return text;
}

std::optional<std::u16string> unlessEmpty(const std::string& text) {
    return text.empty() ? std::nullopt : std::optional(fromUtf8(text));
}

}  // namespace

X11ProcessManager::X11ProcessManager(X11Session& session, std::shared_ptr<const DesktopFiles> desktopFiles)
    : session_(session), desktopFiles_(std::move(desktopFiles)), hostName_(ownHostName()) {
    // Asked now, so that no key waits for it.
    for (const std::string_view name : RootNames) session_.connection().atom(name);
    for (const std::string_view name : WindowNames) session_.connection().atom(name);
    root_ = session_.listen(session_.connection().root(), XCB_EVENT_MASK_PROPERTY_CHANGE);
    for (const int type : {XCB_PROPERTY_NOTIFY, XCB_FOCUS_OUT, XCB_FOCUS_IN, XCB_DESTROY_NOTIFY}) {
        observers_.push_back(session_.addObserver(static_cast<std::uint8_t>(type),
                                                  [this](const xcb_generic_event_t& event) { hear(event); }));
    }
}

void X11ProcessManager::hear(const xcb_generic_event_t& event) {
    const int type = event.response_type & 0x7F;
    if (type == XCB_DESTROY_NOTIFY) {
        const auto window = reinterpret_cast<const xcb_destroy_notify_event_t&>(event).window;
        if (window == manager_.window()) manager_ = {};
        if (window == front_.window() || manager_.window() == XCB_WINDOW_NONE) forgetFront();
        return;
    }
    if (type != XCB_PROPERTY_NOTIFY) {
        if (reinterpret_cast<const xcb_focus_in_event_t&>(event).event == focus_.window()) forgetFront();
        return;
    }
    const auto& change = reinterpret_cast<const xcb_property_notify_event_t&>(event);
    const auto matters = [&](std::string_view name) { return session_.connection().atom(name) == change.atom; };
    const bool isOfRoot = change.window == session_.connection().root();
    const bool changes = isOfRoot ? std::any_of(std::begin(RootNames), std::end(RootNames), matters)
                                  : change.window == front_.window() &&
                                        std::any_of(std::begin(WindowNames), std::end(WindowNames), matters);
    if (changes) forgetFront();
}

void X11ProcessManager::forgetFront() {
    if (std::exchange(isKnown_, false) && frontMayHaveChanged) frontMayHaveChanged();
}

ProcessSerialNumber X11ProcessManager::currentProcess() const {
    return {0, static_cast<std::uint32_t>(getpid())};
}

std::optional<ProcessSerialNumber> X11ProcessManager::frontProcess() const {
    session_.collect();
    if (!isKnown_) {
        const_cast<X11ProcessManager*>(this)->lookUp();
        session_.collect();
    }
    return frontProcess_;
}

std::uint32_t X11ProcessManager::frontWindow() const {
    frontProcess();
    return front_.window() != XCB_WINDOW_NONE ? front_.window() : focus_.window();
}

void X11ProcessManager::lookUp() {
    ++lookUps_;
    // First: what changes from now on makes the answer outdated, also while it is being found.
    isKnown_ = !session_.connection().isBroken();
    xcb_window_t window = activeWindow();
    watch(front_, window, XCB_EVENT_MASK_PROPERTY_CHANGE | XCB_EVENT_MASK_STRUCTURE_NOTIFY);
    if (window != XCB_WINDOW_NONE) {
        focus_ = {};
    } else {
        window = focusedApplicationWindow();
    }
    frontProcess_ = window == XCB_WINDOW_NONE ? std::nullopt : processOf(window);
}

// What a window manager that has gone left behind says nothing: its own window must be there, too.
xcb_window_t X11ProcessManager::activeWindow() {
    constexpr std::string_view Check = "_NET_SUPPORTING_WM_CHECK";
    XcbConnection& connection = session_.connection();
    const PropertyRequest check(connection, connection.root(), Check);
    const PropertyRequest active(connection, connection.root(), "_NET_ACTIVE_WINDOW");
    const xcb_window_t manager = check.word();
    const xcb_window_t window = active.word();
    if (manager == XCB_WINDOW_NONE || manager != manager_.window()) {
        watch(manager_, manager, XCB_EVENT_MASK_STRUCTURE_NOTIFY);
        const bool isThere =
            manager != XCB_WINDOW_NONE && PropertyRequest(connection, manager, Check).word() == manager;
        if (!isThere) manager_ = {};
    }
    return manager_.window() == XCB_WINDOW_NONE ? xcb_window_t{XCB_WINDOW_NONE} : window;
}

// Asked again once it is watched: it may have changed before.
xcb_window_t X11ProcessManager::focusedWindow() {
    xcb_connection_t* const server = session_.get();
    const xcb_window_t root = session_.connection().root();
    for (int attempt = 0; attempt < FocusAttempts; ++attempt) {
        const XcbOwned<xcb_get_input_focus_reply_t> reply(
            xcb_get_input_focus_reply(server, xcb_get_input_focus(server), nullptr));
        const xcb_window_t window = reply && reply->focus > XCB_INPUT_FOCUS_POINTER_ROOT ? reply->focus : root;
        if (attempt > 0 && window == focus_.window()) break;
        watch(focus_, window, XCB_EVENT_MASK_FOCUS_CHANGE);
    }
    return focus_.window();
}

// The focused window is often one deep inside the application's own.
xcb_window_t X11ProcessManager::focusedApplicationWindow() {
    xcb_connection_t* const server = session_.get();
    xcb_window_t window = focusedWindow();
    for (int depth = 0; depth < DeepestWindow && window != session_.connection().root(); ++depth) {
        const PropertyRequest windowClass(session_.connection(), window, "WM_CLASS");
        const auto treeCookie = xcb_query_tree(server, window);
        const bool isApplication = !windowClass.bytes().empty();
        const XcbOwned<xcb_query_tree_reply_t> tree(xcb_query_tree_reply(server, treeCookie, nullptr));
        if (isApplication) return window;
        if (!tree || tree->parent == XCB_WINDOW_NONE) break;
        window = tree->parent;
    }
    return XCB_WINDOW_NONE;
}

void X11ProcessManager::watch(X11Session::WindowEvents& events, xcb_window_t window, std::uint32_t eventMask) {
    if (events.window() == window) return;
    events = window == XCB_WINDOW_NONE ? X11Session::WindowEvents() : session_.listen(window, eventMask);
}

std::optional<ProcessSerialNumber> X11ProcessManager::processOf(xcb_window_t window) {
    XcbConnection& connection = session_.connection();
    const PropertyRequest processId(connection, window, "_NET_WM_PID");
    const PropertyRequest machine(connection, window, "WM_CLIENT_MACHINE");
    const PropertyRequest windowClass(connection, window, "WM_CLASS");
    const PropertyRequest applicationId(connection, window, "_GTK_APPLICATION_ID");
    const std::uint32_t toldProcess = processId.word();
    const std::string host = withoutTrailingZero(machine.bytes());
    WindowIdentity identity;
    readClass(windowClass.bytes(), identity);
    identity.gtkApplicationId = withoutTrailingZero(applicationId.bytes());
    // Numbers of another machine's processes mean something else here.
    std::uint32_t process = host.empty() || host == hostName_ ? toldProcess : 0;
    if (process != 0 && process == static_cast<std::uint32_t>(helperProcess_)) process = currentProcess().lowLongOfPSN;
    const std::string executable = process != 0 ? executableOf(process) : std::string();
    identity.program = executable.substr(executable.find_last_of('/') + 1);
    if (process == 0 && identity.windowClass.empty()) return std::nullopt;

    const DesktopFile* const file = desktopFiles_->find(identity);
    RunningApplication application;
    application.processIdentifier = process;
    application.bundleIdentifier = unlessEmpty(file ? file->identifier : identity.windowClass);
    application.localizedName = unlessEmpty(file && !file->name.empty() ? file->name : identity.windowClass);
    application.executableURL = unlessEmpty(executable);
    return numberOf(application, window);
}

// One process can show windows of several applications, and windows need not tell their process at all.
ProcessSerialNumber X11ProcessManager::numberOf(const RunningApplication& application, xcb_window_t window) {
    ProcessSerialNumber number{0, static_cast<std::uint32_t>(application.processIdentifier)};
    const bool isOurs = number == currentProcess();
    if (number.lowLongOfPSN == 0) number.highLongOfPSN = clientOf(window);
    auto known = applications_.find(number);
    while (!isOurs && known != applications_.end() &&
           known->second.description.bundleIdentifier != application.bundleIdentifier) {
        ++number.highLongOfPSN;
        known = applications_.find(number);
    }
    applications_.insert_or_assign(number, Application{application, window});
    return number;
}

// The part of a window's number that all windows of its program share.
std::uint32_t X11ProcessManager::clientOf(xcb_window_t window) const {
    return window & ~xcb_get_setup(session_.get())->resource_id_mask;
}

std::optional<RunningApplication> X11ProcessManager::runningApplication(ProcessSerialNumber process) const {
    const auto known = applications_.find(process);
    if (known == applications_.end()) return std::nullopt;
    const auto pid = static_cast<pid_t>(process.lowLongOfPSN);
    if (pid != 0 && kill(pid, 0) != 0 && errno == ESRCH) {
        applications_.erase(known);
        return std::nullopt;
    }
    return known->second.description;
}

std::vector<EventTapInformation> X11ProcessManager::eventTaps() const {
    std::vector<EventTapInformation> taps;
    for (RunningApplication& tool : runningKeyTools()) taps.push_back({true, std::move(tool)});
    return taps;
}

void X11ProcessManager::bringToFront(ProcessSerialNumber process) {
    const xcb_window_t window = windowOf(process);
    if (window != XCB_WINDOW_NONE) activateWindow(window);
}

void X11ProcessManager::activateWindow(std::uint32_t window) {
    session_.collect();
    XcbConnection& connection = session_.connection();
    if (activeWindow() == XCB_WINDOW_NONE && manager_.window() == XCB_WINDOW_NONE) {
        xcb_set_input_focus(session_.get(), XCB_INPUT_FOCUS_PARENT, window, XCB_CURRENT_TIME);
        const std::uint32_t above = XCB_STACK_MODE_ABOVE;
        xcb_configure_window(session_.get(), window, XCB_CONFIG_WINDOW_STACK_MODE, &above);
    } else {
        // Events are always sent as 32 bytes.
        xcb_client_message_event_t message{};
        static_assert(sizeof message == 32);
        message.response_type = XCB_CLIENT_MESSAGE;
        message.format = 32;
        message.window = window;
        message.type = connection.atom("_NET_ACTIVE_WINDOW");
        message.data.data32[0] = AskedByPager;
        message.data.data32[1] = session_.serverTime();
        xcb_send_event(session_.get(), 0, connection.root(),
                       XCB_EVENT_MASK_SUBSTRUCTURE_NOTIFY | XCB_EVENT_MASK_SUBSTRUCTURE_REDIRECT,
                       reinterpret_cast<const char*>(&message));
    }
    session_.flush();
}

// The window manager's word alone says little: it names a window active before the server gives it the keyboard. What
// has the focus is that window or one inside it, so it is the same program's.
bool X11ProcessManager::keysArriveIn(std::uint32_t window) const {
    if (window == XCB_WINDOW_NONE || frontWindow() != window) return false;
    const XcbOwned<xcb_get_input_focus_reply_t> reply(
        xcb_get_input_focus_reply(session_.get(), xcb_get_input_focus(session_.get()), nullptr));
    return reply && reply->focus > XCB_INPUT_FOCUS_POINTER_ROOT && clientOf(reply->focus) == clientOf(window);
}

std::optional<Rectangle> X11ProcessManager::frontWindowBounds() const {
    const xcb_window_t window = frontWindow();
    if (window == XCB_WINDOW_NONE) return std::nullopt;
    xcb_connection_t* const server = session_.get();
    const auto sizeAsked = xcb_get_geometry(server, window);
    const auto placeAsked = xcb_translate_coordinates(server, window, session_.connection().root(), 0, 0);
    const XcbOwned<xcb_get_geometry_reply_t> size(xcb_get_geometry_reply(server, sizeAsked, nullptr));
    const XcbOwned<xcb_translate_coordinates_reply_t> place(
        xcb_translate_coordinates_reply(server, placeAsked, nullptr));
    if (!size || !place) return std::nullopt;
    return Rectangle{{static_cast<double>(place->dst_x), static_cast<double>(place->dst_y)},
                     {static_cast<double>(size->width), static_cast<double>(size->height)}};
}

std::vector<xcb_window_t> X11ProcessManager::windowsInStackingOrder() const {
    XcbConnection& connection = session_.connection();
    const PropertyRequest request(connection, connection.root(), "_NET_CLIENT_LIST_STACKING");
    const std::string bytes = request.bytes();
    std::vector<xcb_window_t> windows(bytes.size() / sizeof(xcb_window_t));
    if (!windows.empty()) std::memcpy(windows.data(), bytes.data(), windows.size() * sizeof(xcb_window_t));
    return windows;
}

std::vector<RunningApplication> X11ProcessManager::runningApplications() const {
    std::set<ProcessSerialNumber> seen{currentProcess()};
    std::vector<RunningApplication> applications;
    for (const xcb_window_t window : windowsInStackingOrder()) {
        const auto process = const_cast<X11ProcessManager*>(this)->processOf(window);
        if (!process || !seen.insert(*process).second) continue;
        if (auto application = runningApplication(*process)) applications.push_back(*std::move(application));
    }
    return applications;
}

// Where the process was seen last, or else the topmost of its windows.
xcb_window_t X11ProcessManager::windowOf(ProcessSerialNumber process) {
    const std::vector<xcb_window_t> windows = windowsInStackingOrder();
    const auto known = applications_.find(process);
    const xcb_window_t last = known == applications_.end() ? xcb_window_t{XCB_WINDOW_NONE} : known->second.window;
    if (windows.empty() || std::find(windows.begin(), windows.end(), last) != windows.end()) return last;
    for (auto window = windows.rbegin(); window != windows.rend(); ++window) {
        if (processOf(*window) == process) return *window;
    }
    return XCB_WINDOW_NONE;
}

}  // namespace plume

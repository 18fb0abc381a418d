#include "platform/desktop/AtspiFocusTracker.h"

#include <glib-unix.h>
#include <sys/syscall.h>
#include <unistd.h>

#include <algorithm>
#include <string_view>
#include <utility>

namespace plume {

namespace {

constexpr int DeepestPart = 40;
constexpr int MostPartsSearched = 400;
constexpr int MostChildren = 100;
constexpr int MostLooks = 20;
constexpr std::chrono::milliseconds TimeBetweenLooks{200};

// Not the movements of the caret: telling of one with every key costs a program, and so the typist, 0.4 ms a key.
constexpr std::array<const char*, 5> EventTypes = {"object:state-changed:focused", "window:activate",
                                                   "window:deactivate", "window:destroy", "window:minimize"};

}  // namespace

AtspiFocusTracker::~AtspiFocusTracker() {
    stopWatching();
    for (std::size_t i = 0; i < listeners_.size(); ++i) {
        if (listeners_[i] == nullptr) continue;
        atspi_event_listener_deregister(listeners_[i], EventTypes[i], nullptr);
        g_object_unref(listeners_[i]);
    }
}

bool AtspiFocusTracker::start() {
    for (std::size_t i = 0; i < listeners_.size(); ++i) {
        listeners_[i] = atspi_event_listener_new(heard, this, nullptr);
        if (atspi_event_listener_register(listeners_[i], EventTypes[i], nullptr) == 0) return false;
    }
    findFocus();
    return true;
}

void AtspiFocusTracker::adoptConnections() const {
    const auto adopt = [this](AtspiAccessible* part) {
        if (part == nullptr || part->parent.app == nullptr || part->parent.app->bus == nullptr) return;
        atspi_dbus_connection_setup_with_g_main(part->parent.app->bus, queue_.context());
    };
    const GObjectOwned<AtspiAccessible> desktop(atspi_get_desktop(0));
    const GPtrArray* programs = desktop ? desktop->children : nullptr;
    for (guint i = 0; programs != nullptr && i < programs->len; ++i) {
        adopt(static_cast<AtspiAccessible*>(g_ptr_array_index(programs, i)));
    }
    adopt(activeWindow_.get());
    adopt(focus_.part().get());
}

void AtspiFocusTracker::heard(AtspiEvent* event, void* tracker) {
    auto& self = *static_cast<AtspiFocusTracker*>(tracker);
    const std::string_view type = event->type != nullptr ? event->type : "";
    if (event->source == nullptr) {
    } else if (type.starts_with("object:state-changed:focused")) {
        self.note(event->detail1 != 0 ? Kind::FocusGained : Kind::FocusLost, event->source);
    } else if (type.starts_with("window:activate")) {
        self.note(Kind::WindowActivated, event->source);
    } else {
        self.note(Kind::WindowLeft, event->source);
    }
    g_boxed_free(ATSPI_TYPE_EVENT, event);
}

void AtspiFocusTracker::note(Kind kind, AtspiAccessible* source) {
    noted_.push_back({kind, queue_.share(ATSPI_ACCESSIBLE(g_object_ref(source)))});
    if (noted_.size() == 1) queue_.post([this] { handleNoted(); });
}

void AtspiFocusTracker::handleNoted() {
    // One entry stays while it is handled, so that what is noted meanwhile posts no second call.
    while (!noted_.empty()) {
        const Event event = noted_.front();
        handle(event);
        noted_.pop_front();
    }
}

void AtspiFocusTracker::handle(const Event& event) {
    switch (event.kind) {
        case Kind::FocusGained:
            gained(event.source);
            break;
        case Kind::FocusLost:
            if (focus_.part() == event.source) clearFocus();
            break;
        case Kind::WindowActivated:
            windowActivated(event.source);
            break;
        case Kind::WindowLeft:
            windowLeft(event.source);
            break;
    }
}

void AtspiFocusTracker::gained(const AtspiPart& part) {
    // A program in the background may move its own focus about.
    if (activeWindow_ && !areOfSameProgram(activeWindow_.get(), part.get()) && !isInActiveWindow(part)) {
        considerAgain(part);
    } else {
        setFocus(part);
    }
}

// Programs that are just starting, or busy, may not answer at first, nor tell again.
void AtspiFocusTracker::considerAgain(const AtspiPart& part) {
    const bool isWaiting = candidate_ != nullptr;
    candidate_ = part;
    if (!isWaiting) considerCandidate(MostLooks);
}

void AtspiFocusTracker::considerCandidate(int looks) {
    if (looks == 0 || focus_.part() == candidate_) {
        candidate_ = nullptr;
    } else if (hasState(candidate_.get(), ATSPI_STATE_FOCUSED) && isInActiveWindow(candidate_)) {
        setFocus(std::exchange(candidate_, nullptr));
    } else {
        queue_.postAfter(TimeBetweenLooks, [this, looks] { considerCandidate(looks - 1); });
    }
}

void AtspiFocusTracker::windowActivated(const AtspiPart& window) {
    activeWindow_ = window;
    const AtspiPart focused = focus_.part();
    if (areOfSameProgram(focused.get(), window.get())) return;
    previous_ = focused;
    clearFocus();
    lookForFocusIn(window, MostLooks);
}

void AtspiFocusTracker::windowLeft(const AtspiPart& window) {
    const AtspiPart focused = focus_.part();
    if (activeWindow_ ? activeWindow_ != window : !areOfSameProgram(focused.get(), window.get())) return;
    activeWindow_ = nullptr;
    clearFocus();
    // Qt says nothing of a focus that comes back within half a second.
    const AtspiPart previous = std::exchange(previous_, nullptr);
    if (!previous || areOfSameProgram(previous.get(), window.get())) return;
    if (hasState(previous.get(), ATSPI_STATE_FOCUSED) && isInActiveWindow(previous)) setFocus(previous);
}

void AtspiFocusTracker::setFocus(const AtspiPart& part) {
    const AtspiRole role = atspi_accessible_get_role(part.get(), nullptr);
    AtspiError error;
    const guint process = atspi_accessible_get_process_id(part.get(), error.out());
    const pid_t pid = error.isSet() || process > G_MAXINT ? 0 : static_cast<pid_t>(process);
    focus_.set(part, role == ATSPI_ROLE_PASSWORD_TEXT, pid);
    watch(pid);
}

void AtspiFocusTracker::clearFocus() {
    focus_.clear();
    stopWatching();
}

bool AtspiFocusTracker::isInActiveWindow(const AtspiPart& part) {
    GObjectOwned<AtspiAccessible> at(ATSPI_ACCESSIBLE(g_object_ref(part.get())));
    for (int depth = 0; at && depth < DeepestPart; ++depth) {
        if (hasState(at.get(), ATSPI_STATE_ACTIVE)) return true;
        at.reset(atspi_accessible_get_parent(at.get(), nullptr));
    }
    return false;
}

void AtspiFocusTracker::findFocus() {
    const AtspiPart desktop = queue_.share(atspi_get_desktop(0));
    if (!desktop) return;
    const int programs = atspi_accessible_get_child_count(desktop.get(), nullptr);
    for (int i = 0; i < programs; ++i) {
        const AtspiPart program = child(desktop, i);
        const int windows = program ? atspi_accessible_get_child_count(program.get(), nullptr) : 0;
        for (int j = 0; j < std::min(windows, MostChildren); ++j) {
            const AtspiPart window = child(program, j);
            if (!window || !hasState(window.get(), ATSPI_STATE_ACTIVE)) continue;
            activeWindow_ = window;
            findFocusIn(window);
            return;
        }
    }
}

void AtspiFocusTracker::lookForFocusIn(const AtspiPart& window, int looks) {
    if (activeWindow_ != window || focus_.part()) return;
    findFocusIn(window);
    if (focus_.part() || looks <= 1) return;
    queue_.postAfter(TimeBetweenLooks, [this, window, looks] { lookForFocusIn(window, looks - 1); });
}

void AtspiFocusTracker::findFocusIn(const AtspiPart& window) {
    int left = MostPartsSearched;
    if (const AtspiPart focused = focusedBelow(window, 0, left)) setFocus(focused);
}

AtspiPart AtspiFocusTracker::focusedBelow(const AtspiPart& part, int depth, int& left) const {
    if (--left < 0) return nullptr;
    const auto states = statesOf(part.get());
    if (!states) return nullptr;
    const auto has = [&](AtspiStateType state) { return atspi_state_set_contains(states.get(), state) != 0; };
    // A text can be a window by itself; other windows only stand for what they hold.
    if (has(ATSPI_STATE_FOCUSED) && (depth > 0 || has(ATSPI_STATE_EDITABLE))) return part;
    if (depth == DeepestPart || has(ATSPI_STATE_MANAGES_DESCENDANTS)) return nullptr;
    if (depth > 0 && !has(ATSPI_STATE_SHOWING)) return nullptr;
    const int children = atspi_accessible_get_child_count(part.get(), nullptr);
    for (int i = 0; i < std::min(children, MostChildren) && left > 0; ++i) {
        const AtspiPart below = child(part, i);
        if (!below) continue;
        if (AtspiPart found = focusedBelow(below, depth + 1, left)) return found;
    }
    return nullptr;
}

AtspiPart AtspiFocusTracker::child(const AtspiPart& part, int index) const {
    return queue_.share(atspi_accessible_get_child_at_index(part.get(), index, nullptr));
}

void AtspiFocusTracker::watch(pid_t process) {
    if (process == watched_) return;
    stopWatching();
    if (process == 0) return;
    watchedDescriptor_ = static_cast<int>(syscall(SYS_pidfd_open, process, 0));
    if (watchedDescriptor_ < 0) return;
    watched_ = process;
    watch_ = g_unix_fd_source_new(watchedDescriptor_, G_IO_IN);
    const GUnixFDSourceFunc programEnded = [](int, GIOCondition, void* tracker) -> gboolean {
        auto& self = *static_cast<AtspiFocusTracker*>(tracker);
        self.activeWindow_ = nullptr;
        self.clearFocus();
        return G_SOURCE_REMOVE;
    };
    g_source_set_callback(watch_, reinterpret_cast<GSourceFunc>(reinterpret_cast<void*>(programEnded)), this, nullptr);
    g_source_attach(watch_, queue_.context());
}

void AtspiFocusTracker::stopWatching() {
    if (watch_ != nullptr) {
        g_source_destroy(watch_);
        g_source_unref(watch_);
        close(watchedDescriptor_);
    }
    watch_ = nullptr;
    watched_ = 0;
}

}  // namespace plume

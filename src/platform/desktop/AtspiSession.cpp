#include "platform/desktop/AtspiSession.h"

#include "platform/desktop/AccessibilityBus.h"
#include "platform/desktop/AtspiFocusTracker.h"

namespace plume {

namespace {

constexpr int CallBoundMilliseconds = 150;
constexpr int StartBoundMilliseconds = 500;  // for programs that are just starting

// libatspi listens for every change of every program to keep copies of their user interfaces, which cost memory and
// wake this thread; it is asked not to. States it must keep: it would ask for them in the middle of reading what
// programs send, and never come back.
void keepNoCopies() {
    const GObjectOwned<AtspiAccessible> desktop(atspi_get_desktop(0));
    constexpr auto KeptCopies = static_cast<AtspiCache>(ATSPI_CACHE_STATES | ATSPI_CACHE_INTERFACES);
    if (desktop) atspi_accessible_set_cache_mask(desktop.get(), KeptCopies);
    DBusConnection* bus = atspi_get_a11y_bus();
    for (const char* rule : {"type='signal',interface='org.a11y.atspi.Cache',member='AddAccessible'",
                             "type='signal',interface='org.a11y.atspi.Event.Object',member='ChildrenChanged'",
                             "type='signal',interface='org.a11y.atspi.Event.Object',member='PropertyChange'",
                             "type='signal',interface='org.a11y.atspi.Event.Object',member='StateChanged'"}) {
        dbus_bus_remove_match(bus, rule, nullptr);
    }
}

}  // namespace

bool AtspiSession::connect() {
    // 1: another object of this process has done it.
    const int result = atspi_init();
    if (result != 0 && result != 1) return false;
    atspi_set_main_context(queue_->context());
    atspi_set_timeout(CallBoundMilliseconds, StartBoundMilliseconds);
    keepNoCopies();
    return true;
}

void AtspiSession::run() {
    const AccessibilityStatus found = findAccessibilityBus();
    if (found != AccessibilityStatus::Working && found != AccessibilityStatus::SwitchedOff) {
        status_ = found;
        return;
    }
    g_main_context_push_thread_default(queue_->context());
    if (AtspiFocusTracker tracker(*queue_, focus_); connect() && tracker.start()) {
        queue_->open();
        status_ = found;
        queue_->run([&] { tracker.adoptConnections(); });
    } else {
        status_ = AccessibilityStatus::Failed;
    }
    g_main_context_pop_thread_default(queue_->context());
}

}  // namespace plume

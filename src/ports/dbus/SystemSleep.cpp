#include "ports/dbus/SystemSleep.h"

#include <cstdlib>
#include <string>
#include <utility>

#include "ports/dbus/MainLoopLink.h"
#include "ports/dbus/ServiceBus.h"

namespace plume {

namespace {

constexpr auto Interface = "org.freedesktop.login1.Manager";
constexpr auto Signal = "PrepareForSleep";

std::string systemBusAddress() {
    const char* const address = std::getenv("DBUS_SYSTEM_BUS_ADDRESS");
    return address ? address : "unix:path=/run/dbus/system_bus_socket";
}

}  // namespace

// On the thread, but for what says otherwise.
class SleepSession {
  public:
    SleepSession(RunLoop& mainLoop, SystemSleep::Listener listener)
        : bus_(loop_), listener_(std::move(listener)), mainLoop_(mainLoop) {
        bus_.heard = [this](DBusMessage& signal) { hear(signal); };
    }

    void run() {
        if (!bus_.connect(systemBusAddress())) return;
        // The bus itself sees to it that nobody else is heard.
        bus_.listen(std::string("type='signal',sender='org.freedesktop.login1',interface='") + Interface +
                    "',member='" + Signal + "'");
        loop_.run();
    }
    // From any thread.
    void end() {
        mainLoop_.cut();
        loop_.stop();
    }

  private:
    void hear(DBusMessage& signal) {
        if (dbus_message_is_signal(&signal, Interface, Signal) == 0) return;
        const auto sleeps = BusReader(&signal).boolean();
        if (sleeps) mainLoop_.perform([tell = listener_, asleep = *sleeps] { tell(asleep); });
    }

    PollRunLoop loop_;
    ServiceBus bus_;
    const SystemSleep::Listener listener_;
    MainLoopLink mainLoop_;
};

SystemSleep::SystemSleep(RunLoop& mainLoop, Listener listener)
    : thread_(std::make_shared<SleepSession>(mainLoop, std::move(listener))) {}

SystemSleep::~SystemSleep() = default;

}  // namespace plume

#include "ports/dbus/InputMethodWatch.h"

#include <utility>

#include "ports/dbus/IbusAddress.h"
#include "ports/dbus/IbusConnection.h"
#include "ports/dbus/MainLoopLink.h"

namespace plume {

// On the thread, but for what says otherwise.
class InputMethodSession {
  public:
    InputMethodSession(std::string display, RunLoop& tapLoop, InputMethodWatch::EngineListener engineChanged)
        : display_(std::move(display)),
          bus_(loop_),
          ibus_(loop_),
          engineChanged_(std::move(engineChanged)),
          tapLoop_(tapLoop) {
        bus_.heard = [this](DBusMessage& signal) { hear(signal); };
        ibus_.engineChanged = [this](const std::string& name) { tellEngine(name); };
    }

    void run() {
        if (!bus_.connect(sessionBusAddress())) return;
        bus_.listen(
            "type='signal',sender='org.freedesktop.DBus',member='NameOwnerChanged',arg0='org.freedesktop.IBus'");
        ibus_.connect(ibusAddress(display_));
        loop_.run();
    }
    // From any thread.
    void end() {
        tapLoop_.cut();
        loop_.stop();
    }

  private:
    // IBus comes to the session's bus when its own is there.
    void hear(DBusMessage& signal) {
        if (dbus_message_is_signal(&signal, "org.freedesktop.DBus", "NameOwnerChanged") == 0) return;
        BusReader values(&signal);
        values.string();
        values.string();
        const bool hasCome = !values.string().value_or("").empty();
        if (hasCome) ibus_.connect(ibusAddress(display_));
    }

    void tellEngine(const std::string& name) {
        // Engines of this kind leave the keys alone.
        const bool isLayout = name.starts_with("xkb:");
        std::string identifier = name.empty() || isLayout ? std::string() : "ibus:" + name;
        if (identifier == told_) return;
        told_ = identifier;
        tapLoop_.perform([tell = engineChanged_, identifier = std::move(identifier)] { tell(identifier); });
    }

    const std::string display_;
    PollRunLoop loop_;
    ServiceBus bus_;
    IbusConnection ibus_;
    std::string told_;
    const InputMethodWatch::EngineListener engineChanged_;
    MainLoopLink tapLoop_;
};

InputMethodWatch::InputMethodWatch(const std::string& display, RunLoop& loop, EngineListener engineChanged)
    : thread_(std::make_shared<InputMethodSession>(display, loop, std::move(engineChanged))) {}

InputMethodWatch::~InputMethodWatch() = default;

}  // namespace plume

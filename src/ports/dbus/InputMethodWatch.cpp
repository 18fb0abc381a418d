#include "ports/dbus/InputMethodWatch.h"

#include <utility>

#include "ports/dbus/FcitxConnection.h"
#include "ports/dbus/IbusAddress.h"
#include "ports/dbus/IbusConnection.h"
#include "ports/dbus/MainLoopLink.h"

namespace plume {

namespace {

constexpr const char* Ibus = "org.freedesktop.IBus";

}  // namespace

// On the thread, but for what says otherwise.
class InputMethodSession {
  public:
    InputMethodSession(std::string display, RunLoop& tapLoop, InputMethodWatch::EngineListener engineChanged,
                       InputMethodWatch::Happened happened)
        : display_(std::move(display)),
          bus_(loop_),
          ibus_(loop_, keys_),
          fcitx_(loop_, bus_, keys_),
          engineChanged_(std::move(engineChanged)),
          tapLoop_(tapLoop) {
        bus_.heard = [this](DBusMessage& signal) { hear(signal); };
        keys_.happened = [this, happened = std::move(happened)] { tapLoop_.perform(happened); };
        ibus_.engineChanged = [this](const std::string& name) {
            tellEngine(ibusEngine_, name.empty() ? name : "ibus:" + name);
        };
        fcitx_.engineChanged = [this](const std::string& name) {
            tellEngine(fcitxEngine_, name.empty() ? name : "fcitx:" + name);
        };
    }

    void run() {
        if (!bus_.connect(sessionBusAddress())) return;
        for (const char* service : {Ibus, FcitxConnection::Service}) {
            bus_.listen(std::string("type='signal',sender='org.freedesktop.DBus',member='NameOwnerChanged',arg0='") +
                        service + "'");
        }
        ibus_.connect(ibusAddress(display_));
        bus_.call(newCall({DBUS_SERVICE_DBUS, DBUS_PATH_DBUS, DBUS_INTERFACE_DBUS}, "NameHasOwner",
                          {std::string(FcitxConnection::Service)}),
                  [this](const BusAnswer& answer) {
                      if (answer.values().boolean().value_or(false)) fcitx_.connect(sessionBusAddress());
                  });
        loop_.run();
    }
    // From any thread.
    void end() {
        tapLoop_.cut();
        loop_.stop();
    }

    ComposedKeys& keys() { return keys_; }  // which may be used on the tap thread

  private:
    // IBus comes to the session's bus when its own is there. Fcitx stands in for it there too, and says nothing.
    void hear(DBusMessage& signal) {
        if (dbus_message_is_signal(&signal, DBUS_INTERFACE_DBUS, "NameOwnerChanged") == 0) return;
        BusReader values(&signal);
        const std::string service = values.string().value_or("");
        values.string();
        const bool hasCome = !values.string().value_or("").empty();
        if (service == FcitxConnection::Service) {
            hasCome ? fcitx_.connect(sessionBusAddress()) : fcitx_.disconnect();
        } else if (hasCome) {
            ibus_.connect(ibusAddress(display_));
        }
    }

    // Of one of them.
    void tellEngine(std::string& engine, const std::string& identifier) {
        engine = identifier;
        const std::string& inForce = fcitxEngine_.empty() ? ibusEngine_ : fcitxEngine_;
        if (inForce == told_) return;
        told_ = inForce;
        tapLoop_.perform([tell = engineChanged_, identifier = inForce] { tell(identifier); });
    }

    const std::string display_;
    PollRunLoop loop_;
    ServiceBus bus_;
    ComposedKeys keys_;
    IbusConnection ibus_;
    FcitxConnection fcitx_;
    std::string ibusEngine_;  // their identifiers, empty for none
    std::string fcitxEngine_;
    std::string told_;
    const InputMethodWatch::EngineListener engineChanged_;
    MainLoopLink tapLoop_;
};

InputMethodWatch::InputMethodWatch(const std::string& display, RunLoop& loop, EngineListener engineChanged,
                                   Happened happened)
    : thread_(std::make_shared<InputMethodSession>(display, loop, std::move(engineChanged), std::move(happened))) {}

InputMethodWatch::~InputMethodWatch() = default;

InputMethod& InputMethodWatch::inputMethod() {
    return thread_->keys();
}

}  // namespace plume

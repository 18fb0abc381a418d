// What Fcitx says to programs on the session's bus: which engine works in them.
//
// It tells each program alone which engine works in it, so it is heard by a connection that only listens. That
// connection exists while Fcitx does, and gets nothing but what is named in its rules.
#pragma once

#include <functional>
#include <string>

#include "ports/dbus/FcitxKeys.h"
#include "ports/dbus/ServiceBus.h"

namespace plume {

// Belongs to the thread of its loop, which outlives it, as the connection to the session's bus and
// the keys do.
class FcitxConnection {
  public:
    static constexpr const char* Service = "org.fcitx.Fcitx5";

    FcitxConnection(PollRunLoop& loop, ServiceBus& session, ComposedKeys& keys);

    // The engine that works in the field with the focus, by its name; empty when there is none, when it only stands for
    // a keyboard layout, where the program does not talk to Fcitx on the bus, or when Fcitx has gone.
    std::function<void(const std::string& name)> engineChanged;

    // Fcitx has come, to the bus at this address. What is in force is told as soon as it has said it.
    void connect(const std::string& address);
    // It has gone.
    void disconnect();

  private:
    void askForEngine();
    void overhear(DBusMessage& message);
    void setEngine(const std::string& name);

    ServiceBus& session_;
    ServiceBus monitor_;
    FcitxKeys keys_;
    std::string address_;
    std::string focus_;  // the field that has it, by its path
};

}  // namespace plume

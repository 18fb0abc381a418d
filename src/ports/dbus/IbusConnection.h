// What IBus says on the bus that it has of its own: which engine works, and what becomes of keys.
//
// IBus sends what it sends to programs to others, too, who ask for it. That is done only while an engine works that
// turns keys into other text. What is heard then was typed: it is handed on, and nothing of it is kept.
#pragma once

#include <cstdint>
#include <functional>
#include <string>

#include "ports/dbus/ComposedKeys.h"
#include "ports/dbus/ServiceBus.h"

namespace plume {

// Belongs to the thread of its loop, which outlives it, as the keys do.
class IbusConnection {
  public:
    IbusConnection(PollRunLoop& loop, ComposedKeys& keys);

    // The engine in force, by its name; empty when there is none, when it only stands for a keyboard layout, or when
    // IBus has gone.
    std::function<void(const std::string& name)> engineChanged;

    // Instead of an earlier connection. What is in force is told as soon as IBus has said it.
    void connect(const std::string& address);
    bool isConnected() const { return bus_.isConnected(); }

  private:
    void hear(DBusMessage& message);
    void askForEngine();
    void setEngine(const std::string& name);
    void overhear(DBusMessage& message);
    void overhearCall(DBusMessage& call);
    void overhearSignal(DBusMessage& signal);
    void overhearReply(DBusMessage& reply);
    void forwardKey(DBusMessage& signal);

    ComposedKeys& keys_;
    ServiceBus bus_;
    bool composes_ = false;
    std::string focus_;          // the input context that has it, by its path
    std::uint32_t keyCall_ = 0;  // the serial by which a program gave the key that was announced
    std::string keyProgram_;     // and that program
    std::uint32_t keyCode_ = 0;
};

}  // namespace plume

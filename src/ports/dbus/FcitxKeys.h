// What becomes of the keys that programs give to Fcitx, as it tells them on the session's bus.
//
// Heard by a connection that only listens, and that exists only while an engine works that turns keys into other text.
// What is heard was typed: it is handed on, and nothing of it is kept.
#pragma once

#include <cstdint>
#include <string>

#include "ports/dbus/ComposedKeys.h"
#include "ports/dbus/ServiceBus.h"

namespace plume {

// Belongs to the thread of its loop, which outlives it, as the connection to the session's bus and the keys do.
class FcitxKeys {
  public:
    FcitxKeys(PollRunLoop& loop, ServiceBus& session, ComposedKeys& keys);

    // The engine works in the field with the focus. Keys are its own once they are heard, which lasts when it is so
    // already.
    void connect(const std::string& address);
    // It does so no more. Keys that are on their way to it are heard for a moment yet.
    void end();
    // Fcitx has gone.
    void disconnect();

  private:
    // The key that was announced, as the program gave it to Fcitx.
    struct Key {
        std::string program;
        std::uint32_t call = 0;  // its serial
        std::uint32_t symbol = 0;
        bool isAnswered = false;
    };

    void overhear(DBusMessage& message);
    void overhearCall(DBusMessage& call);
    void overhearSignal(DBusMessage& signal);
    void overhearReply(DBusMessage& reply);
    void forwardKey(DBusMessage& signal);

    PollRunLoop& loop_;
    ServiceBus& session_;
    ServiceBus monitor_;
    ComposedKeys& keys_;
    std::string focus_;      // the field that keys went to last, by its path
    bool composes_ = false;  // the engine that works
    bool isHearing_ = false;
    Timer goodbye_;
    Key key_;
    int unansweredPings_ = 0;
};

}  // namespace plume

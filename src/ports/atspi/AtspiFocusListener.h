// Hears from one program which part gets the focus: for programs whose parts are too many to walk through, which
// browsers have. Belongs to the accessibility thread.
//
// A connection of its own, because who listens is taken for a screen reader by every program (see AtspiBus.h) until
// that connection is closed.
#pragma once

#include <functional>
#include <string>
#include <utility>

#include "ports/atspi/AtspiBus.h"
#include "ports/posix/PollRunLoop.h"

namespace plume {

class AtspiFocusListener {
  public:
    using Heard = std::function<void(const AtspiPart& part)>;

    AtspiFocusListener(PollRunLoop& loop, Heard heard) : loop_(loop), heard_(std::move(heard)) {}
    ~AtspiFocusListener() { stop(); }
    AtspiFocusListener(const AtspiFocusListener&) = delete;
    AtspiFocusListener& operator=(const AtspiFocusListener&) = delete;

    // To that program instead of another one. `address` is the bus's.
    void listenTo(const std::string& program, const std::string& address);
    void stop();

  private:
    bool begin(const std::string& program, const std::string& address);
    void takeMessages();
    void take(DBusMessage* message) const;

    PollRunLoop& loop_;
    const Heard heard_;
    AtspiBus bus_;
    Subscription source_;
    std::string program_;  // listened to; empty when none is
};

}  // namespace plume

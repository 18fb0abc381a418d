// The two ways to the part that has the focus: walking through the active window, and hearing from a program whose
// parts are too many to walk through, which browsers have. Both belong to the accessibility thread.
#pragma once

#include <sys/types.h>

#include <functional>
#include <string>
#include <utility>
#include <vector>

#include "ports/atspi/AtspiParts.h"
#include "ports/posix/PollRunLoop.h"

namespace plume {

class AtspiFocusFinder {
  public:
    explicit AtspiFocusFinder(AtspiBus& bus) : bus_(bus) {}

    struct Found {
        AtspiPart part;       // none when nothing below has the focus
        std::string program;  // the one in front, also when no window of it says that it is active
        pid_t process = 0;    // as the bus sees it
    };
    // In the program with that process. When none has it (a sandbox has numbers of its own) or it is 0, in the program
    // whose window says that it is the active one.
    Found find(pid_t process);
    // What a program of the bus is made with; empty when it does not tell.
    const std::string& toolkitOf(const std::string& program);
    // Chromium shows its windows without their parts until somebody asks for the relations between them.
    void askForParts(const std::string& program);

  private:
    struct Program {
        AtspiPart root;
        pid_t process = 0;
        std::string toolkit;
        bool toldToolkit = false;
    };

    void updatePrograms();
    Program programAt(const AtspiPart& root);
    bool findIn(const Program& program, bool isInFront, Found& found);
    AtspiPart focusedBelow(const AtspiPart& part, const AtspiStates& states, int depth, int& left);

    AtspiBus& bus_;
    std::vector<Program> programs_;
    int connection_ = 0;  // the one on which they were found
};

// Hears from one program which part gets the focus. A connection of its own, because who listens is taken for a screen
// reader by every program (see AtspiBus.h) until that connection is closed.
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
    bool isListening() const { return !program_.empty(); }

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

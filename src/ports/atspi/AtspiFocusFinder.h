// Finds the part that has the focus by walking through the active window. Belongs to the accessibility thread.
#pragma once

#include <sys/types.h>

#include <string>
#include <vector>

#include "ports/atspi/AtspiParts.h"

namespace plume {

class AtspiFocusFinder {
  public:
    explicit AtspiFocusFinder(AtspiBus& bus) : bus_(bus) {}

    struct Found {
        AtspiPart part;  // none when nothing below has the focus
        std::string program;
        pid_t process = 0;  // as the bus sees it
    };
    // In the program with that process. When none has it (a sandbox has numbers of its own) or it is 0, in the program
    // whose window says that it is the active one.
    Found find(pid_t process);
    // What a program of the bus is made with; empty when it does not tell.
    const std::string& toolkitOf(const std::string& program);

  private:
    struct Program {
        AtspiPart root;
        pid_t process = 0;
        std::string toolkit;
        bool toldToolkit = false;
    };

    void updatePrograms();
    Program programAt(const AtspiPart& root);
    bool findIn(const Program& program, Found& found);
    AtspiPart focusedBelow(const AtspiPart& part, const AtspiStates& states, int depth, int& left);

    AtspiBus& bus_;
    std::vector<Program> programs_;
    int connection_ = 0;  // the one on which they were found
};

}  // namespace plume

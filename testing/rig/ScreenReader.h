#pragma once

#include <sys/types.h>

#include <optional>
#include <string>

#include "platform/Accessibility.h"
#include "ports/atspi/AtspiParts.h"

namespace plume::rig {

// Finds parts of a program's windows by the names that a screen reader says, on the accessibility bus. Asks for what is
// there now and waits for nothing: a window that has just come may not be told yet. One thread.
class ScreenReader {
  public:
    // In the session of this process; throws RigError.
    ScreenReader();

    // Where the first shown part of that name is on the screen, labels and frames aside; nothing when there is none.
    std::optional<Rectangle> place(pid_t process, const std::string& name);
    // What stands in it.
    std::optional<std::string> text(pid_t process, const std::string& name);

  private:
    AtspiPart find(pid_t process, const std::string& name);
    AtspiPart findIn(const AtspiPart& part, const std::string& name);
    bool isCalled(const AtspiPart& part, const std::string& name);

    AtspiBus bus_;
};

}  // namespace plume::rig

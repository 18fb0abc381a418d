// The small window that is clicked to take the keyboard away from a virtual machine.
//
// Implemented by the application; belongs to the main thread.
#pragma once

#include "platform/Accessibility.h"

namespace plume {

class VMHelperController {
  public:
    virtual ~VMHelperController() = default;
    // In front of everything, its middle at this place (from the top left of the main screen).
    virtual void show(Point centre) = 0;
    virtual void hide() = 0;
};

}  // namespace plume

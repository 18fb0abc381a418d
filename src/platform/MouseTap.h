// Hearing clicks, without a say in them.
//
// Belongs to the tap thread, where the listener is called.
#pragma once

#include <functional>

#include "Foundation/Result.h"
#include "platform/Accessibility.h"

namespace plume {

class MouseTap {
  public:
    // A button went down here, from the top left of the main screen.
    using Listener = std::function<void(Point location)>;

    virtual ~MouseTap() = default;
    virtual Result<void> create(Listener listener) = 0;
    virtual bool exists() const = 0;
    virtual void remove() = 0;
};

}  // namespace plume

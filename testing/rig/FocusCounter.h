#pragma once

#include "testing/rig/XClient.h"

namespace plume::rig {

// Counts the focus events that the server sends to a window and to everything in it, those that toolkits leave out
// included: a keyboard grab by somebody else is one such event, and enough to close a program's completion list.
class FocusCounter {
  public:
    struct Counts {
        int in = 0;
        int out = 0;
        int byGrab = 0;  // how many of them were caused by a grab or its end
        friend bool operator==(const Counts&, const Counts&) = default;
    };

    // Watches the windows that exist now, once no focus moves any more. One thread; the display outlives the counter.
    FocusCounter(const std::string& display, xcb_window_t window);

    // What has been sent since the last call, the core protocol's events and those of the input extension.
    Counts takeCore();
    Counts takeInputExtension();

  private:
    void awaitQuiet();
    void drain();

    XClient client_;
    std::uint8_t extensionOpcode_;
    Counts core_;
    Counts inputExtension_;
};

}  // namespace plume::rig

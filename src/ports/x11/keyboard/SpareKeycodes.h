// Key codes that no key of the layout has, assigned to characters that no key of the layout types.
//
// Programs read the symbols of a key code some time after the key was sent, so a key code keeps its symbol for a while
// after its last use; the one that was used longest ago is assigned first. Keeps account only: knows no display.
#pragma once

#include <xcb/xcb.h>

#include <cstddef>
#include <limits>
#include <set>
#include <vector>

namespace plume {

class SpareKeycodes {
  public:
    // Seconds that a key code rests after its last use before it becomes another character.
    static constexpr double Rest = 0.5;
    static constexpr double Never = std::numeric_limits<double>::infinity();

    struct Assignment {
        xcb_keycode_t keycode = 0;
        char32_t character = 0;  // 0: none
        double lastUse = -Never;
        bool written = true;  // whether the server knows
    };

    // These there are, none assigned. Those that there were before keep the time of their last use.
    void reset(const std::vector<xcb_keycode_t>& keycodes);

    // The key code of the character, used now; assigned to it if need be. 0 when none is free.
    xcb_keycode_t take(char32_t character, double now);
    // All that were taken at `since` or later were used until now.
    void extend(double since, double now);

    // Whether all of these could be taken.
    bool canTake(const std::set<char32_t>& characters, double now) const;
    // When take() can assign one again; Never when there are no key codes.
    double nextFree() const;

    std::vector<Assignment>& assignments() { return assignments_; }
    const std::vector<Assignment>& assignments() const { return assignments_; }

  private:
    static bool isFree(const Assignment& assignment, double now) { return assignment.lastUse + Rest <= now; }

    std::vector<Assignment> assignments_;
};

}  // namespace plume

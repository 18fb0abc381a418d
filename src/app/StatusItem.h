// The icon by which Plume is seen in the session, and what it shows.
//
// Owned by the application's delegate; belongs to the main thread. A desktop that has no place for icons shows none,
// and one whose place comes late, goes or comes back is followed.
#pragma once

#include <string>

namespace plume {

struct Status {
    bool isEnabled = true;
    bool secureInput = false;
    std::u16string secureInputStatus = {};  // the sentence about it
    bool keyboardIsLost = false;            // nothing is heard until somebody or the clock tries again

    bool operator==(const Status&) const = default;
};

class StatusItem {
  public:
    virtual ~StatusItem() = default;
    // Takes effect at once; also while the menu is open.
    virtual void setStatus(const Status& status) = 0;
    // There is a place for the icon, and it is shown there.
    virtual bool isVisible() const = 0;
};

}  // namespace plume

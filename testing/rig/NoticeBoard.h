#pragma once

#include <cstdint>
#include <map>
#include <mutex>
#include <string>

#include "testing/rig/BusService.h"

namespace plume::rig {

// The desktop's service for notices, in the process of the test: shows them to nobody.
class NoticeBoard {
  public:
    // On the session's bus of this process; throws RigError.
    NoticeBoard();

    // What the notice with that title says; nothing when none is shown.
    std::optional<std::string> body(const std::string& title) const;
    // The user presses a button of it; nothing happens when there is no such button.
    void press(const std::string& title, const std::string& label);

  private:
    struct Shown {
        std::uint32_t number = 0;
        std::string body;
        std::map<std::string, std::string> buttons;  // names by labels
    };

    BusMessage answer(DBusMessage* call);
    std::uint32_t keep(DBusMessage* call);

    mutable std::mutex mutex_;
    std::map<std::string, Shown> shown_;  // by their titles; guarded by mutex_
    std::uint32_t last_ = 0;
    BusService service_;
};

}  // namespace plume::rig

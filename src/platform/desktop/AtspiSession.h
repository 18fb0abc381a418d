// All that the accessibility thread shares with other threads, and what it runs.
#pragma once

#include <atomic>
#include <memory>

#include "platform/desktop/AtspiAccessibility.h"
#include "platform/desktop/AtspiFocus.h"
#include "platform/desktop/AtspiQueue.h"

namespace plume {

class AtspiSession {
  public:
    const std::shared_ptr<AtspiQueue>& queue() const { return queue_; }
    const AtspiFocus& focus() const { return focus_; }
    AccessibilityStatus status() const { return status_; }

    // The thread itself, until the queue ends.
    void run();

  private:
    bool connect();

    const std::shared_ptr<AtspiQueue> queue_ = std::make_shared<AtspiQueue>();
    AtspiFocus focus_;
    std::atomic<AccessibilityStatus> status_ = AccessibilityStatus::Starting;
};

}  // namespace plume

// Notices that stay until the user presses one of their buttons. On one thread only.
#pragma once

#include <algorithm>
#include <string_view>
#include <utility>
#include <vector>

#include "platform/Notices.h"

namespace plume {

class SimulatedNotices final : public Notices {
  public:
    void show(Notice notice) override { shown_.push_back(std::move(notice)); }
    const std::vector<Notice>& shown() const { return shown_; }

    // The user presses the button with that label of the notice with that title; nothing happens when there is none.
    void press(std::string_view title, std::string_view label) {
        const auto notice = std::ranges::find(shown_, title, &Notice::title);
        if (notice == shown_.end()) return;
        const auto button = std::ranges::find(notice->buttons, label, &Notice::Button::label);
        if (button == notice->buttons.end()) return;
        const auto pressed = std::move(button->pressed);
        shown_.erase(notice);
        pressed();
    }

  private:
    std::vector<Notice> shown_;
};

}  // namespace plume

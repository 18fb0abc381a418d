// A diagnostic: reads the rows of a two-column list in the application in front by copying its cells one by one.
//
// Owned by the input service; belongs to the tap thread. Every action is followed by a pause on the run loop.
#pragma once

#include <functional>
#include <optional>
#include <string>

#include "platform/Pasteboard.h"
#include "platform/RunLoop.h"

namespace plume {

class KeySender;

class AclExport {
  public:
    // Nothing is owned. `copy` presses what copies.
    AclExport(KeySender& sender, const Pasteboard& pasteboard, RunLoop& runLoop, std::function<void()> copy);

    // From the selected row down until a row's first cell is that of the row before or cannot be read. Does nothing
    // while it runs.
    void start();
    // One cell a line; nothing before the end.
    const std::optional<std::u16string>& text() const { return text_; }

  private:
    void copyFirstCell();
    void readFirstCell();
    void copySecondCell();
    void readSecondCell();
    void nextRow();
    void after(void (AclExport::*next)());

    KeySender& sender_;
    const Pasteboard& pasteboard_;
    RunLoop& runLoop_;
    std::function<void()> copy_;
    Timer next_;
    bool running_ = false;
    std::optional<std::u16string> previous_;
    std::u16string collected_;
    std::optional<std::u16string> text_;
};

}  // namespace plume

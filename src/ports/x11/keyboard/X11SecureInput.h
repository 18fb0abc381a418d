// Whether another program has grabbed the keyboard, or the focused field takes a password.
//
// Belongs to the main thread and has a connection of its own.
#pragma once

#include <functional>
#include <memory>
#include <string>

#include "platform/SecureInput.h"
#include "ports/x11/XcbConnection.h"

namespace plume {

class X11SecureInput final : public SecureInput {
  public:
    // `focusIsPassword` tells whether the focused field hides what is typed, from what is already known of it.
    static Result<std::unique_ptr<X11SecureInput>> open(const std::string& display,
                                                        std::function<bool()> focusIsPassword);

    bool isSecureEventInputEnabled() const override;

  private:
    X11SecureInput(std::unique_ptr<XcbConnection> connection, std::function<bool()> focusIsPassword);
    bool isKeyboardHeld() const;

    const std::unique_ptr<XcbConnection> connection_;
    const std::function<bool()> focusIsPassword_;
    const xcb_window_t neverShown_;
};

}  // namespace plume

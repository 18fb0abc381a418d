// Whether some program keeps what is typed to itself: a password is being entered, or the keyboard is held.
#pragma once

namespace plume {

class SecureInput {
  public:
    virtual ~SecureInput() = default;
    // Asked every few seconds on the main thread; may cost a short question to the system, never a wait for a program.
    virtual bool isSecureEventInputEnabled() const = 0;
};

}  // namespace plume

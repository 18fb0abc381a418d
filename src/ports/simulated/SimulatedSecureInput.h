// Secure input that is on when it is told to be.
#pragma once

#include "platform/SecureInput.h"

namespace plume {

class SimulatedSecureInput final : public SecureInput {
  public:
    bool isSecureEventInputEnabled() const override { return enabled_; }
    void setEnabled(bool enabled) { enabled_ = enabled; }

  private:
    bool enabled_ = false;
};

}  // namespace plume

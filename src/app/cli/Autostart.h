// Whether Plume is started when the user logs in: a desktop file among the session's own.
#pragma once

#include "Foundation/Result.h"
#include "platform/Files.h"

namespace plume {

class Autostart {
  public:
    // Outlives it.
    explicit Autostart(Files& files) : files_(files) {}

    bool isOn() const;
    // The error names the file.
    Result<void> set(bool on);

  private:
    Files& files_;
};

}  // namespace plume

// The system's sounds, by name ("Pop").
#pragma once

#include <string_view>

namespace plume {

class Sounds {
  public:
    virtual ~Sounds() = default;
    // Starts the sound and returns at once; one that is missing is a beep, and without any device nothing. From any
    // thread.
    virtual void play(std::string_view name) = 0;
};

}  // namespace plume

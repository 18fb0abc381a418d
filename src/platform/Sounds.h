// Sounds by name ("Pop").
#pragma once

#include <string_view>

namespace plume {

class Sounds {
  public:
    virtual ~Sounds() = default;
    // Both start the sound and return at once; without any device there is none. From any thread.
    // One that is missing is silence.
    virtual void play(std::string_view name) = 0;
    // One that is missing is a beep: for what the user must not miss.
    virtual void playOrBeep(std::string_view name) = 0;
};

}  // namespace plume

// Sounds that nobody hears, written down in order. On one thread only.
#pragma once

#include <string>
#include <vector>

#include "platform/Sounds.h"

namespace plume {

class SimulatedSounds final : public Sounds {
  public:
    void play(std::string_view name) override { played_.emplace_back(name); }
    void playOrBeep(std::string_view name) override { play(name); }
    const std::vector<std::string>& played() const { return played_; }

  private:
    std::vector<std::string> played_;
};

}  // namespace plume

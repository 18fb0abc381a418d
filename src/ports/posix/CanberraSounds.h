// Plume's own sounds and those of the desktop's sound theme, played by libcanberra.
//
// A thread of its own plays them, from the first sound on: a sound server that hangs delays nobody, and without a sound
// nothing is opened.
#pragma once

#include <filesystem>
#include <memory>

#include "platform/Sounds.h"

namespace plume {

class CanberraSounds final : public Sounds {
  public:
    // The folder with Plume's own sounds; where it lacks one, the theme's are played.
    explicit CanberraSounds(std::filesystem::path ownSounds);
    // Sounds that were not started yet are dropped. Never waits for the sound server.
    ~CanberraSounds() override;
    CanberraSounds(const CanberraSounds&) = delete;
    CanberraSounds& operator=(const CanberraSounds&) = delete;

    void play(std::string_view name) override;
    void playOrBeep(std::string_view name) override;

  private:
    class Player;
    std::shared_ptr<Player> player_;  // shared with the thread, which may outlive this object
};

}  // namespace plume

// Writes sentences for the user and for the log, from any thread.
#pragma once

#include <mutex>
#include <ostream>
#include <string>

namespace plume {

class Voice {
  public:
    // Outlives it.
    explicit Voice(std::ostream& stream) : stream_(stream) {}
    void say(const std::string& sentence) {
        const std::lock_guard lock(mutex_);
        stream_ << "plume: " << sentence << std::endl;
    }

  private:
    std::mutex mutex_;
    std::ostream& stream_;
};

}  // namespace plume

#include "ports/posix/CanberraSounds.h"

#include <canberra.h>

#include <array>
#include <condition_variable>
#include <cstdlib>
#include <deque>
#include <filesystem>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <system_error>
#include <thread>

namespace plume {

namespace {

struct EventName {
    std::string_view sound;
    const char* event;
};

// What comes closest in the freedesktop sound theme to the sounds that Plume knows by name.
constexpr std::array EventNames = {
    EventName{"Basso", "dialog-error"}, EventName{"Funk", "dialog-warning"}, EventName{"Glass", "complete"},
    EventName{"Ping", "bell"},          EventName{"Pop", "message"},         EventName{"Tink", "button-pressed"},
};
constexpr const char* Beep = "bell";

constexpr std::size_t MostWaiting = 4;

struct ContextDestroy {
    void operator()(ca_context* context) const { ca_context_destroy(context); }
};

std::string eventOf(std::string_view sound) {
    for (const EventName& name : EventNames) {
        if (name.sound == sound) return name.event;
    }
    return std::string(sound);
}

// Without any, libcanberra's ALSA driver would write lines of complaints about it to standard error.
bool hasSoundDevice() {
    std::error_code ignored;
    const char* const runtime = std::getenv("XDG_RUNTIME_DIR");
    return std::getenv("PULSE_SERVER") || std::filesystem::exists("/dev/snd", ignored) ||
           (runtime && std::filesystem::exists(std::filesystem::path(runtime) / "pulse", ignored));
}

int start(ca_context* context, const char* event) {
    return ca_context_play(context, 0, CA_PROP_EVENT_ID, event, CA_PROP_CANBERRA_CACHE_CONTROL, "volatile", nullptr);
}

}  // namespace

class CanberraSounds::Player {
  public:
    void play(const std::shared_ptr<Player>& self, std::string_view name) {
        const std::scoped_lock lock(mutex_);
        // A server that hangs must not make sounds pile up and all play later.
        if (waiting_.size() >= MostWaiting) return;
        waiting_.emplace_back(name);
        if (!isRunning_) std::thread([self] { self->run(); }).detach();
        isRunning_ = true;
        changed_.notify_one();
    }

    void end() {
        const std::scoped_lock lock(mutex_);
        ended_ = true;
        changed_.notify_one();
    }

  private:
    void run() {
        while (const auto name = next()) playNow(*name);
        context_.reset();
    }

    std::optional<std::string> next() {
        std::unique_lock lock(mutex_);
        changed_.wait(lock, [this] { return ended_ || !waiting_.empty(); });
        if (ended_) return std::nullopt;
        std::string name = std::move(waiting_.front());
        waiting_.pop_front();
        return name;
    }

    void playNow(const std::string& name) {
        if (!context_) {
            if (!hasSoundDevice()) return;
            ca_context* context = nullptr;
            if (ca_context_create(&context) != CA_SUCCESS) return;
            context_.reset(context);
            ca_context_change_props(context, CA_PROP_APPLICATION_NAME, "Plume", nullptr);
        }
        // Every other failure means that there is no device, or that the user wants no sounds.
        if (start(context_.get(), eventOf(name).c_str()) == CA_ERROR_NOTFOUND) start(context_.get(), Beep);
    }

    std::unique_ptr<ca_context, ContextDestroy> context_;  // the thread's own
    std::mutex mutex_;                                     // over all that follows
    std::condition_variable changed_;
    std::deque<std::string> waiting_;
    bool isRunning_ = false;
    bool ended_ = false;
};

CanberraSounds::CanberraSounds() : player_(std::make_shared<Player>()) {}

CanberraSounds::~CanberraSounds() {
    player_->end();
}

void CanberraSounds::play(std::string_view name) {
    player_->play(player_, name);
}

}  // namespace plume

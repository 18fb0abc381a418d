#include "ports/posix/CanberraSounds.h"

#include <canberra.h>

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
#include <utility>

#include "ports/posix/SoundSource.h"

namespace plume {

namespace {

constexpr const char* Beep = "bell";

constexpr std::size_t MostWaiting = 4;

struct ContextDestroy {
    void operator()(ca_context* context) const { ca_context_destroy(context); }
};

// Without any, libcanberra's ALSA driver would write lines of complaints about it to standard error.
bool hasSoundDevice() {
    std::error_code ignored;
    const char* const runtime = std::getenv("XDG_RUNTIME_DIR");
    return std::getenv("PULSE_SERVER") || std::filesystem::exists("/dev/snd", ignored) ||
           (runtime && std::filesystem::exists(std::filesystem::path(runtime) / "pulse", ignored));
}

struct Order {
    std::string name;
    bool beepsInstead;  // where the sound is missing
};

int start(ca_context* context, const SoundSource& source) {
    const char* const property = source.file.empty() ? CA_PROP_EVENT_ID : CA_PROP_MEDIA_FILENAME;
    const std::string& value = source.file.empty() ? source.event : source.file.native();
    return ca_context_play(context, 0, property, value.c_str(), CA_PROP_MEDIA_ROLE, "event",
                           CA_PROP_CANBERRA_CACHE_CONTROL, "volatile", nullptr);
}

}  // namespace

class CanberraSounds::Player {
  public:
    explicit Player(std::filesystem::path ownSounds) : ownSounds_(std::move(ownSounds)) {}

    void play(const std::shared_ptr<Player>& self, std::string_view name, bool beepsInstead) {
        const std::scoped_lock lock(mutex_);
        // A server that hangs must not make sounds pile up and all play later.
        if (waiting_.size() >= MostWaiting) return;
        waiting_.push_back({std::string(name), beepsInstead});
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
        while (const auto order = next()) playNow(*order);
        context_.reset();
    }

    std::optional<Order> next() {
        std::unique_lock lock(mutex_);
        changed_.wait(lock, [this] { return ended_ || !waiting_.empty(); });
        if (ended_) return std::nullopt;
        Order order = std::move(waiting_.front());
        waiting_.pop_front();
        return order;
    }

    void playNow(const Order& order) {
        if (!context_) {
            if (!hasSoundDevice()) return;
            ca_context* context = nullptr;
            if (ca_context_create(&context) != CA_SUCCESS) return;
            context_.reset(context);
            ca_context_change_props(context, CA_PROP_APPLICATION_NAME, "Plume", nullptr);
        }
        // Every other failure means that there is no device, or that the user wants no sounds.
        const bool isMissing = start(context_.get(), soundSourceOf(order.name, ownSounds_)) == CA_ERROR_NOTFOUND;
        if (isMissing && order.beepsInstead) start(context_.get(), {.file = {}, .event = Beep});
    }

    const std::filesystem::path ownSounds_;
    std::unique_ptr<ca_context, ContextDestroy> context_;  // the thread's own
    std::mutex mutex_;                                     // over all that follows
    std::condition_variable changed_;
    std::deque<Order> waiting_;
    bool isRunning_ = false;
    bool ended_ = false;
};

CanberraSounds::CanberraSounds(std::filesystem::path ownSounds)
    : player_(std::make_shared<Player>(std::move(ownSounds))) {}

CanberraSounds::~CanberraSounds() {
    player_->end();
}

void CanberraSounds::play(std::string_view name) {
    player_->play(player_, name, false);
}

void CanberraSounds::playOrBeep(std::string_view name) {
    player_->play(player_, name, true);
}

}  // namespace plume

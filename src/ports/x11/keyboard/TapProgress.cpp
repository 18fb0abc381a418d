#include "ports/x11/keyboard/TapProgress.h"

#include <sys/mman.h>
#include <unistd.h>

#include <new>

namespace plume {

KeyMoment KeyMoments::next(std::uint32_t time) {
    latest_ = {time, time == latest_.time ? latest_.number + 1 : 1};
    return latest_;
}

TapProgress::TapProgress() : memory_(memfd_create("keys", MFD_CLOEXEC)) {
    if (!memory_.isOpen() || ftruncate(memory_.get(), sizeof(Words)) != 0) {
        memory_.close();
        return;
    }
    map();
    if (words_ != &own_) new (words_) Words;
}

TapProgress::TapProgress(int descriptor) : memory_(descriptor) {
    map();
}

TapProgress::~TapProgress() {
    if (words_ != &own_) munmap(words_, sizeof(Words));
}

void TapProgress::map() {
    void* const memory = mmap(nullptr, sizeof(Words), PROT_READ | PROT_WRITE, MAP_SHARED, memory_.get(), 0);
    if (memory == MAP_FAILED) return memory_.close();
    words_ = static_cast<Words*>(memory);
}

void TapProgress::begin() {
    words_->handled.store(0);
    words_->takenOver.store(0);
}

void TapProgress::setHandled(KeyMoment key) {
    words_->handled.store((std::uint64_t{key.time} << 32) | key.number);
}

bool TapProgress::hasHandled(KeyMoment key) const {
    if (words_ == &own_) return true;
    const std::uint64_t handled = words_->handled.load();
    const auto time = static_cast<std::uint32_t>(handled >> 32);
    if (handled == 0) return false;
    // The server's time starts anew every 49 days.
    if (key.time != time) return static_cast<std::int32_t>(key.time - time) < 0;
    return key.number <= static_cast<std::uint32_t>(handled);
}

}  // namespace plume

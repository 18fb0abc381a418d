#include "input/AclExport.h"

#include <utility>

#include "Foundation/KeyCode.h"
#include "input/delivery/KeySender.h"

namespace plume {

namespace {

constexpr double Pause = 0.05;  // seconds after every action
constexpr std::size_t InitialCapacity = 10000;

}  // namespace

AclExport::AclExport(KeySender& sender, const Pasteboard& pasteboard, RunLoop& runLoop, std::function<void()> copy)
    : sender_(sender), pasteboard_(pasteboard), runLoop_(runLoop), copy_(std::move(copy)) {}

void AclExport::after(void (AclExport::*next)()) {
    next_ = runLoop_.performAfterDelay(Pause, [this, next] { (this->*next)(); });
}

void AclExport::start() {
    if (running_) return;
    running_ = true;
    text_.reset();
    previous_.reset();
    collected_.clear();
    collected_.reserve(InitialCapacity);
    copyFirstCell();
}

void AclExport::copyFirstCell() {
    copy_();
    after(&AclExport::readFirstCell);
}

void AclExport::readFirstCell() {
    std::optional<std::u16string> cell = pasteboard_.string();
    if (!cell || cell == previous_) {
        text_ = std::move(collected_);
        running_ = false;
        return;
    }
    collected_.append(*cell).append(u"\n");
    previous_ = std::move(cell);
    sender_.sendKey(KeyCode::Tab);
    after(&AclExport::copySecondCell);
}

void AclExport::copySecondCell() {
    copy_();
    after(&AclExport::readSecondCell);
}

void AclExport::readSecondCell() {
    collected_.append(pasteboard_.string().value_or(u"")).append(u"\n");
    sender_.sendShiftTab();
    after(&AclExport::nextRow);
}

void AclExport::nextRow() {
    sender_.sendKey(KeyCode::Down);
    after(&AclExport::copyFirstCell);
}

}  // namespace plume

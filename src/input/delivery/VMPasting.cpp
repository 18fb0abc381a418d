#include "input/delivery/VMPasting.h"

#include <utility>

namespace plume {

namespace {

// Seconds, each from the start of the step that it belongs to.
constexpr double ActivationDelay = 0.2;
constexpr double HelperClickDelay = 0.2;
constexpr double HelperHideDelay = 0.3;
constexpr double GiveWayDelay = 0.5;
constexpr double MachineClickDelay = 0.1;
constexpr double KeystrokeDelay = 0.2;
constexpr double KeystrokeDelayBehindBackspaces = 0.4;

}  // namespace

VMPasting::VMPasting(EventPoster& poster, ProcessManager& processManager, RunLoop& tapLoop, RunLoop& mainLoop,
                     VMHelperController* helper)
    : poster_(poster), processManager_(processManager), tapLoop_(tapLoop), mainLoop_(mainLoop), helper_(helper) {}

void VMPasting::after(double delay, std::function<void()> call) {
    timers_.push_back(tapLoop_.performAfterDelay(delay, std::move(call)));
}

void VMPasting::start(Order order) {
    ++ordersToCome_;
    auto shared = std::make_shared<const Order>(std::move(order));
    after(ActivationDelay, [this, shared = std::move(shared)] {
        processManager_.bringToFront(processManager_.currentProcess());
        showVMHelper(shared);
    });
}

void VMPasting::showVMHelper(const std::shared_ptr<const Order>& order) {
    if (order->setting->has(InputFlag::ClickAtVMHelper)) {
        if (helper_) mainLoop_.perform([helper = helper_, at = poster_.pointerLocation()] { helper->show(at); });
        after(HelperClickDelay, [this] { sendMouseClick(); });
        after(HelperHideDelay, [this] {
            if (helper_) mainLoop_.perform([helper = helper_] { helper->hide(); });
        });
    }
    after(GiveWayDelay, [this, order] { activateAndPasteToVM(*order); });
}

void VMPasting::activateAndPasteToVM(const Order& order) {
    processManager_.bringToFront(order.target);
    if (order.setting->has(InputFlag::ClickAtVM)) {
        after(MachineClickDelay, [this] { sendMouseClick(); });
    }
    if (order.setting->has(InputFlag::DeleteAfterActivateVM)) {
        after(KeystrokeDelay, order.sendBackspaces);
        after(KeystrokeDelayBehindBackspaces, [this, send = order.sendPasteCommand] { sendPasteCommand(send); });
    } else {
        after(KeystrokeDelay, [this, send = order.sendPasteCommand] { sendPasteCommand(send); });
    }
}

// The last step of an order.
void VMPasting::sendPasteCommand(const std::function<void()>& send) {
    if (--ordersToCome_ == 0) timers_.clear();
    send();
}

void VMPasting::sendMouseClick() {
    poster_.click(poster_.pointerLocation());
}

}  // namespace plume

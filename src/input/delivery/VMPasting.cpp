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

void VMPasting::start(Order order) {
    auto shared = std::make_shared<const Order>(std::move(order));
    tapLoop_.schedule(ActivationDelay, [this, shared = std::move(shared)] {
        processManager_.bringToFront(processManager_.currentProcess());
        showVMHelper(shared);
    });
}

void VMPasting::showVMHelper(const std::shared_ptr<const Order>& order) {
    if (order->setting->has(InputFlag::ClickAtVMHelper)) {
        if (helper_) mainLoop_.perform([helper = helper_, at = poster_.pointerLocation()] { helper->show(at); });
        tapLoop_.schedule(HelperClickDelay, [this] { sendMouseClick(); });
        tapLoop_.schedule(HelperHideDelay, [this] {
            if (helper_) mainLoop_.perform([helper = helper_] { helper->hide(); });
        });
    }
    tapLoop_.schedule(GiveWayDelay, [this, order] { activateAndPasteToVM(*order); });
}

void VMPasting::activateAndPasteToVM(const Order& order) {
    processManager_.bringToFront(order.target);
    if (order.setting->has(InputFlag::ClickAtVM)) {
        tapLoop_.schedule(MachineClickDelay, [this] { sendMouseClick(); });
    }
    if (order.setting->has(InputFlag::DeleteAfterActivateVM)) {
        tapLoop_.schedule(KeystrokeDelay, order.sendBackspaces);
        tapLoop_.schedule(KeystrokeDelayBehindBackspaces, order.sendPasteCommand);
    } else {
        tapLoop_.schedule(KeystrokeDelay, order.sendPasteCommand);
    }
}

void VMPasting::sendMouseClick() {
    poster_.click(poster_.pointerLocation());
}

}  // namespace plume

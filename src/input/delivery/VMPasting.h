// Pasting into a virtual machine: what was offered reaches the machine's own clipboard only when its window is left and
// entered again, so Plume comes to the front and gives way before the keystroke.
//
// Owned by the delivery; belongs to the tap thread. The times are those that such programs were found to need.
#pragma once

#include <functional>
#include <memory>
#include <vector>

#include "input/delivery/ContextInputSetting.h"
#include "input/delivery/VMHelperController.h"
#include "platform/EventPoster.h"
#include "platform/ProcessManager.h"
#include "platform/RunLoop.h"

namespace plume {

class VMPasting {
  public:
    // Nothing is owned; a null helper is no window.
    VMPasting(EventPoster& poster, ProcessManager& processManager, RunLoop& tapLoop, RunLoop& mainLoop,
              VMHelperController* helper);

    // One paste: who is activated again, and what is sent then.
    struct Order {
        std::shared_ptr<const ContextInputSetting> setting;
        ProcessSerialNumber target;
        std::function<void()> sendBackspaces;  // only with DeleteAfterActivateVM
        std::function<void()> sendPasteCommand;
    };
    void start(Order order);

  private:
    void after(double delay, std::function<void()> call);
    void showVMHelper(const std::shared_ptr<const Order>& order);
    void activateAndPasteToVM(const Order& order);
    void sendPasteCommand(const std::function<void()>& send);
    void sendMouseClick();

    EventPoster& poster_;
    ProcessManager& processManager_;
    RunLoop& tapLoop_;
    RunLoop& mainLoop_;
    VMHelperController* helper_;
    int ordersToCome_ = 0;       // a paste may be ordered before the last one is done
    std::vector<Timer> timers_;  // of the orders to come; some have run
};

}  // namespace plume

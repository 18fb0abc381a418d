// Delivers outputs to the application in front, one after the other: erases, types or pastes piece by piece, presses
// keys, moves the caret back, and has the user's clipboard restored.
//
// Owned by the input service; belongs to the tap thread. What is sent without a pause goes out inside send(), the rest
// in batches on the tap thread's run loop. Nothing here waits or fails: an application that never takes what was pasted
// delays what follows by a second, one that hangs by ten. The user's own keys are held while an output is on its way,
// where the port can.
#pragma once

#include <cstddef>
#include <cstdint>
#include <deque>
#include <memory>
#include <optional>
#include <string>

#include "content/PLOutput.h"
#include "input/delivery/ClipboardDataProvider.h"
#include "input/delivery/ContextInputResolver.h"
#include "input/delivery/KeySender.h"
#include "input/delivery/OutputBatch.h"
#include "input/delivery/OutputPreparation.h"
#include "input/delivery/VMPasting.h"
#include "platform/EventPoster.h"
#include "platform/Pasteboard.h"
#include "platform/ProcessManager.h"
#include "platform/RunLoop.h"

namespace plume {

class OutputDelivery {
  public:
    // What delivery works on. Nothing is owned; all of it outlives the delivery, and no call of the loops runs once
    // the delivery is gone.
    struct Dependencies {
        EventPoster& poster;
        Pasteboard& pasteboard;
        const Accessibility& accessibility;
        ProcessManager& processManager;
        ContextInputResolver& resolver;
        RunLoop& tapLoop;
        RunLoop& mainLoop;
        VMHelperController* vmHelper;  // null: no window
    };

    explicit OutputDelivery(const Dependencies& dependencies);
    OutputDelivery(const OutputDelivery&) = delete;
    OutputDelivery& operator=(const OutputDelivery&) = delete;

    // Decides how the output is delivered (its `cancelTrigger` and its content's suffix are final when this returns)
    // and starts, behind the outputs that are still on their way. `target` is the process that received the last key.
    void send(std::shared_ptr<PLOutput> output, const TriggerKey& triggerKey, ProcessSerialNumber target);
    // Drops what has not been sent yet, for good: the rest of a text is of no use to whoever has the focus by now. The
    // user's clipboard still comes back.
    void abandon();
    // The tap lets every event pass, unseen.
    bool letsEverythingPass() const { return sender_.isSending() || pasting_; }
    // Every output has been delivered.
    bool isIdle() const { return !current_ && queue_.empty(); }

    // The user's keys wait from the first hold to the last release, besides while an output is on its way.
    void holdUserKeys();
    void releaseUserKeys();
    // They go on waiting, for 2 seconds from now: see EventPoster.
    void keepHoldingUserKeys() { dependencies_.poster.keepHoldingUserKeys(); }

    KeySender& sender() { return sender_; }
    ClipboardDataProvider& clipboardDataProvider() { return provider_; }
    const ClipboardDataProvider& clipboardDataProvider() const { return provider_; }

  private:
    // One output on its way, with what belongs to it alone.
    struct Delivery {
        std::shared_ptr<PLOutput> output;
        std::shared_ptr<const ContextInputSetting> setting;  // as it was when the output was prepared
        ProcessSerialNumber target;
        std::uint64_t heldBackspaces = 0;  // sent when the virtual machine is active again
        bool restoresClipboard = false;    // the user's preference when it was prepared
        bool tookOverRestore = false;      // a pending restore was cancelled for it
        bool pasted = false;
        bool allSent = false;  // but for paste keystrokes that are still to come
    };

    void startNext();
    void start();
    void sendBatch();
    void continueBatch();
    void performSteps();
    void perform(const OutputStep& step);
    void finish();
    void completeIfDone();

    void paste(const PLOutput::Fragment& fragment);
    void offer(const PLOutput::Fragment& fragment);
    void pasteByActivation();
    void sendPasteCommand();
    void sendPasteKeystroke();
    void wasTaken();
    void takingIsOverdue();
    void goOnBehindPaste();

    Dependencies dependencies_;
    ClipboardDataProvider provider_;
    KeySender sender_;
    VMPasting vmPasting_;
    std::deque<Delivery> queue_;
    std::optional<Delivery> current_;
    OutputBatch batch_;              // of the current delivery
    std::size_t nextStep_ = 0;       // in batch_
    int holds_ = 0;                  // of the user's keys
    bool startsNext_ = false;        // inside startNext()
    bool pasting_ = false;           // a delayed paste keystroke is to come
    int keystrokesToCome_ = 0;       // paste keystrokes, delayed ones and those to virtual machines
    bool awaitsTaking_ = false;      // nothing goes on before the last paste was taken
    bool hasAskedForPaste_ = false;  // its keystroke was sent
    Timer nextBatch_;
    Timer keystroke_;    // the delayed one
    Timer behindPaste_;  // when the paste was taken, or is waited for no longer
    // When the last paste's keystroke was sent, and to which program.
    double pasted_ = 0;
    std::optional<ProcessSerialNumber> pastedInto_;
};

}  // namespace plume

#include "input/delivery/OutputDelivery.h"

#include <utility>
#include <variant>

namespace plume {

namespace {
// An application that has not taken what was pasted by then is not waited for.
constexpr double TakingLimit = 1.0;  // seconds from the keystroke
// But for one that hangs, until somebody else is in front.
constexpr double HangingLimit = 10.0;
constexpr double BetweenLooks = 0.05;
}  // namespace

OutputDelivery::OutputDelivery(const Dependencies& dependencies)
    : dependencies_(dependencies),
      provider_(dependencies.pasteboard, dependencies.tapLoop),
      sender_(dependencies.poster, dependencies.accessibility),
      vmPasting_(dependencies.poster, dependencies.processManager, dependencies.tapLoop, dependencies.mainLoop,
                 dependencies.vmHelper) {
    provider_.onTaken = [this] { wasTaken(); };
}

void OutputDelivery::send(std::shared_ptr<PLOutput> output, const TriggerKey& triggerKey, ProcessSerialNumber target) {
    ContextInputResolver& resolver = dependencies_.resolver;
    resolver.prepareSending(output->snippetExpandedContent.get());
    output->contextInputSetting = resolver.setting();
    if (output->erasedText) {
        output->backspaceCount = backspacesFor(*output->erasedText, resolver.setting()->erasesAtOnce);
    }
    prepareOutput(*output, *resolver.setting(), triggerKey, !isIdle());

    Delivery delivery;
    delivery.setting = std::make_shared<const ContextInputSetting>(*resolver.setting());
    delivery.target = target;
    delivery.restoresClipboard =
        resolver.preferences.restoreClipboard && !delivery.setting->has(InputFlag::DoNotRestoreClipboard);
    if (delivery.setting->has(InputFlag::DeleteAfterActivateVM)) {
        delivery.heldBackspaces = std::exchange(output->backspaceCount, 0);
    }
    delivery.output = std::move(output);
    queue_.push_back(std::move(delivery));
    startNext();
}

// What is left is nothing, and comes to its end as always.
void OutputDelivery::abandon() {
    queue_.clear();
    if (!current_) return;
    PLOutput& rest = *current_->output;
    rest.fragments.clear();
    rest.backspaceCount = 0;
    rest.leftArrowCount = 0;
    current_->heldBackspaces = 0;
    nextStep_ = batch_.steps.size();
}

// Keys that are let go at the end of an output may order the next one: that takes its place in the queue.
void OutputDelivery::startNext() {
    if (startsNext_) return;
    startsNext_ = true;
    while (!current_ && !queue_.empty()) {
        current_ = std::move(queue_.front());
        queue_.pop_front();
        start();
    }
    startsNext_ = false;
}

void OutputDelivery::start() {
    holdUserKeys();
    current_->tookOverRestore = provider_.cancelRestore();
    // A backup may have to read megabytes from a program: only for what goes through the clipboard.
    if (current_->restoresClipboard && current_->setting->has(InputFlag::UseClipboard)) provider_.backup();
    if (current_->setting->overtypesCompletion && current_->output->backspaceCount > 0) sender_.overtypeCompletion();
    sendBatch();
}

void OutputDelivery::sendBatch() {
    sender_.setContextInputSetting(current_->setting);
    batch_ = takeBatch(*current_->output, *current_->setting);
    nextStep_ = 0;
    continueBatch();
}

void OutputDelivery::continueBatch() {
    performSteps();
    if (awaitsTaking_) return;
    if (!batch_.pause) return finish();
    nextBatch_ = dependencies_.tapLoop.performAfterDelay(*batch_.pause, [this] { sendBatch(); });
}

// All in one, so that the port can send it together.
void OutputDelivery::performSteps() {
    if (nextStep_ == batch_.steps.size()) return;
    dependencies_.poster.begin();
    while (nextStep_ < batch_.steps.size() && !awaitsTaking_) perform(batch_.steps[nextStep_++]);
    dependencies_.poster.end();
}

void OutputDelivery::perform(const OutputStep& step) {
    switch (step.kind) {
        case OutputStep::Kind::Backspaces:
            return sender_.sendBackspaces(step.count);
        case OutputStep::Kind::LeftArrows:
            return sender_.sendLeftArrowKeys(step.count);
        case OutputStep::Kind::Text:
            return sender_.sendPlainText(std::get<std::u16string>(step.fragment));
        case OutputStep::Kind::Paste:
            return paste(step.fragment);
        case OutputStep::Kind::Key: {
            const auto& key = *std::get<std::shared_ptr<SnippetKeyVariable>>(step.fragment);
            if (key.keyCode != KeyCode::None) sender_.sendKey(key.keyCode, key.modifiers, step.count);
            return;
        }
    }
}

void OutputDelivery::finish() {
    const bool pastes = current_->setting->has(InputFlag::UseClipboard);
    const bool restores = pastes && current_->restoresClipboard;
    // A restore that was put off for an output without a paste of its own is still owed.
    const bool owesRestore = current_->tookOverRestore && !current_->pasted;
    if (restores || owesRestore) provider_.restoreAfterDelay();
    current_->allSent = true;
    completeIfDone();
}

void OutputDelivery::completeIfDone() {
    if (!current_ || !current_->allSent || keystrokesToCome_ > 0) return;
    current_.reset();
    releaseUserKeys();
    startNext();
}

// Each time: the port may have let them go because they had waited for long enough.
void OutputDelivery::holdUserKeys() {
    ++holds_;
    dependencies_.poster.holdUserKeys();
}

void OutputDelivery::releaseUserKeys() {
    if (--holds_ == 0) dependencies_.poster.releaseUserKeys();
}

void OutputDelivery::paste(const PLOutput::Fragment& fragment) {
    const bool tells = dependencies_.pasteboard.tellsWhenTaken();
    const auto* text = std::get_if<std::u16string>(&fragment);
    // Nobody takes nothing, and it would be waited for.
    if (tells && text && text->empty()) return;
    offer(fragment);
    current_->pasted = true;
    awaitsTaking_ = tells;
    ++keystrokesToCome_;

    const ContextInputSetting& setting = *current_->setting;
    if (pastesByActivation(setting)) return pasteByActivation();
    if (!setting.has(InputFlag::DelayPasting)) return sendPasteCommand();
    pasting_ = true;
    keystroke_ = dependencies_.tapLoop.performAfterDelay(pasteKeystrokeDelay(setting), [this] { sendPasteCommand(); });
}

void OutputDelivery::offer(const PLOutput::Fragment& fragment) {
    dependencies_.pasteboard.setPastesPrimary(current_->setting->pastesPrimary);
    if (const auto* text = std::get_if<std::u16string>(&fragment)) {
        provider_.setString(*text);
    } else if (const auto* rich = std::get_if<AttributedString>(&fragment)) {
        provider_.includeHTMLData = current_->setting->has(InputFlag::IncludeHTMLData);
        provider_.excludeParagraphTag = current_->setting->has(InputFlag::ExcludeParagraphTag);
        provider_.setAttributedString(*rich);
    }
}

void OutputDelivery::pasteByActivation() {
    VMPasting::Order order;
    order.setting = current_->setting;
    order.target = current_->target;
    // The output is on its way until its last paste keystroke is sent.
    order.sendBackspaces = [this] { sender_.sendBackspaces(std::exchange(current_->heldBackspaces, 0)); };
    order.sendPasteCommand = [this] { sendPasteCommand(); };
    vmPasting_.start(std::move(order));
}

void OutputDelivery::sendPasteCommand() {
    dependencies_.pasteboard.paste([this] { sendPasteKeystroke(); });
}

void OutputDelivery::sendPasteKeystroke() {
    pasting_ = false;
    --keystrokesToCome_;
    hasAskedForPaste_ = true;
    pasted_ = dependencies_.tapLoop.now();
    pastedInto_ = dependencies_.processManager.frontProcess();
    provider_.wasPasted();
    sender_.sendPasteCommand(*current_->setting);
    if (awaitsTaking_ && hasAskedForPaste_) {
        behindPaste_ = dependencies_.tapLoop.performAfterDelay(TakingLimit, [this] { takingIsOverdue(); });
    }
    completeIfDone();
}

// Inside the pasteboard's call, perhaps inside the keystroke's: goes on from the loop.
void OutputDelivery::wasTaken() {
    if (!awaitsTaking_ || !hasAskedForPaste_) return;
    hasAskedForPaste_ = false;
    behindPaste_ = dependencies_.tapLoop.performAfterDelay(0, [this] { goOnBehindPaste(); });
}

void OutputDelivery::takingIsOverdue() {
    // What is left was meant for the program that got the paste.
    if (dependencies_.processManager.frontProcess() != pastedInto_) abandon();
    const bool mayTakeIt =
        dependencies_.pasteboard.isPasteAwaited() && dependencies_.tapLoop.now() - pasted_ < HangingLimit;
    if (!mayTakeIt) return goOnBehindPaste();
    // Keys that it got now would come before the text.
    dependencies_.poster.keepHoldingUserKeys();
    if (current_->restoresClipboard && !provider_.isRestoring()) provider_.restoreAfterDelay();
    behindPaste_ = dependencies_.tapLoop.performAfterDelay(BetweenLooks, [this] { takingIsOverdue(); });
}

void OutputDelivery::goOnBehindPaste() {
    awaitsTaking_ = false;
    hasAskedForPaste_ = false;
    const bool pausesForPaste = pauseAfterPaste(*current_->setting) > 0;
    if (pausesForPaste) batch_.pause = pauseAfterTaking(*current_->setting);
    continueBatch();
}

}  // namespace plume

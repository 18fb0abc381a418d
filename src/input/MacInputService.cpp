#include "input/MacInputService.h"

#include <algorithm>
#include <utility>

namespace plume {

namespace {

constexpr std::size_t TimeoutsToGiveUp = 3;
constexpr double TimeoutPeriod = 60;  // seconds
// Until the tap is tried again after it was given up, in seconds.
constexpr double GivenUpPeriod = 60;

}  // namespace

MacInputService::MacInputService(Dependencies dependencies)
    : around_(std::move(dependencies)),
      hotKeys_(hotKeysPressed),
      keyCodeTransformer_(around_.inputSources),
      resolver_(around_.processManager, around_.bundleIdentifierResolver, around_.accessibility, around_.poster),
      delivery_({around_.poster, around_.pasteboard, around_.accessibility, around_.processManager, resolver_,
                 around_.tapLoop, around_.mainLoop, around_.vmHelper}),
      aclExport_(delivery_.sender(), around_.pasteboard, around_.tapLoop, [this] { sendCopyCommand(); }),
      userPasteboard_(around_.pasteboard, delivery_.clipboardDataProvider()),
      secureInputWatch_(around_.secureInput, around_.processManager, around_.tapLoop, around_.mainLoop,
                        [this] { secureInputChangedEvent.raise(*this); }) {
    layoutChanged();
    around_.inputSources.setChangeListener([this] { layoutChanged(); });
}

MacInputService::~MacInputService() {
    around_.inputSources.setChangeListener(nullptr);
    if (around_.keyboardTap.exists()) around_.keyboardTap.remove();
    if (around_.mouseTap.exists()) around_.mouseTap.remove();
}

void MacInputService::onTapThread(std::function<void()> call) {
    if (eventTapThread_.load() == std::this_thread::get_id()) {
        call();
    } else {
        around_.tapLoop.perform(std::move(call));
    }
}

void MacInputService::enableEvents() {
    keyUpObserved_ = keyUpEvent.isObserved();
    around_.tapLoop.perform([this] { enableEventsInternal(); });
}

void MacInputService::enableEventsInternal() {
    eventTapThread_ = std::this_thread::get_id();
    isLastProcessReceivedKeyEventNull_ = true;
    timeouts_.clear();
    nextTry_.cancel();
    if (!evenTapCreated()) {
        const auto created = around_.keyboardTap.create(*this, resolver_.listenAtAnnotatedSession);
        if (!created) {
            around_.log("The event tap could not be created to monitor key events");
            around_.log(created.error().message);
        }
    }
    if (evenTapCreated()) around_.mainLoop.perform([this] { secureInputWatch_.startCheckingSecureInputTimer(); });
    active_ = true;
    if (listenMouseDownEvents_) enableMouseEventTap();
}

void MacInputService::enableMouseEventTap() {
    if (around_.mouseTap.exists()) return;
    const auto created = around_.mouseTap.create([this](Point location) { mouseDown(location); });
    if (created) return;
    around_.log("The event tap could not be created to monitor mouse events");
    around_.log(created.error().message);
}

void MacInputService::disableEvents() {
    onTapThread([this] { disableEventsInternal(); });
}

void MacInputService::disableEventsInternal() {
    active_ = false;
    nextTry_.cancel();
    if (evenTapCreated()) {
        around_.keyboardTap.remove();
        around_.mainLoop.perform([this] { secureInputWatch_.stop(); });
    }
    if (around_.mouseTap.exists()) around_.mouseTap.remove();
}

void MacInputService::setListenMouseDownEvents(bool listen) {
    listenMouseDownEvents_ = listen;
    if (!active_) return;
    if (listen) {
        enableMouseEventTap();
    } else if (around_.mouseTap.exists()) {
        around_.mouseTap.remove();
    }
}

void MacInputService::tapDisabledByTimeout() {
    around_.log("Event tap was disabled by timeout");
    delivery_.abandon();
    // Nobody knows what was typed meanwhile.
    typingInterrupted();
    // What becomes of the modifiers meanwhile is no hot key.
    if (!hotKeys_.keyModifier().isEmpty()) hotKeys_.ignoreNextHotKey();
    const double now = around_.tapLoop.now();
    std::erase_if(timeouts_, [&](double moment) { return now - moment >= TimeoutPeriod; });
    timeouts_.push_back(now);
    if (timeouts_.size() < TimeoutsToGiveUp) return around_.keyboardTap.enable();

    around_.log("The keyboard is not listened to for a minute: the event tap was disabled three times within one");
    timeouts_.clear();
    nextTry_ = around_.tapLoop.performAfterDelay(GivenUpPeriod, [this] { tryTapAgain(); });
    around_.mainLoop.perform([this] {
        KeyboardTapGivenUp givenUp;
        keyboardTapGivenUpEvent.raise(givenUp);
    });
}

void MacInputService::tryTapAgain() {
    onTapThread([this] {
        if (!nextTry_) return;
        nextTry_.cancel();
        around_.keyboardTap.enable();
    });
}

void MacInputService::tapDisabledByUserInput() {
    around_.log("Event tap was disabled by user input");
}

void MacInputService::layoutChanged() {
    keyCodeTransformer_.regenerateStringToKeyCodeMapping();
    // Layouts without Latin letters keep the places of a Latin one for commands.
    CommandKeyCodes codes;
    codes.v = keyCodeTransformer_.reverseTransformedValue(u"V").value_or(codes.v);
    codes.c = keyCodeTransformer_.reverseTransformedValue(u"C").value_or(codes.c);
    delivery_.sender().setCommandKeyCodes(codes);
}

Result<void> MacInputService::registerSystemHotKey(SystemHotKeys::Id id, const GeneralHotKey& hotKey,
                                                   std::function<void()> pressed) {
    around_.systemHotKeys.unregisterHotKey(id);
    if (hotKey.keyCode == KeyCode::None) return {};
    return around_.systemHotKeys.registerHotKey(id, hotKey.keyCode, hotKey.modifiers,
                                                [this, pressed = std::move(pressed)] {
                                                    ignoreNextHotKey();
                                                    pressed();
                                                });
}

void MacInputService::setRestoreClipboardDelay(double seconds) {
    delivery_.clipboardDataProvider().restoreDelay = seconds;
}

void MacInputService::setCustomApplicationSetting(const std::u16string& bundleIdentifier,
                                                  std::shared_ptr<const ContextInputSetting> setting) {
    resolver_.applicationSettings.set(bundleIdentifier, std::move(setting));
}

void MacInputService::setApplicationTable(std::shared_ptr<const ApplicationTable> table) {
    resolver_.applicationSettings.setTable(std::move(table));
}

Result<void> MacInputService::setOwnApplicationRows(std::string_view text, const std::string& fileName) {
    return resolver_.applicationSettings.setOwnRows(text, fileName);
}

std::vector<RunningApplication> MacInputService::tappingProcesses() const {
    const auto own = around_.processManager.runningApplication(around_.processManager.currentProcess());
    std::vector<RunningApplication> others;
    for (EventTapInformation& tap : around_.processManager.eventTaps()) {
        RunningApplication& application = tap.tappingProcess;
        const bool isOwn = own && application.processIdentifier == own->processIdentifier;
        if (!tap.isActiveFilter || isOwn || application.bundleIdentifier == u"com.apple.dock") continue;
        others.push_back(std::move(application));
    }
    return others;
}

void MacInputService::sendCopyCommand() {
    const auto front = around_.processManager.frontProcess();
    const bool isX11 =
        front && around_.bundleIdentifierResolver.getBundleIdentifier(*front) == u"org.macosforge.xquartz.X11";
    delivery_.sender().sendCopyCommand(*resolver_.setting(),
                                       isX11 || resolver_.setting()->has(InputFlag::UseControlKey));
}

void MacInputService::exportACLs() {
    aclExport_.start();
}

bool MacInputService::isSameProcess() const {
    return !expandsInOwnWindows_ && lastProcessReceivedKeyEvent_ == around_.processManager.currentProcess();
}

std::optional<std::u16string> MacInputService::stringForKeyCode(KeyCode keyCode, EventFlags flags) const {
    auto text = around_.inputSources.translateKey(keyCode, flags & ModifierFlags);
    if (text && text->size() > 1) text->resize(1);
    return text;
}

const std::optional<std::u16string>& MacInputService::contextBundleIdentifier() const {
    return resolver_.contextBundleIdentifier();
}

std::shared_ptr<const ContextInputSetting> MacInputService::refreshContextInputSetting() {
    resolver_.refresh();
    delivery_.sender().setContextInputSetting(resolver_.setting());
    return resolver_.setting();
}

void MacInputService::sendOutput(std::shared_ptr<PLOutput> output) {
    if (!output) return;
    onTapThread([this, output = std::move(output)]() mutable {
        delivery_.send(std::move(output), {lastKeyCode_, lastKeyString_}, lastProcessReceivedKeyEvent_);
    });
}

void MacInputService::bringLastProcessToFront() {
    around_.processManager.bringToFront(lastProcessReceivedKeyEvent_);
}

}  // namespace plume

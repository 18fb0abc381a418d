#include "app/linux/LinuxPort.h"

#include <xcb/xproto.h>

#include <algorithm>
#include <array>
#include <optional>
#include <utility>

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"
#include "input/BundleIdentifierResolver.h"

namespace plume {

namespace {

// Keeps the value of a result, or its error.
template <typename Part>
Result<void> keep(Result<std::unique_ptr<Part>> result, std::unique_ptr<Part>& place) {
    if (!result) return result.error();
    place = std::move(result).value();
    return {};
}

bool isShortcut(EventFlags flags) {
    return flags.containsAny(EventFlag::Control | EventFlag::Option | EventFlag::Command);
}

// Keys by which people leave a field.
std::optional<FocusMover> moverOf(KeyCode keyCode, EventFlags flags) {
    if (isShortcut(flags)) return std::nullopt;
    if (keyCode == KeyCode::Tab) return FocusMover::Tab;
    const bool isReturn = keyCode == KeyCode::Return || keyCode == KeyCode::KeypadEnter;
    return isReturn ? std::optional(FocusMover::Return) : std::nullopt;
}

// Keys that may set something off which takes the focus.
bool maySetOff(KeyCode keyCode, EventFlags flags) {
    return isShortcut(flags) || keyCode == KeyCode::Escape;
}

}  // namespace

Result<std::unique_ptr<LinuxPort>> LinuxPort::open(DescriptorLoop& mainLoop, const std::string& display,
                                                   const std::filesystem::path& ownSounds) {
    std::unique_ptr<LinuxPort> port(new LinuxPort(mainLoop, ownSounds));
    if (const auto begun = port->begin(display); !begun) return begun.error();
    return port;
}

Result<void> LinuxPort::begin(const std::string& display) {
    if (auto opened = keep(X11Session::open(display, tapLoop_), session_); !opened) return opened;
    if (auto opened = openKeyboard(display); !opened) return opened;
    if (auto opened = openDesktop(display); !opened) return opened;
    connectParts();
    return {};
}

Result<void> LinuxPort::openKeyboard(const std::string& display) {
    if (auto opened = keep(XkbKeyboard::open(session_->connection()), keyboard_); !opened) return opened;
    if (auto opened = keep(TapConnection::open(display, *keyboard_), tapConnection_); !opened) return opened;
    watchdog_ = std::make_unique<Watchdog>(
        tapLoop_, display, Watchdog::Shared{clipboardCopy_.descriptor(), tapConnection_->progress().descriptor()});
    keyboardTap_ = std::make_unique<X11KeyboardTap>(tapLoop_, *tapConnection_, *keyboard_);
    poster_ = std::make_unique<X11EventPoster>(tapLoop_, *tapConnection_, *keyboard_, *keyboardTap_);
    return {};
}

Result<void> LinuxPort::openDesktop(const std::string& display) {
    const auto focusIsPassword = [this] { return accessibility_.focusIsPassword() || hiddenPrompts_.isWaiting(); };
    if (auto opened = keep(X11Pasteboard::open(*session_), pasteboard_); !opened) return opened;
    if (auto opened = keep(X11SecureInput::open(display, focusIsPassword), secureInput_); !opened) return opened;
    mouseTap_ = std::make_unique<X11MouseTap>(*session_);
    processManager_ = std::make_unique<X11ProcessManager>(*session_, DesktopFiles::ofEnvironment());
    inputSources_ = std::make_unique<X11InputSources>(*keyboard_);
    systemHotKeys_ = std::make_unique<X11SystemHotKeys>(*session_, *keyboard_);
    keyboardTap_->setFocusQuestions(
        {.isPassword = [this] { return accessibility_.focusIsPasswordForKey() || hiddenPrompts_.isWaitingForKey(); },
         .movedByItself = [this] { return accessibility_.takeOwnMove(); }});
    return {};
}

void LinuxPort::connectParts() {
    keyboard_->listenTo(*session_);
    pasteboard_->setSharedCopy(&clipboardCopy_);
    followFocus();
    followScreen();
    inputMethod_ = std::make_unique<InputMethodWatch>(
        session_->connection().displayName(), tapLoop_,
        [this](const std::string& engine) { inputSources_->setEngine(engine); },
        [this] { keyboardTap_->inputMethodTold(); });
    keyboardTap_->setInputMethod(&inputMethod_->inputMethod());

    // Whoever waits on the tap thread tells the watchdog that this is no hang.
    session_->heartbeat = [this] { watchdog_->beat(); };
    poster_->heartbeat = [this] { watchdog_->beat(); };
    tapConnection_->setReopenedListener([this](xcb_window_t window) { watchdog_->setTapWindow(window); });
}

// Programs are asked for their focus when it may have moved.
void LinuxPort::followFocus() {
    keyboardTap_->setUserTyped([this](KeyCode keyCode, EventFlags flags) {
        secureInput_->somethingHappens();
        if (const auto mover = moverOf(keyCode, flags)) {
            userMovesFocus(*mover);
        } else if (maySetOff(keyCode, flags)) {
            focusMayHaveMoved();
        } else {
            accessibility_.userTypes();
            hiddenPrompts_.userTypes();
        }
    });
    // Where clicks cannot be heard, the tap says so when it is created.
    static_cast<void>(mouseTap_->setClicked([this] {
        secureInput_->somethingHappens();
        keyboardTap_->userClicked();
        userMovesFocus(FocusMover::Click);
    }));
    processManager_->frontMayHaveChanged = [this] { tapLoop_.perform([this] { tellFrontProcess(); }); };
    tapLoop_.perform([this] { tellFrontProcess(); });
}

// People turn their screens and plug others in while Plume runs.
void LinuxPort::followScreen() {
    const XcbConnection& connection = session_->connection();
    accessibility_.setMainScreenHeight(connection.screen().height_in_pixels);
    rootEvents_ = session_->listen(connection.root(), XCB_EVENT_MASK_STRUCTURE_NOTIFY);
    screenResized_ =
        session_->addObserver(XCB_CONFIGURE_NOTIFY, [this, root = connection.root()](const xcb_generic_event_t& event) {
            const auto& configured = reinterpret_cast<const xcb_configure_notify_event_t&>(event);
            if (configured.window == root) accessibility_.setMainScreenHeight(configured.height);
        });
}

void LinuxPort::tellFrontProcess() {
    secureInput_->somethingHappens();
    const auto application = foregroundApplication(*processManager_);
    const pid_t process = application ? static_cast<pid_t>(application->processIdentifier) : 0;
    accessibility_.setFrontProcess(process);
    hiddenPrompts_.setFrontProcess(process);
    focusMayHaveMoved();
}

void LinuxPort::userMovesFocus(FocusMover mover) {
    accessibility_.userMovesFocus(mover);
    hiddenPrompts_.promptMayHaveCome();
}

void LinuxPort::focusMayHaveMoved() {
    accessibility_.focusMayHaveMoved();
    hiddenPrompts_.promptMayHaveCome();
}

Result<void> LinuxPort::startWatchdog() {
    watchdog_->setTapWindow(tapConnection_->window());
    auto started = watchdog_->start();
    watchdog_->awaitListening();
    return started;
}

Composition::Ports LinuxPort::ports() {
    return {*keyboardTap_, *mouseTap_,      *poster_, *pasteboard_, *processManager_, *inputSources_, accessibility_,
            *secureInput_, *systemHotKeys_, sounds_,  notices_,     processLauncher_, tapLoop_,       mainLoop_};
}

}  // namespace plume

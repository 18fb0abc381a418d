#include "ports/x11/keyboard/TapSession.h"

#include <algorithm>
#include <utility>

#include "ports/x11/keyboard/X11KeyCodes.h"

namespace plume {

namespace {

constexpr double LongestHold = 2.0;

// The left one of the keys that make the lowest of these flags.
KeyCode modifierKeyOf(EventFlags flags) {
    if (flags.contains(EventFlag::Shift)) return KeyCode::Shift;
    if (flags.contains(EventFlag::Control)) return KeyCode::Control;
    if (flags.contains(EventFlag::Option)) return KeyCode::Option;
    return KeyCode::Command;
}

bool typesText(std::u16string_view text) {
    constexpr char16_t Delete = 0x7F;
    return !text.empty() && text.front() >= u' ' && text.front() != Delete;
}

bool isRepeat(const xcb_input_key_press_event_t& key) {
    return (key.flags & XCB_INPUT_KEY_EVENT_FLAGS_KEY_REPEAT) != 0;
}

}  // namespace

TapSession::TapSession(Dependencies dependencies)
    : dependencies_(std::move(dependencies)),
      keyboards_(dependencies_.connection),
      keymaps_(dependencies_.connection, dependencies_.keyboard),
      grabCheck_(std::make_unique<KeyboardGrabCheck>(dependencies_.connection)) {}

Result<void> TapSession::begin() {
    TapConnection& connection = dependencies_.connection;
    const auto typedOn = typedOnLast();
    if (typedOn && !keymaps_.use(*typedOn)) {
        return Error{"The X server of display \"" + connection.connection().displayName() +
                     "\" refuses to give the keyboard's layout to its XTEST keyboard; without that, keys that Plume "
                     "passes on would come out wrong. Does setxkbmap with your layout help?"};
    }
    if (auto grabbed = keyboards_.grab(); !grabbed) return grabbed;
    for (const std::uint16_t device : keyboards_.grabbed()) keymaps_.add(device);
    connection.userKeys = keyboards_.keysDown();
    decoder_.setKeymap(keymaps_.current(), connection.userKeys, dependencies_.keyboard.locks());
    selectEvents(XCB_INPUT_DEVICE_ALL, XCB_INPUT_XI_EVENT_MASK_HIERARCHY);
    connection.setHearsPresses(true);
    becomeTypedOn();
    grabCheck_->ask(dependencies_.loop.now());
    connection.connection().sync();
    addSource();
    return {};
}

// The keyboard that was typed on last, where the server still knows it.
std::optional<std::uint16_t> TapSession::typedOnLast() const {
    const TapConnection& connection = dependencies_.connection;
    const auto keyboards = HardwareKeyboards::list(connection);
    if (keyboards.empty()) return std::nullopt;
    std::uint16_t typedOn = keyboards.front().id;
    for (const InputDevice& device : inputDevices(connection.connection())) {
        if (device.id != connection.masterKeyboard()) continue;
        if (std::ranges::find(keyboards, device.keySource, &InputDevice::id) != keyboards.end()) {
            typedOn = device.keySource;
        }
    }
    return typedOn;
}

// At the first key of another keyboard the server gives all programs its layout. Window managers bind their keys anew
// then, and do nothing on them meanwhile, for a second and more: that is to be over when the user's first key passes.
void TapSession::becomeTypedOn() const {
    TapConnection& connection = dependencies_.connection;
    const auto& withoutSymbols = keymaps_.current()->spareKeycodes();
    if (withoutSymbols.empty()) return;
    connection.sendKey(withoutSymbols.back(), true);
    connection.sendKey(withoutSymbols.back(), false);
}

void TapSession::typeOn(std::uint16_t device) {
    const auto before = keymaps_.current();
    keymaps_.use(device);
    if (keymaps_.current() == before) return;
    decoder_.setKeymap(keymaps_.current(), dependencies_.connection.userKeys, dependencies_.keyboard.locks());
}

void TapSession::selectEvents(std::uint16_t device, std::uint32_t events) const {
    selectDeviceEvents(dependencies_.connection.connection(), device, events);
}

void TapSession::addSource() {
    descriptor_ = dependencies_.connection.connection().descriptor();
    source_ = dependencies_.loop.addSource(descriptor_, [this] { drain(); });
}

void TapSession::end() {
    if (std::exchange(ended_, true)) return;
    source_.end();
    holdLimit_.cancel();
    nextDrain_.cancel();
    TapConnection& connection = dependencies_.connection;
    keyboards_.ungrab();
    connection.setHearsPresses(false);
    grabCheck_.reset();
    connection.connection().sync();
    passOnUnheard();
    connection.releaseAll();
    connection.connection().sync();
    connection.userKeys.reset();
}

void TapSession::passOnUnheard() {
    TapConnection& connection = dependencies_.connection;
    if (waiting_) send(*waiting_);
    while (const auto event = nextEvent()) {
        const auto& key = reinterpret_cast<const xcb_input_key_press_event_t&>(*event);
        if (!isKey(*event)) continue;
        const auto keycode = static_cast<xcb_keycode_t>(key.detail);
        const bool pressed = key.event_type == XCB_INPUT_KEY_PRESS;
        if (pressed != connection.keysDown()[keycode]) connection.sendKey(keycode, pressed);
    }
}

bool TapSession::isInput(const xcb_generic_event_t& event, std::uint16_t type) const {
    const auto& generic = reinterpret_cast<const xcb_ge_generic_event_t&>(event);
    return (generic.response_type & 0x7F) == XCB_GE_GENERIC &&
           generic.extension == dependencies_.connection.inputOpcode() && generic.event_type == type;
}

bool TapSession::isKey(const xcb_generic_event_t& event) const {
    return isInput(event, XCB_INPUT_KEY_PRESS) || isInput(event, XCB_INPUT_KEY_RELEASE);
}

void TapSession::drain() {
    const auto kept = shared_from_this();  // the listener may end the session
    const TapConnection& connection = dependencies_.connection;
    tellOutcomes();
    while (!ended_ && !held_) {
        auto event = nextEvent();
        if (!event) break;
        if (waitsForOutcome(*event)) {
            readAhead_.push_front(std::move(event));
            settle();
            break;
        }
        handle(*event);
    }
    if (!ended_ && readsAhead_) readAhead();
    if (!ended_ && connection.isBroken()) dependencies_.lost();
}

// Whatever the listener does about the outcome comes before the key that waits for it, also the end of the session. The
// loop answers the watchdog in between.
void TapSession::settle() {
    dependencies_.inputMethod->settle();
    tellOutcomes();
    if (!ended_ && !held_) nextDrain_ = dependencies_.loop.performAfterDelay(0, [this] { drain(); });
}

XcbOwned<xcb_generic_event_t> TapSession::nextEvent() {
    if (readAhead_.empty()) return dependencies_.connection.connection().pollEvent();
    auto event = std::move(readAhead_.front());
    readAhead_.pop_front();
    return event;
}

void TapSession::readAhead() {
    while (auto event = dependencies_.connection.connection().pollEvent()) {
        readAhead_.push_back(std::move(event));
        if (isForWindowManager(*readAhead_.back())) return release();
    }
}

// A key with Alt or Super, also the release of either by itself.
bool TapSession::isForWindowManager(const xcb_generic_event_t& event) const {
    const auto& key = reinterpret_cast<const xcb_input_key_press_event_t&>(event);
    return isKey(event) && (key.mods.effective & (XCB_MOD_MASK_1 | XCB_MOD_MASK_4)) != 0;
}

void TapSession::handle(const xcb_generic_event_t& event) {
    if (isInput(event, XCB_INPUT_HIERARCHY)) {
        handleHierarchy(reinterpret_cast<const xcb_input_hierarchy_event_t&>(event));
    }
    keymaps_.hear(event);
    // Another program types: that cannot be swallowed, and it does not go on where the user was.
    if (isInput(event, XCB_INPUT_RAW_KEY_PRESS) && !dependencies_.connection.isOwnPress(event.full_sequence)) {
        return dependencies_.listener.typingInterrupted();
    }
    // What came before the connection was ended has been passed on by whoever did that.
    TapProgress& progress = dependencies_.connection.progress();
    if (!isKey(event) || progress.isTakenOver()) return;
    const auto& key = reinterpret_cast<const xcb_input_key_press_event_t&>(event);
    if (isRepeat(key)) return handleKey(key);
    const KeyMoment moment = moments_.next(key.time);
    handleKey(key);
    progress.setHandled(moment);
}

void TapSession::handleKey(const xcb_input_key_press_event_t& key) {
    const auto keycode = static_cast<xcb_keycode_t>(key.detail);
    if (key.event_type == XCB_INPUT_KEY_PRESS) {
        devices_[keycode] = key.deviceid;
        if (!keymaps_.isInUse(key.deviceid)) typeOn(key.deviceid);
        press(keycode, isRepeat(key));
    } else {
        release(keycode);
    }
    if (ended_) return;
    dependencies_.connection.flush();
    // Not behind a press: the answer would come while the program is busy with the key.
    if (key.event_type == XCB_INPUT_KEY_RELEASE) askForGrabs();
}

void TapSession::askForGrabs() {
    grabCheck_->ask(dependencies_.loop.now());
    dependencies_.connection.flush();
}

void TapSession::handleHierarchy(const xcb_input_hierarchy_event_t& event) {
    constexpr std::uint32_t Came = XCB_INPUT_HIERARCHY_MASK_SLAVE_ADDED | XCB_INPUT_HIERARCHY_MASK_DEVICE_ENABLED |
                                   XCB_INPUT_HIERARCHY_MASK_SLAVE_ATTACHED;
    constexpr std::uint32_t Went = XCB_INPUT_HIERARCHY_MASK_SLAVE_REMOVED | XCB_INPUT_HIERARCHY_MASK_DEVICE_DISABLED;
    const auto* const infos = xcb_input_hierarchy_infos(&event);
    for (int i = 0; i < xcb_input_hierarchy_infos_length(&event); ++i) {
        if ((infos[i].flags & Went) == 0) continue;
        keyboards_.forget(infos[i].deviceid);
        keymaps_.remove(infos[i].deviceid);
        releaseKeysOf(infos[i].deviceid);
    }
    if ((event.flags & Came) == 0) return;
    keyboards_.grabNew();
    for (const std::uint16_t device : keyboards_.grabbed()) keymaps_.add(device);
}

void TapSession::releaseKeysOf(std::uint16_t device) {
    for (unsigned i = 0; i < devices_.size() && !ended_; ++i) {
        if (devices_[i] == device && dependencies_.connection.userKeys[i]) release(static_cast<xcb_keycode_t>(i));
    }
    dependencies_.connection.flush();
}

bool TapSession::mayTell() {
    if (grabCheck_->isGrabbed(dependencies_.loop.now())) return false;
    return !dependencies_.focus.isPassword || !dependencies_.focus.isPassword();
}

// After an output, its keys may have moved the focus.
bool TapSession::isInAnotherField() {
    constexpr double Settling = 1;
    const auto& moved = dependencies_.focus.movedByItself;
    return moved && moved() && dependencies_.loop.now() - releasedAt_ > Settling;
}

bool TapSession::tellsKey(const KeyDecoder::Key& key) {
    if (key.silent) return false;
    const bool withholdsNow = !mayTell();
    if (withholdsNow && !std::exchange(withholding_, true)) dependencies_.listener.typingInterrupted();
    if (!withholdsNow) {
        withholding_ = false;
        if (isInAnotherField()) dependencies_.listener.typingInterrupted();
    }
    return !withholdsNow && !ended_;
}

void TapSession::press(xcb_keycode_t keycode, bool repeated) {
    const KeycodeSet& down = dependencies_.connection.keysDown();
    const EventFlags flagsBefore = decoder_.flags();
    const KeyDecoder::Key key = decoder_.press(keycode);
    dependencies_.connection.userKeys.set(keycode);
    seen_.set(keycode);
    bool swallow = false;
    told_[keycode] = tellsKey(key);
    if (told_[keycode]) {
        tellMissedModifiers(flagsBefore);
        if (!ended_) swallow = tell(key, key.modifier ? TapEvent::Type::FlagsChanged : TapEvent::Type::KeyDown);
    }
    if (ended_) return;
    swallowed_ = swallow;
    if (!swallow && told_[keycode] && goesToInputMethod(key)) giveToInputMethod(key, keycode, repeated);
    if (swallow) {
        decoder_.undoLocks();
        // A repeat of a key that was passed on: let go of it, or it would go on repeating.
        if (down[keycode]) inject({keycode, false});
    } else if (!repeated || !down[keycode]) {
        inject({keycode, true});
    }
    if (dependencies_.userTyped && !swallow) dependencies_.userTyped(key.keyCode, key.flags);
}

void TapSession::release(xcb_keycode_t keycode) {
    const KeyDecoder::Key key = decoder_.release(keycode);
    dependencies_.connection.userKeys.reset(keycode);
    bool isHotKey = false;
    if (told_[keycode]) {
        told_.reset(keycode);
        isHotKey = tell(key, key.modifier ? TapEvent::Type::FlagsChanged : TapEvent::Type::KeyUp) && key.modifier;
        if (ended_) return;
    }
    // Swallowed, or let go of meanwhile: no program has it down. What went down before the tap came has to come up.
    const bool isUp = seen_[keycode] && !dependencies_.connection.keysDown()[keycode];
    seen_.reset(keycode);
    if (!isUp) inject({keycode, false, isHotKey || (key.modifier && swallowed_)});
}

void TapSession::tellMissedModifiers(EventFlags flags) {
    const EventFlags changed = (flags ^ dependencies_.toldFlags) & ModifierFlags;
    if (changed.isEmpty()) return;
    dependencies_.toldFlags = flags;
    dependencies_.listener.keyboardEvent({TapEvent::Type::FlagsChanged, modifierKeyOf(changed), flags, {}});
}

bool TapSession::tell(const KeyDecoder::Key& key, TapEvent::Type type) {
    dependencies_.toldFlags = key.flags;
    // Programs type nothing with Alt.
    const bool command = !key.modifier && key.flags.contains(EventFlag::Option);
    TapEvent event{type, key.keyCode, key.flags, key.string, key.composing, command};
    undecided_ = type == TapEvent::Type::KeyDown && goesToInputMethod(key) &&
                 (typesText(key.string) || dependencies_.inputMethod->isComposing());
    event.undecided = undecided_;
    if (undecided_) event.string = {};
    return dependencies_.listener.keyboardEvent(event);
}

bool TapSession::waitsForOutcome(const xcb_generic_event_t& event) const {
    const InputMethod* const inputMethod = dependencies_.inputMethod;
    return inputMethod && !inputMethod->isIdle() && isInput(event, XCB_INPUT_KEY_PRESS);
}

// Engines leave shortcuts alone. The others all go there; those that type nothing they take only while they compose.
bool TapSession::goesToInputMethod(const KeyDecoder::Key& key) const {
    constexpr EventFlags Shortcuts = EventFlag::Control | EventFlag::Option | EventFlag::Command;
    if (!dependencies_.inputMethod || !dependencies_.inputMethod->takesText()) return false;
    return !key.modifier && !key.flags.containsAny(Shortcuts);
}

// GTK resets the engine when it has moved the caret; a letter that the engine got before that would be lost.
void TapSession::giveToInputMethod(const KeyDecoder::Key& key, xcb_keycode_t keycode, bool repeated) {
    constexpr std::uint32_t FirstKeycode = 8;  // of X, for the first code of the hardware
    if (repeated) {
        // How often it repeats for the program nobody knows.
        if (undecided_) dependencies_.listener.typingInterrupted();
        return;
    }
    announced_.keyCode = key.keyCode;
    announced_.flags = key.flags;
    announced_.text = typesText(key.string) ? key.string : std::u16string_view();
    announced_.isTold = !undecided_;
    dependencies_.inputMethod->announceKey(keycode - FirstKeycode, announced_.isTold);
}

void TapSession::tellOutcomes() {
    if (!dependencies_.inputMethod || dependencies_.inputMethod->isIdle()) return;
    const auto kept = shared_from_this();  // the listener may end the session
    while (!ended_ && !held_) {
        const auto outcome = dependencies_.inputMethod->next();
        if (!outcome) return;
        if (outcome->unknown || !mayTell()) {
            dependencies_.listener.typingInterrupted();
        } else {
            tellOutcome(*outcome);
        }
    }
}

void TapSession::tellOutcome(const InputMethod::Outcome& outcome) {
    TapEvent event;
    event.delivered = true;
    event.flags = announced_.flags;
    event.keyCode = KeyCode::Delete;
    for (std::size_t i = 0; i < outcome.erased && !ended_; ++i) dependencies_.listener.keyboardEvent(event);
    std::u16string text = outcome.text;
    if (outcome.keyPassed) text += announced_.text;
    if (!text.empty() && !ended_) {
        event.keyCode = KeyCode::None;
        event.string = text;
        event.composing = outcome.composing;
        dependencies_.listener.keyboardEvent(event);
    }
    if (!outcome.keyPassed || !announced_.text.empty() || announced_.isTold || ended_) return;
    event.keyCode = announced_.keyCode;
    event.string = {};
    dependencies_.listener.keyboardEvent(event);
}

void TapSession::inject(Injection injection) {
    if (held_) {
        waiting_ = injection;
        return;
    }
    send(injection);
}

void TapSession::send(Injection injection) {
    if (injection.keepsMenusClosed) dependencies_.connection.keepMenusClosed();
    dependencies_.connection.sendKey(injection.keycode, injection.down);
}

void TapSession::hold() {
    if (ended_ || std::exchange(held_, true)) return;
    dependencies_.loop.setSourcePaused(descriptor_, true);
    holdLimit_ = dependencies_.loop.performAfterDelay(LongestHold, [this] { release(); });
}

void TapSession::keepHolding() {
    if (ended_ || !held_) return;
    holdLimit_ = dependencies_.loop.performAfterDelay(LongestHold, [this] { release(); });
    if (std::exchange(readsAhead_, true)) return;
    letGoOfKeys();
    dependencies_.loop.setSourcePaused(descriptor_, false);
    nextDrain_ = dependencies_.loop.performAfterDelay(0, [this] { drain(); });
}

// Their releases wait, too, and a key that seems held for so long begins to repeat.
void TapSession::letGoOfKeys() {
    const KeycodeSet down = dependencies_.connection.keysDown();
    for (std::size_t i = 0; i < down.size(); ++i) {
        const auto keycode = static_cast<xcb_keycode_t>(i);
        if (down[i] && keymaps_.current()->modifiersOf(keycode) == 0) send({keycode, false});
    }
    dependencies_.connection.flush();
}

void TapSession::userClicked() {
    if (readsAhead_) release();
}

void TapSession::release() {
    if (ended_ || !std::exchange(held_, false)) return;
    readsAhead_ = false;
    releasedAt_ = dependencies_.loop.now();
    holdLimit_.cancel();
    dependencies_.loop.setSourcePaused(descriptor_, false);
    if (waiting_) inject(*std::exchange(waiting_, {}));
    dependencies_.connection.flush();
    // What was read ahead meanwhile makes no descriptor readable.
    nextDrain_ = dependencies_.loop.performAfterDelay(0, [this] { drain(); });
}

void TapSession::keyboardChanged(XkbKeyboard::Change change) {
    if (change == XkbKeyboard::Change::Locks) decoder_.adopt(dependencies_.keyboard.locks());
    if (change != XkbKeyboard::Change::Keymap) return;
    keymaps_.coreChanged();
    decoder_.setKeymap(keymaps_.current(), dependencies_.connection.userKeys, dependencies_.keyboard.locks());
}

}  // namespace plume

// The tap while it has the keyboards: from grabbing them until it gives them back or loses the connection.
//
// Every key of theirs comes here, is decoded, told to the listener, and pressed again on the XTEST keyboard unless the
// listener swallowed it. What is down there comes up again in any case: a release follows every press that was passed
// on, whatever the listener says, and releases of keys that were down before the tap are passed on, too. Belongs to the
// tap thread.
#pragma once

#include <xcb/xinput.h>

#include <array>
#include <cstdint>
#include <deque>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "platform/InputMethod.h"
#include "platform/KeyboardTap.h"
#include "ports/posix/PollRunLoop.h"
#include "ports/x11/keyboard/DeviceKeymaps.h"
#include "ports/x11/keyboard/HardwareKeyboards.h"
#include "ports/x11/keyboard/KeyDecoder.h"
#include "ports/x11/keyboard/KeyboardGrabCheck.h"
#include "ports/x11/keyboard/TapConnection.h"
#include "ports/x11/keyboard/XkbKeyboard.h"

namespace plume {

// A key that the user pressed and that passes, by its virtual key code and with the flags of the modifiers held.
using UserTyped = std::function<void(KeyCode keyCode, EventFlags flags)>;

// What is asked at every key before it is told; either may be empty.
struct FocusQuestions {
    std::function<bool()> isPassword;     // what has the focus takes a password
    std::function<bool()> movedByItself;  // since this was asked last
};

class TapSession : public std::enable_shared_from_this<TapSession> {
  public:
    struct Dependencies {
        PollRunLoop& loop;
        TapConnection& connection;
        XkbKeyboard& keyboard;
        KeyboardTapListener& listener;
        const FocusQuestions& focus;
        const UserTyped& userTyped;  // may be empty
        std::function<void()> lost;  // the connection is gone
        EventFlags& toldFlags;       // the modifiers that the listener takes to be held
        InputMethod* inputMethod;    // null: none
    };

    explicit TapSession(Dependencies dependencies);
    TapSession(const TapSession&) = delete;
    TapSession& operator=(const TapSession&) = delete;

    // Takes the keyboards; the error says why there is none to take.
    Result<void> begin();
    // Gives them back. Nothing is down for the programs afterwards: what the user still holds counts when it is pressed
    // anew. Nobody is called any more.
    void end();

    void keyboardChanged(XkbKeyboard::Change change);
    void hold();
    void release();
    // See EventPoster::keepHoldingUserKeys().
    void keepHolding();
    void userClicked();
    // Tells what the input method has put into programs.
    void tellOutcomes();

  private:
    struct Injection {
        xcb_keycode_t keycode;
        bool down;
        bool keepsMenusClosed = false;  // what the listener swallowed would otherwise look like this key alone
    };

    std::optional<std::uint16_t> typedOnLast() const;
    void becomeTypedOn() const;
    void typeOn(std::uint16_t device);
    void selectEvents(std::uint16_t device, std::uint32_t events) const;
    void addSource();
    void passOnUnheard();
    void drain();
    void settle();
    void readAhead();
    void letGoOfKeys();
    XcbOwned<xcb_generic_event_t> nextEvent();
    bool isForWindowManager(const xcb_generic_event_t& event) const;
    bool isInput(const xcb_generic_event_t& event, std::uint16_t type) const;
    bool isKey(const xcb_generic_event_t& event) const;
    void handle(const xcb_generic_event_t& event);
    void handleKey(const xcb_input_key_press_event_t& key);
    void askForGrabs();
    void handleHierarchy(const xcb_input_hierarchy_event_t& event);
    void press(xcb_keycode_t keycode, bool repeated);
    void release(xcb_keycode_t keycode);
    void releaseKeysOf(std::uint16_t device);
    bool mayTell();
    bool isInAnotherField();
    bool tellsKey(const KeyDecoder::Key& key);
    void tellMissedModifiers(EventFlags flags);
    bool tell(const KeyDecoder::Key& key, TapEvent::Type type);
    bool waitsForOutcome(const xcb_generic_event_t& event) const;
    bool goesToInputMethod(const KeyDecoder::Key& key) const;
    void giveToInputMethod(const KeyDecoder::Key& key, xcb_keycode_t keycode, bool repeated);
    void tellOutcome(const InputMethod::Outcome& outcome);
    void inject(Injection injection);
    void send(Injection injection);

    Dependencies dependencies_;
    HardwareKeyboards keyboards_;
    DeviceKeymaps keymaps_;
    KeyDecoder decoder_;
    std::unique_ptr<KeyboardGrabCheck> grabCheck_;
    int descriptor_ = -1;
    bool ended_ = false;

    KeycodeSet seen_;                           // keys that are down and went down here
    KeycodeSet told_;                           // those of them that the listener was told of
    std::array<std::uint16_t, 256> devices_{};  // that a key went down on
    bool withholding_ = false;                  // the latest key went by untold
    bool swallowed_ = false;                    // the latest key that went down was swallowed

    // The key that was announced to the input method last.
    struct Announced {
        KeyCode keyCode = KeyCode::None;
        EventFlags flags;
        std::u16string text;
        bool isTold = false;  // as a key of the program's, which it is unless the engine does something
    };
    Announced announced_;
    bool undecided_ = false;  // the latest key that was told is the input method's

    KeyMoments moments_;

    bool held_ = false;
    std::optional<Injection> waiting_;
    Timer holdLimit_;
    double releasedAt_ = 0;
    bool readsAhead_ = false;                              // held for long: keys are looked at, and wait here
    std::deque<XcbOwned<xcb_generic_event_t>> readAhead_;  // in front of what is unread

    Subscription source_;
    Timer nextDrain_;
};

}  // namespace plume

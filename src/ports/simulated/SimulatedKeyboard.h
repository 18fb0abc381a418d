// The user's keyboard on the simulated desktop: which keys are held, and the way of a key through the tap and the
// system's hot keys to the program in front.
#pragma once

#include <cstdint>
#include <deque>
#include <functional>
#include <optional>
#include <set>
#include <string>

#include "platform/InputSources.h"
#include "platform/RunLoop.h"
#include "ports/simulated/SimulatedInputMethod.h"
#include "ports/simulated/SimulatedKeyboardTap.h"
#include "ports/simulated/SimulatedSystemHotKeys.h"

namespace plume {

class SimulatedKeyboard {
  public:
    // The key code of a character that is on no key.
    static constexpr KeyCode UnmappedKeyCode{0x7F};
    // Held keys follow after this time at the latest, in seconds.
    static constexpr double LongestHold = 2;

    // A key on its way to the program in front.
    struct Key {
        TapEvent::Type type = TapEvent::Type::KeyDown;
        KeyCode keyCode = KeyCode::None;
        EventFlags flags;
        std::u16string string;
        bool isDown = true;
    };
    using Deliver = std::function<void(const Key& key)>;

    // Nothing is owned; all of it outlives the keyboard.
    SimulatedKeyboard(RunLoop& runLoop, const InputSources& inputSources, SimulatedKeyboardTap& tap,
                      SimulatedSystemHotKeys& hotKeys, Deliver deliver);
    SimulatedKeyboard(const SimulatedKeyboard&) = delete;
    SimulatedKeyboard& operator=(const SimulatedKeyboard&) = delete;

    // A key that is down already repeats; a modifier key does not.
    void press(KeyCode keyCode);
    void release(KeyCode keyCode);
    // A key that stands for a character which the layout has on no key.
    void pressCharacter(std::u16string_view character);
    void releaseCharacter(std::u16string_view character);

    SimulatedInputMethod& inputMethod() { return inputMethod_; }
    bool isDown(KeyCode keyCode) const { return down_.contains(keyCode); }
    EventFlags flags() const;

    // Whether the port can make the user's keys wait; it cannot at first.
    void setCanHold(bool can) { canHold_ = can; }
    void hold();
    void letGo();

  private:
    // A held key, and whether the listener has decided about it.
    struct Waiting {
        Key key;
        bool decided;
    };

    void arrive(Key key);
    void decide(const Key& key);
    bool goesToInputMethod(const Key& key) const;
    void compose(const Key& key);
    void tellDelivered(KeyCode keyCode, std::u16string_view text);
    void pass(const Key& key);

    RunLoop& runLoop_;
    const InputSources& inputSources_;
    SimulatedKeyboardTap& tap_;
    SimulatedSystemHotKeys& hotKeys_;
    const Deliver deliver_;
    SimulatedInputMethod inputMethod_;
    std::set<KeyCode> down_;
    std::set<KeyCode> takenBySystem_;  // keys whose release the system keeps as well
    bool canHold_ = false;
    bool holding_ = false;
    bool lettingGo_ = false;
    std::deque<Waiting> waiting_;
    Timer holdLimit_;
};

}  // namespace plume

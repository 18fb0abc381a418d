// Hearing every key of the session before any program does, and deciding whether a program gets it.
//
// The tap belongs to the tap thread: it is created there, and the listener is called there, synchronously, while the
// key waits. A port that loses the tap because an answer took too long says so and leaves the keys alone until
// enable().
#pragma once

#include <string_view>

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"
#include "Foundation/Result.h"

namespace plume {

// What the user did to one key. Keys that Plume posts itself are never reported.
struct TapEvent {
    enum class Type { KeyDown, KeyUp, FlagsChanged };

    Type type = Type::KeyDown;
    KeyCode keyCode = KeyCode::None;
    EventFlags flags = {};       // the modifiers held; for FlagsChanged: from now on
    std::u16string_view string;  // what the key produces, at most 10 units, or what is delivered; valid during the call
    // Part of a sequence of keys that has produced nothing yet: what the key would produce by itself does not count.
    bool composing = false;
    // With the modifiers held, programs take the key for a command, whatever it produces.
    bool command = false;
    // An input method gets the key first; what becomes of it is told later, as what is delivered.
    bool undecided = false;
    // The program has it already, and it cannot be swallowed: text that an input method put there, without a key code,
    // or a key that it passed on. While it goes on `composing`, nothing can be done to the text.
    bool delivered = false;
};

class KeyboardTapListener {
  public:
    virtual ~KeyboardTapListener() = default;
    // True swallows the event: no program gets it.
    virtual bool keyboardEvent(const TapEvent& event) = 0;
    virtual void tapDisabledByTimeout() = 0;
    virtual void tapDisabledByUserInput() = 0;
    // What is typed from here on does not continue what was typed before: keys go by that nobody is told of (into a
    // password, to a program that holds the keyboard, from a program that types), or the focus is elsewhere.
    virtual void typingInterrupted() {}
};

class KeyboardTap {
  public:
    virtual ~KeyboardTap() = default;
    // Starts hearing keys. The listener is not owned and is called until remove(). With `annotatedSession`, at the
    // later of the two places in the event stream where the port has two. The error says what is missing.
    virtual Result<void> create(KeyboardTapListener& listener, bool annotatedSession) = 0;
    virtual bool exists() const = 0;
    // Again after tapDisabledByTimeout.
    virtual void enable() = 0;
    // Keys reach programs without Plume from now on.
    virtual void remove() = 0;
    // Whether a tap could be created at all; creates none. From any thread.
    virtual Result<void> check() const = 0;
};

}  // namespace plume

// An input method between the keyboard and the programs: an engine that gets keys first and may turn them into other
// text. What becomes of a key is known only when the engine has had it.
//
// All on the tap thread.
#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>

namespace plume {

class InputMethod {
  public:
    // What a program got.
    struct Outcome {
        std::size_t erased = 0;  // characters before the caret, before the text came
        std::u16string text;
        bool keyPassed = false;  // behind the text, the key that was announced, as it is
        bool composing = false;  // text is being composed, which the program does not have yet
        bool unknown = false;    // nobody said what became of the key
    };

    virtual ~InputMethod() = default;
    // Keys that type text go to an engine that may turn them into other text.
    virtual bool takesText() const = 0;
    // Text is being composed: all keys go to the engine.
    virtual bool isComposing() const = 0;
    // No key that was announced is to be settled, and there is nothing to take. Asked for every key.
    virtual bool isIdle() const = 0;
    // This key of the hardware (its evdev code) is about to go there; the one announced before has been settled. Of a
    // key that types nothing it is only waited, for a shorter time, until the engine has had it.
    virtual void announceKey(std::uint32_t code, bool typesNothing) = 0;
    // Waits until it is known what became of the key that was announced, 0.1 s from then at most, and 0.3 s more
    // while the engine has it.
    virtual void settle() = 0;
    // The next thing that programs got, in order; nothing when all has been taken.
    virtual std::optional<Outcome> next() = 0;
};

}  // namespace plume

// Synthesised keys and clicks, and the state of the real ones.
//
// Used on the tap thread. Between begin() and end(), which nest, a port may gather events and send them together; what
// was posted reaches the program in front in that order, and the tap never reports it as typed.
#pragma once

#include <string_view>

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"
#include "platform/Accessibility.h"

namespace plume {

// One key going down or up: a key by its code, or, with a text, a key that produces just that text.
struct SynthesisedKey {
    KeyCode keyCode = KeyCode::None;
    EventFlags flags = {};  // of the held modifiers
    bool down = true;
    std::u16string_view text;
};

class EventPoster {
  public:
    virtual ~EventPoster() = default;

    virtual void begin() = 0;
    virtual void end() = 0;
    // With `pastTap`, by the way around the tapped stream where the port has two.
    virtual void post(const SynthesisedKey& key, bool pastTap) = 0;

    // Whether post() can produce every character of this text now; otherwise it has to be pasted.
    virtual bool canType(std::u16string_view text) const = 0;

    // The key of a shortcut with this small letter or other ASCII character. Never none.
    virtual KeyCode keyCodeOfLetter(char16_t letter) const = 0;

    // Whether the user holds this key now.
    virtual bool isKeyDown(KeyCode keyCode) const = 0;

    // From the top left of the main screen.
    virtual Point pointerLocation() const = 0;
    // A press and a release of the left button at that place.
    virtual void click(Point location) = 0;

    // The user's own keys from now on, with the one being decided about if it is passed on, wait until the output in
    // flight is complete, and follow in order; a port that cannot do it does nothing. They wait 2 seconds at most.
    virtual void holdUserKeys() = 0;
    virtual void releaseUserKeys() = 0;
    // Keys that wait go on doing so for 2 seconds from now, because the program in front hangs or what they are for is
    // not there yet. Those that the programs have down are let go of, so that none begins to repeat. A click, and a key
    // with Alt or Super, with which people leave such a program, end the waiting.
    virtual void keepHoldingUserKeys() = 0;
};

}  // namespace plume

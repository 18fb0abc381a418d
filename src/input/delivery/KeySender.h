// The keystrokes that delivery is made of: typed chunks, keys, backspaces, arrows, the paste and copy commands.
//
// Owned by the input service; used on the tap thread. While a primitive runs isSending() is true and the tap lets
// everything pass. Lengths and counts are UTF-16 units and key presses.
#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

#include "input/delivery/ContextInputSetting.h"
#include "platform/Accessibility.h"
#include "platform/EventPoster.h"

namespace plume {

// The keys that type "V" and "C" in the user's keyboard layout.
struct CommandKeyCodes {
    KeyCode v = KeyCode::V;
    KeyCode c = KeyCode::C;
};

class KeySender {
  public:
    KeySender(EventPoster& poster, const Accessibility& accessibility);

    // The setting in force: how long chunks are, which way events go. Null until the first application is resolved.
    void setContextInputSetting(std::shared_ptr<const ContextInputSetting> setting) { setting_ = std::move(setting); }
    void setCommandKeyCodes(CommandKeyCodes codes) { commandKeys_ = codes; }

    bool isSending() const { return sending_; }

    // Types the text in chunks, none of the modifiers held.
    void sendPlainText(std::u16string_view text);
    // Down and up, `count` times.
    void sendKey(KeyCode keyCode, EventFlags flags = {}, std::uint64_t count = 1);
    // When text is selected, one forward delete comes first: it takes the selection, and the rest what was typed.
    void sendBackspaces(std::uint64_t count);
    void sendLeftArrowKeys(std::uint64_t count);
    void sendShiftTab();
    // For a program that proposes how a word goes on: what it has proposed is overwritten, and the text stands as it
    // was typed. Without a proposal nothing changes.
    void overtypeCompletion();
    // Control in place of Command counts where the setting names no keys.
    void sendCopyCommand(const ContextInputSetting& setting, bool withControl);
    void sendPasteCommand(const ContextInputSetting& setting);

  private:
    // Marks the time of a primitive.
    class Sending {
      public:
        explicit Sending(KeySender& sender);
        ~Sending();
        Sending(const Sending&) = delete;
        Sending& operator=(const Sending&) = delete;

      private:
        KeySender& sender_;
    };

    void post(KeyCode keyCode, EventFlags flags, bool down, std::u16string_view text = {});
    bool losesRepeatedKeys() const { return setting_ && setting_->losesRepeatedKeys; }
    void press(KeyCode keyCode, EventFlags flags);
    void tap(KeyCode keyCode, EventFlags flags, std::u16string_view text = {});
    void type(std::u16string_view text);
    void press(const Keystrokes& keys);
    void sendAlternativePaste(const ContextInputSetting& setting, EventFlag modifier);

    EventPoster& poster_;
    const Accessibility& accessibility_;
    std::shared_ptr<const ContextInputSetting> setting_;
    CommandKeyCodes commandKeys_;
    bool sending_ = false;
    // What was pressed last, or typed.
    KeyCode lastKey_ = KeyCode::None;
    std::u16string lastCharacter_;
};

}  // namespace plume

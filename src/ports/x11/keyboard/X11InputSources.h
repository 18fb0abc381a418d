// The keyboard layout in force on X11, or the engine of an input method that works behind it.
#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <utility>

#include "platform/InputSources.h"
#include "ports/x11/keyboard/XkbKeyboard.h"

namespace plume {

// On the tap thread. The identifier is that of the input method's engine, where one turns keys into other text; else
// the layout, with its variant in parentheses: "us", "de(nodeadkeys)".
class X11InputSources final : public InputSources {
  public:
    // The keyboard outlives it.
    explicit X11InputSources(XkbKeyboard& keyboard);
    X11InputSources(const X11InputSources&) = delete;
    X11InputSources& operator=(const X11InputSources&) = delete;

    // The engine in force, such as "ibus:libpinyin"; empty: none.
    void setEngine(const std::string& identifier);

    const std::optional<std::u16string>& currentInputSourceIdentifier() const override { return identifier_; }
    // Option changes no text on X11: what types third-level characters is no modifier but a level chooser. Keypad keys
    // type digits.
    std::optional<std::u16string> translateKey(KeyCode keyCode, EventFlags flags) const override;
    void setChangeListener(std::function<void()> listener) override { listener_ = std::move(listener); }

  private:
    void readIdentifier();
    void tell() const;
    void changed(const XkbKeyboard::Change& change);

    const XkbKeyboard& keyboard_;
    std::string engine_;
    std::optional<std::u16string> identifier_;
    std::function<void()> listener_;
    Subscription keyboardChanged_;
};

}  // namespace plume

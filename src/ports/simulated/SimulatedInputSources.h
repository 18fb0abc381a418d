// The simulated keyboard: a US layout, under whatever identifier is set.
#pragma once

#include <string_view>
#include <utility>

#include "platform/InputSources.h"

namespace plume {

class SimulatedInputSources final : public InputSources {
  public:
    // A key, and whether Shift is held with it.
    struct Stroke {
        KeyCode keyCode = KeyCode::None;
        bool shift = false;
    };

    static constexpr std::u16string_view US = u"org.example.keylayout.US";

    // Tells the change listener.
    void setIdentifier(std::optional<std::u16string> identifier);

    // How a person types this character; nothing when it is on no key. A line feed is Return.
    static std::optional<Stroke> strokeFor(char16_t character);

    const std::optional<std::u16string>& currentInputSourceIdentifier() const override { return identifier_; }
    std::optional<std::u16string> translateKey(KeyCode keyCode, EventFlags flags) const override;
    void setChangeListener(std::function<void()> listener) override { listener_ = std::move(listener); }

  private:
    std::optional<std::u16string> identifier_{US};
    std::function<void()> listener_;
};

}  // namespace plume

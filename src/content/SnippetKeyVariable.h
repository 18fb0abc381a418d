// A key pressed in the middle of the text.
#pragma once

#include <cstdint>
#include <string>

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"
#include "content/SnippetVariable.h"

namespace plume {

class SnippetKeyVariable final : public SnippetVariable {
  public:
    // What a body may ask for at most; more is brought down to it when it is read.
    static constexpr std::uint64_t MaximumCount = 10'000;
    static constexpr double MaximumDelay = 24 * 60 * 60;

    SnippetKeyVariable() = default;
    // A code outside 16 bits is no key; a count below 1 or unreadable is 1; a negative or unreadable delay is 0.
    explicit SnippetKeyVariable(const VariableParams& params);
    SnippetKeyVariable(std::u16string label, KeyCode code);
    std::u16string toString() const override;

    bool shift() const;
    bool control() const;
    bool option() const;
    bool command() const;

    bool isArrow() const;
    bool isReturnOrTab() const;
    // Return, Tab and the keypad's Enter: one press is one place for the caret.
    bool movesCaret() const;

    Text key;  // the label shown to the user
    KeyCode keyCode = KeyCode::None;
    std::uint64_t count = 1;
    double delay = 0;  // seconds
    EventFlags modifiers;
};

}  // namespace plume

// The short names of keys, as hot-key fields and key placeholders show them, and the key of a name.
//
// Belongs to the thread of the input sources. The names of keys that type text follow the keyboard layout: the owner
// regenerates the map when that changes.
#pragma once

#include <cstdint>
#include <functional>
#include <map>
#include <optional>
#include <string>
#include <string_view>

#include "platform/InputSources.h"

namespace plume {

// What is translated for the user.
struct KeyNameTexts {
    std::u16string space = u"Space";
    std::u16string keypad = u"Pad %@";  // %@: what the key types
};

class SRKeyCodeTransformer {
  public:
    // The input sources are not owned and outlive the transformer.
    explicit SRKeyCodeTransformer(const InputSources& inputSources, KeyNameTexts texts = {});

    // Nothing for a key that has no name, and for a code that is negative as 16 bits.
    std::optional<std::u16string> transformedValue(std::int64_t keyCode) const;
    std::optional<std::uint16_t> reverseTransformedValue(std::u16string_view name) const;
    // KeyCode::None for an unknown name.
    std::uint16_t keyCodeForString(std::u16string_view name) const;
    void regenerateStringToKeyCodeMapping();

  private:
    const InputSources& inputSources_;
    KeyNameTexts texts_;
    std::map<std::u16string, std::uint16_t, std::less<>> keyCodes_;
};

}  // namespace plume

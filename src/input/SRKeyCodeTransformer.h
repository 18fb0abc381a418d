// The short names of keys, as hot-key fields and key placeholders show them, and the key of a name.
//
// Belongs to the thread of the input sources. The names of keys that type text follow the keyboard layout: the owner
// regenerates the map when that changes.
#pragma once

#include <functional>
#include <map>
#include <optional>
#include <string>
#include <string_view>

#include "Foundation/KeyCode.h"
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

    // Nothing for a key that has no name, or a code of 32768 and above.
    std::optional<std::u16string> transformedValue(KeyCode keyCode) const;
    std::optional<KeyCode> reverseTransformedValue(std::u16string_view name) const;
    // KeyCode::None for an unknown name.
    KeyCode keyCodeForString(std::u16string_view name) const;
    void regenerateStringToKeyCodeMapping();

  private:
    const InputSources& inputSources_;
    KeyNameTexts texts_;
    std::map<std::u16string, KeyCode, std::less<>> keyCodes_;
};

}  // namespace plume

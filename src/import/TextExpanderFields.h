// The fields of TextExpander's forms: "filltext:name=Who:default=you:width=20".
#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace plume {

// The placeholder that says the same as this text between percent signs; nothing when it is no field.
std::optional<std::u16string> fieldFromTextExpander(std::u16string_view macro);

// "fillpart:name=Greeting:default=yes", which makes what follows a part that can be left out.
struct TextExpanderPart {
    std::u16string name;
    bool isSelected = true;  // at first
};
std::optional<TextExpanderPart> partFromTextExpander(std::u16string_view macro);

// The field that writes `content`, or not.
std::u16string bodyOfPart(const TextExpanderPart& part, std::u16string_view content);

}  // namespace plume

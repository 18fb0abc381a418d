#include "import/PropertyListFields.h"

#include <cmath>

#include "Foundation/Strings.h"

namespace plume {

std::optional<std::u16string> textAt(const PropertyList& dictionary, std::string_view key) {
    const auto* text = dictionary.find<std::u16string>(key);
    return text ? std::optional(*text) : std::nullopt;
}

std::optional<std::int64_t> integerAt(const PropertyList& dictionary, std::string_view key) {
    constexpr double Most = 1e15;
    if (const auto* integer = dictionary.find<std::int64_t>(key)) return *integer;
    if (const auto* truth = dictionary.find<bool>(key)) return *truth ? 1 : 0;
    if (const auto* real = dictionary.find<double>(key); real && std::abs(*real) < Most) {
        return static_cast<std::int64_t>(*real);
    }
    if (const auto* text = dictionary.find<std::u16string>(key)) return integerValue(*text);
    return std::nullopt;
}

}  // namespace plume

// What the tests of rich text have in common.
#pragma once

#include <functional>
#include <memory>
#include <string>
#include <utility>

#include "Foundation/text/AttributedString.h"

namespace plume {

// The attributes of the unit at `index`, or none.
inline TextAttributes attributesAt(const AttributedString& text, std::size_t index) {
    const SharedAttributes attributes = text.attributesAt(index);
    return attributes ? *attributes : TextAttributes{};
}

inline AttributedString attributed(std::u16string text, const std::function<void(TextAttributes&)>& set) {
    auto attributes = std::make_shared<TextAttributes>();
    set(*attributes);
    return AttributedString(std::move(text), attributes);
}

inline std::shared_ptr<const TextAttachment> attachment(std::u16string name, std::string contents) {
    return std::make_shared<const TextAttachment>(TextAttachment{std::move(name), std::move(contents), {}});
}

}  // namespace plume

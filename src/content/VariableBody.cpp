#include "content/VariableBody.h"

#include <algorithm>

#include "Foundation/Strings.h"
#include "content/SnippetVariableUtils.h"

namespace plume {

std::optional<std::u16string> textParam(const VariableParams& params, std::u16string_view name) {
    const auto found = params.find(name);
    if (found == params.end()) return std::nullopt;
    return found->second;
}

std::int64_t integerParam(const VariableParams& params, std::u16string_view name) {
    const auto found = params.find(name);
    return found == params.end() ? 0 : integerValue(found->second);
}

std::int32_t shortIntegerParam(const VariableParams& params, std::u16string_view name) {
    using Limits = std::numeric_limits<std::int32_t>;
    return static_cast<std::int32_t>(
        std::clamp<std::int64_t>(integerParam(params, name), Limits::min(), Limits::max()));
}

void BodyWriter::part(std::u16string_view text) {
    if (text.empty()) return;
    if (!body_.empty()) body_ += u' ';
    body_ += text;
}

void BodyWriter::param(std::u16string_view name, std::u16string_view value) {
    part(name);
    body_ += u':';
    body_ += SnippetVariableUtils::escapeParam(value);
}

void BodyWriter::param(std::u16string_view name, std::int64_t value) {
    param(name, fromUtf8(std::to_string(value)));
}

void BodyWriter::unsignedParam(std::u16string_view name, std::uint64_t value) {
    param(name, fromUtf8(std::to_string(value)));
}

void BodyWriter::paramUnlessZero(std::u16string_view name, std::int64_t value) {
    if (value != 0) param(name, value);
}

void BodyWriter::paramIfSet(std::u16string_view name, const std::optional<std::u16string>& value) {
    if (value) param(name, *value);
}

}  // namespace plume

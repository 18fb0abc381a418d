// Helpers of the placeholder kinds: fetching parameters by name, and writing a body part by part.
#pragma once

#include <cstdint>
#include <limits>
#include <optional>
#include <string>
#include <string_view>

#include "content/SnippetVariable.h"

namespace plume {

// Nothing when the body has no such parameter.
std::optional<std::u16string> textParam(const VariableParams& params, std::u16string_view name);
// 0 when the parameter is missing or no number; brought into 32 bits by the second.
std::int64_t integerParam(const VariableParams& params, std::u16string_view name);
std::int32_t shortIntegerParam(const VariableParams& params, std::u16string_view name);

// Parts of a body, joined by single spaces.
class BodyWriter {
  public:
    // A part as it stands; an empty one is left out.
    void part(std::u16string_view text);
    // "name:value", the value escaped where it must be.
    void param(std::u16string_view name, std::u16string_view value);
    void param(std::u16string_view name, std::int64_t value);
    void unsignedParam(std::u16string_view name, std::uint64_t value);
    // As above, unless the value is 0 or absent.
    void paramUnlessZero(std::u16string_view name, std::int64_t value);
    void paramIfSet(std::u16string_view name, const std::optional<std::u16string>& value);

    std::u16string take() { return std::move(body_); }

  private:
    std::u16string body_;
};

}  // namespace plume

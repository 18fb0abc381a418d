// Reading and writing the body of a placeholder, the text between its markers: a row of parameters, "name:value".
#pragma once

#include <cstdint>
#include <functional>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

namespace plume {

inline constexpr char16_t OpeningMarker = u'\u3010';
inline constexpr char16_t ClosingMarker = u'\u3011';

// The parameters of a body by name; a parameter without a value maps to the empty string.
using VariableParams = std::map<std::u16string, std::u16string, std::less<>>;

// The parameters of a body, read as CSVParser reads rows of "Name" and "Value" with ":" between fields and spaces
// between rows: a body that starts with a space has none, a stray double quote ends the reading, and of parameters with
// the same name the last one counts. Never fails; takes time linear in the body.
VariableParams parseParams(std::u16string_view body);

// Nothing when the body has no such parameter.
std::optional<std::u16string> textParam(const VariableParams& params, std::u16string_view name);
// 0 when the parameter is missing or no number; brought into 32 bits by the second.
std::int64_t integerParam(const VariableParams& params, std::u16string_view name);
std::int32_t shortIntegerParam(const VariableParams& params, std::u16string_view name);

// A parameter's value as it must be written to be read back.
std::u16string escapeParam(std::u16string_view value);

// Writes a body part by part, with single spaces between them.
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

// Writes what other text expanders can say with placeholders of Plume.
//
// The results are pieces of content in UTF-16. Markers within values, for which there is no escape, are left out.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace plume {

struct ForeignField {
    std::u16string name;
    bool isMultiline = false;
    std::vector<std::u16string> choices;  // none: something to write
    std::u16string initial;
};

inline constexpr std::u16string_view CaretPlaceholder = u"\u3010|\u3011";
inline constexpr std::u16string_view ClipboardPlaceholder = u"\u3010clipboard\u3011";

std::u16string fieldPlaceholder(const ForeignField& field);
// `uuid` may be empty.
std::u16string snippetPlaceholder(std::u16string_view abbreviation, std::u16string_view uuid);
// A key by its English name in any case ("enter", "tab", "left", "f5", "a"), with modifier flags; nothing when Plume
// knows no such key.
std::optional<std::u16string> keyPlaceholder(std::string_view name, std::uint64_t modifiers, std::int64_t count);

// A piece of a date: letters of a date pattern that show the day or the time, or text.
struct DatePiece {
    enum class Kind { Text, Day, Time };
    Kind kind = Kind::Text;
    std::u16string text;
};

struct DateShift {
    std::int64_t years = 0;
    std::int64_t months = 0;
    std::int64_t days = 0;
    std::int64_t seconds = 0;  // within the day that is shown, when a time is shown
};

// Nothing when the pieces cannot be shown shifted like this: a day by hours.
std::optional<std::u16string> datePlaceholders(const std::vector<DatePiece>& pieces, const DateShift& shift,
                                               std::u16string_view locale);

// The pieces of a format for strftime, or nothing when it asks for what date patterns do not have.
std::optional<std::vector<DatePiece>> piecesOfStrftime(std::u16string_view format);

// Whether text of another program holds an opening marker, which Plume takes for the start of a placeholder.
bool holdsMarker(std::u16string_view text);

}  // namespace plume

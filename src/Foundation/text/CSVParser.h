// Reading text of separated values.
//
// The dialect: fields stand between separators, records between runs of line separators, so empty lines between records
// are skipped. A field that starts with a double quote runs to the closing one, and a doubled one in it stands for one.
// What breaks these rules ends the parse; everything read before it is kept. A text that starts with a line separator
// gives nothing.
#pragma once

#include <cstddef>
#include <functional>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/CharacterSet.h"

namespace plume {

// A plain object for one thread. Linear in the length of the text.
class CSVParser {
  public:
    // Field names and values. A short record has no entry for the columns that it lacks.
    using Row = std::map<std::u16string, std::u16string>;

    // A record that has more fields ends the parse, after being given with this many.
    static constexpr std::size_t MaxFieldsPerRecord = 65536;

    // Without `lineSeparator` any newline character separates records. `hasHeader` takes the names from the first
    // record in place of `fieldNames`. Throws std::invalid_argument when the separator is empty or holds a double quote
    // or a line separator: a mistake of the calling code, not of the text.
    CSVParser(std::u16string text, std::u16string separator, std::optional<CharacterSet> lineSeparator, bool hasHeader,
              std::vector<std::u16string> fieldNames);

    // All rows in order, or nothing when there is not even one.
    std::optional<std::vector<Row>> arrayOfParsedRows();
    // Hands over each row as soon as it is read, so that only one is held at a time. False when there is not even one.
    bool parseRowsForReceiver(const std::function<void(Row)>& receiver);

    // The columns known so far. Those beyond the given or read names are called FIELD_<number>, counted from 1.
    const std::vector<std::u16string>& fieldNames() const { return fieldNames_; }

  private:
    bool parseHeader();
    // Calls `receive` with each field and its index; false when no record starts here.
    template <typename Receive>
    bool parseRecord(Receive receive);
    std::optional<std::u16string> parseField();
    std::optional<std::u16string> parseEscaped();
    std::u16string parseNonEscaped();
    bool parseSeparator();
    bool parseLineSeparators();
    bool isAtEnd() const { return position_ == text_.size(); }
    bool isAtLineSeparator() const { return !isAtEnd() && lineSeparator_.contains(text_[position_]); }
    bool isAtSeparator() const;
    const std::u16string& nameOfField(std::size_t index);

    std::u16string text_;
    std::u16string separator_;
    CharacterSet lineSeparator_;
    CharacterSet endTextCharacterSet_;  // what may end a field without quotes
    bool hasHeader_;
    std::vector<std::u16string> fieldNames_;
    std::size_t position_ = 0;
};

}  // namespace plume

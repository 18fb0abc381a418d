// Text of separated values: reading and writing.
#pragma once

#include <cstddef>
#include <filesystem>
#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <ostream>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/CharacterSet.h"
#include "Foundation/Result.h"

namespace plume {

// Reads records from a text, where
// - fields stand between separators, and records between runs of line separators, so empty lines are skipped;
// - a field that starts with a double quote runs to the closing one, and a doubled one in it stands for one;
// - what breaks these rules ends the parse, and everything read before it is kept;
// - a text that starts with a line separator gives nothing.
//
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

    // Where the last parse ended: at the end of the text, or where it broke the rules.
    std::size_t position() const { return position_; }

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

// Utf8 has no byte-order mark; Utf16 is little-endian and starts with one.
enum class CsvEncoding { Utf8, Utf16 };

// Writes records that CSVParser and others read. A field that holds a newline character, the delimiter or a double
// quote is put in double quotes, with its own doubled. Lines end in a line feed.
//
// A plain object for one thread. Writing goes on without complaint when the stream fails; closeStream tells.
class CsvWriter {
  public:
    using Field = std::optional<std::u16string>;

    // A new file, or in place of what the file held, in UTF-8 with commas. Fails when the file cannot be opened.
    static Result<CsvWriter> makeForWritingToCSVFile(const std::filesystem::path& path);

    // The stream is not owned, and must outlive the writer. A byte-order mark is written at once.
    CsvWriter(std::ostream& stream, CsvEncoding encoding, char16_t delimiter);

    // Nothing counts as the empty text.
    void writeField(const Field& field);
    void finishLine();
    // Finishes a started line before, and its own after; no fields give an empty line.
    void writeLineOfFields(const std::vector<Field>& fields);
    // Finishes a started line, then writes each line of the text behind a "#". CSVParser takes these lines for records.
    void writeComment(std::u16string_view comment);

    // Brings everything to its place, and closes a file made by this class. Fails when anything could not be written;
    // the writer must not be used afterwards.
    Result<void> closeStream();

  private:
    void finishStartedLine();
    // Without a byte-order mark.
    void write(std::u16string_view text);

    std::unique_ptr<std::ostream> ownedStream_;  // null when the stream is somebody else's
    std::ostream* stream_;
    CsvEncoding encoding_;
    char16_t delimiter_;
    CharacterSet illegalCharacters_;  // what makes quotes necessary
    std::size_t currentField_ = 0;
};

}  // namespace plume

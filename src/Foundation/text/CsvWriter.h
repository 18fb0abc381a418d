// Writing text of separated values that CSVParser and others read.
//
// A field that holds a newline character, the delimiter or a double quote is put in double quotes, with its own
// doubled. Lines end in a line feed.
#pragma once

#include <cstddef>
#include <filesystem>
#include <memory>
#include <optional>
#include <ostream>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/CharacterSet.h"
#include "Foundation/Result.h"

namespace plume {

// Utf8 has no byte-order mark; Utf16 is little-endian and starts with one.
enum class CsvEncoding { Utf8, Utf16 };

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

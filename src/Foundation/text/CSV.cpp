#include "Foundation/text/CSV.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <fstream>
#include <stdexcept>
#include <utility>

#include "Foundation/Strings.h"

namespace plume {

namespace {

constexpr char16_t Quote = u'"';
constexpr char16_t ByteOrderMark = u'\uFEFF';

std::string utf16Bytes(std::u16string_view text) {
    std::string bytes;
    bytes.reserve(text.size() * 2);
    for (const char16_t unit : text) {
        bytes += static_cast<char>(unit & 0xff);
        bytes += static_cast<char>(unit >> 8);
    }
    return bytes;
}

}  // namespace

// ---- Reading ----

CSVParser::CSVParser(std::u16string text, std::u16string separator, std::optional<CharacterSet> lineSeparator,
                     bool hasHeader, std::vector<std::u16string> fieldNames)
    : text_(std::move(text)),
      separator_(std::move(separator)),
      lineSeparator_(lineSeparator ? *lineSeparator : CharacterSet::newlines()),
      hasHeader_(hasHeader),
      fieldNames_(std::move(fieldNames)) {
    const auto forbidden = [&](char16_t unit) { return unit == Quote || lineSeparator_.contains(unit); };
    if (separator_.empty() || std::any_of(separator_.begin(), separator_.end(), forbidden)) {
        throw std::invalid_argument(
            "CSV separator string must not be empty and must not contain the double quote character or newline "
            "characters.");
    }
    endTextCharacterSet_ =
        lineSeparator_.united(CharacterSet::withCharacters(std::u16string{Quote, separator_.front()}));
}

std::optional<std::vector<CSVParser::Row>> CSVParser::arrayOfParsedRows() {
    std::vector<Row> rows;
    if (!parseRowsForReceiver([&](Row row) { rows.push_back(std::move(row)); })) return std::nullopt;
    return rows;
}

bool CSVParser::parseRowsForReceiver(const std::function<void(Row)>& receiver) {
    position_ = 0;
    if (hasHeader_ && !parseHeader()) return false;
    bool any = false;
    do {
        Row row;
        const auto store = [&](std::size_t index, std::u16string field) {
            row.insert_or_assign(nameOfField(index), std::move(field));
        };
        if (!parseRecord(store)) break;
        any = true;
        receiver(std::move(row));
    } while (parseLineSeparators());
    return any;
}

bool CSVParser::parseHeader() {
    std::vector<std::u16string> names;
    if (!parseRecord([&](std::size_t, std::u16string name) { names.push_back(std::move(name)); })) return false;
    fieldNames_ = std::move(names);
    return parseLineSeparators();
}

template <typename Receive>
bool CSVParser::parseRecord(Receive receive) {
    if (isAtEnd() || isAtLineSeparator()) return false;
    std::size_t count = 0;
    do {
        std::optional<std::u16string> field = parseField();
        if (!field) break;
        receive(count++, std::move(*field));
    } while (count < MaxFieldsPerRecord && parseSeparator());
    return count > 0;
}

std::optional<std::u16string> CSVParser::parseField() {
    if (!isAtEnd() && text_[position_] == Quote) return parseEscaped();
    return parseNonEscaped();
}

std::optional<std::u16string> CSVParser::parseEscaped() {
    std::u16string field;
    std::size_t start = position_ + 1;
    for (;;) {
        const std::size_t quote = text_.find(Quote, start);
        if (quote == std::u16string::npos) return std::nullopt;
        field.append(text_, start, quote - start);
        start = quote + 1;
        if (start == text_.size() || text_[start] != Quote) break;
        field += Quote;
        ++start;
    }
    position_ = start;
    return field;
}

std::u16string CSVParser::parseNonEscaped() {
    const std::size_t start = position_;
    for (; !isAtEnd(); ++position_) {
        if (!endTextCharacterSet_.contains(text_[position_])) continue;
        // The first unit of a longer separator is text unless all of the separator follows.
        const bool isText = text_[position_] == separator_.front() && !isAtSeparator();
        if (!isText) break;
    }
    return text_.substr(start, position_ - start);
}

bool CSVParser::isAtSeparator() const {
    return text_.compare(position_, separator_.size(), separator_) == 0;
}

bool CSVParser::parseSeparator() {
    if (!isAtSeparator()) return false;
    position_ += separator_.size();
    return true;
}

bool CSVParser::parseLineSeparators() {
    const std::size_t start = position_;
    while (isAtLineSeparator()) ++position_;
    return position_ > start;
}

const std::u16string& CSVParser::nameOfField(std::size_t index) {
    if (index == fieldNames_.size()) fieldNames_.push_back(u"FIELD_" + fromUtf8(std::to_string(index + 1)));
    return fieldNames_[index];
}

// ---- Writing ----

Result<CsvWriter> CsvWriter::makeForWritingToCSVFile(const std::filesystem::path& path) {
    errno = 0;
    auto file = std::make_unique<std::ofstream>(path, std::ios::binary | std::ios::trunc);
    if (!*file) {
        const char* reason = errno != 0 ? std::strerror(errno) : "unknown reason";
        return Error{"The file " + path.string() + " cannot be written: " + reason + "."};
    }
    CsvWriter writer(*file, CsvEncoding::Utf8, u',');
    writer.ownedStream_ = std::move(file);
    return writer;
}

CsvWriter::CsvWriter(std::ostream& stream, CsvEncoding encoding, char16_t delimiter)
    : stream_(&stream),
      encoding_(encoding),
      delimiter_(delimiter),
      illegalCharacters_(
          CharacterSet::newlines().united(CharacterSet::withCharacters(std::u16string{Quote, delimiter}))) {
    if (encoding == CsvEncoding::Utf16) write({&ByteOrderMark, 1});
}

void CsvWriter::writeField(const Field& field) {
    const std::u16string_view text = field ? std::u16string_view(*field) : std::u16string_view();
    if (currentField_++ > 0) write({&delimiter_, 1});
    const auto isIllegal = [&](char16_t unit) { return illegalCharacters_.contains(unit); };
    if (std::none_of(text.begin(), text.end(), isIllegal)) {
        write(text);
        return;
    }
    std::u16string quoted(1, Quote);
    quoted.reserve(text.size() + 2);
    for (const char16_t unit : text) {
        if (unit == Quote) quoted += Quote;
        quoted += unit;
    }
    quoted += Quote;
    write(quoted);
}

void CsvWriter::finishLine() {
    write(u"\n");
    currentField_ = 0;
}

void CsvWriter::finishStartedLine() {
    if (currentField_ > 0) finishLine();
}

void CsvWriter::writeLineOfFields(const std::vector<Field>& fields) {
    finishStartedLine();
    for (const Field& field : fields) writeField(field);
    finishLine();
}

void CsvWriter::writeComment(std::u16string_view comment) {
    finishStartedLine();
    const auto isNewline = [](char16_t unit) { return CharacterSet::newlines().contains(unit); };
    for (;;) {
        const auto end = std::find_if(comment.begin(), comment.end(), isNewline);
        const auto length = static_cast<std::size_t>(end - comment.begin());
        write(u"#");
        write(comment.substr(0, length));
        write(u"\n");
        if (length == comment.size()) break;
        const bool isPair = comment.substr(length).starts_with(u"\r\n");
        comment.remove_prefix(length + (isPair ? 2 : 1));
    }
}

Result<void> CsvWriter::closeStream() {
    stream_->flush();
    const bool written = stream_->good();
    ownedStream_.reset();
    if (!written) return Error{"The text of separated values could not be written completely."};
    return {};
}

void CsvWriter::write(std::u16string_view text) {
    const std::string bytes = encoding_ == CsvEncoding::Utf8 ? toUtf8(text) : utf16Bytes(text);
    stream_->write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
}

}  // namespace plume

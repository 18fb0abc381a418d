#include "Foundation/text/CsvWriter.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <fstream>
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

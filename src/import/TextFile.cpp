#include "import/TextFile.h"

#include <unicode/ucnv.h>

#include <algorithm>
#include <limits>
#include <optional>

#include "Foundation/Strings.h"

namespace plume {

namespace {

constexpr std::string_view Utf8Mark = "\xEF\xBB\xBF";

Result<std::u16string> decoded(std::string_view bytes, const char* encoding) {
    constexpr std::size_t Most = std::numeric_limits<std::int32_t>::max() / 2;
    if (bytes.size() > Most) return Error{"the file is too large for a text"};
    UErrorCode status = U_ZERO_ERROR;
    UConverter* const converter = ucnv_open(encoding, &status);
    std::u16string text(bytes.size(), u'\0');
    const std::int32_t length = ucnv_toUChars(converter, text.data(), static_cast<std::int32_t>(text.size()),
                                              bytes.data(), static_cast<std::int32_t>(bytes.size()), &status);
    ucnv_close(converter);
    if (U_FAILURE(status)) return Error{std::string("the text cannot be read as ") + encoding};
    text.resize(static_cast<std::size_t>(length));
    return text;
}

// "UTF-16LE" or "UTF-16BE" when nearly every character of the beginning has a 0 in the same half; else null.
const char* obviousUtf16(std::string_view bytes) {
    constexpr std::size_t Looked = 4096;
    if (bytes.size() % 2 != 0) return nullptr;
    const std::string_view start = bytes.substr(0, Looked);
    std::size_t zeros[2] = {0, 0};
    for (std::size_t i = 0; i < start.size(); ++i) zeros[i % 2] += start[i] == '\0';
    const std::size_t many = std::max<std::size_t>(1, start.size() / 2 * 3 / 4);
    if (zeros[1] >= many && zeros[0] == 0) return "UTF-16LE";
    if (zeros[0] >= many && zeros[1] == 0) return "UTF-16BE";
    return nullptr;
}

Result<std::u16string> decodedByLook(std::string_view bytes, CodePage otherwise) {
    if (bytes.starts_with("\xFF\xFE") || bytes.starts_with("\xFE\xFF")) return decoded(bytes, "UTF-16");
    if (const char* const encoding = obviousUtf16(bytes)) return decoded(bytes, encoding);
    if (bytes.starts_with(Utf8Mark)) bytes.remove_prefix(Utf8Mark.size());
    if (auto text = fromStrictUtf8(bytes)) return std::move(*text);
    return decoded(bytes, otherwise == CodePage::MacRoman ? "macintosh" : "windows-1252");
}

}  // namespace

Result<std::u16string> textOfFile(std::string_view bytes, CodePage otherwise) {
    Result<std::u16string> text = decodedByLook(bytes, otherwise);
    if (!text) return text;
    const std::size_t nul = text.value().find(u'\0');
    if (nul == std::u16string::npos) return text;
    return Error{"line " + std::to_string(lineNumberAt(text.value(), nul)) +
                 ": a NUL character, which no text has; expected a text file"};
}

std::size_t lineNumberAt(std::u16string_view text, std::size_t position) {
    const std::u16string_view before = text.substr(0, position);
    std::size_t number = 1;
    for (std::size_t i = 0; i < before.size(); ++i) {
        const bool isPair = before[i] == u'\r' && i + 1 < text.size() && text[i + 1] == u'\n';
        if (before[i] == u'\n' || (before[i] == u'\r' && !isPair)) ++number;
    }
    return number;
}

}  // namespace plume

#include "app/cli/CsvLibrary.h"

#include <unicode/ucnv.h>

#include <algorithm>
#include <limits>
#include <optional>
#include <utility>

#include "Foundation/Strings.h"
#include "Foundation/text/CSV.h"

namespace plume {

namespace {

constexpr const char16_t* Abbreviation = u"Name";
constexpr const char16_t* Content = u"Value";
constexpr const char16_t* Label = u"Label";

// Every sequence of bytes is a text in these; nothing only when ICU lacks the encoding.
std::optional<std::u16string> decoded(std::string_view bytes, const char* encoding) {
    constexpr std::size_t Most = std::numeric_limits<std::int32_t>::max() / 2;
    if (bytes.size() > Most) return std::nullopt;
    UErrorCode status = U_ZERO_ERROR;
    UConverter* const converter = ucnv_open(encoding, &status);
    if (U_FAILURE(status)) return std::nullopt;
    std::u16string text(bytes.size(), u'\0');
    const std::int32_t length = ucnv_toUChars(converter, text.data(), static_cast<std::int32_t>(text.size()),
                                              bytes.data(), static_cast<std::int32_t>(bytes.size()), &status);
    ucnv_close(converter);
    if (U_FAILURE(status)) return std::nullopt;
    text.resize(static_cast<std::size_t>(length));
    return text;
}

std::optional<std::u16string> textOf(std::string_view bytes) {
    constexpr std::string_view Utf8Mark = "\xEF\xBB\xBF";
    if (bytes.starts_with("\xFF\xFE") || bytes.starts_with("\xFE\xFF")) return decoded(bytes, "UTF-16");
    if (bytes.starts_with(Utf8Mark)) bytes.remove_prefix(Utf8Mark.size());
    if (auto text = fromStrictUtf8(bytes)) return text;
    return decoded(bytes, "macintosh");
}

std::u16string take(CSVParser::Row& row, const char16_t* column) {
    const auto found = row.find(column);
    return found != row.end() ? std::move(found->second) : std::u16string();
}

}  // namespace

Result<std::shared_ptr<SnippetGroup>> readCsvLibrary(std::string_view bytes, const std::u16string& groupName) {
    auto text = textOf(bytes);
    if (!text) return Error{"its text is in an encoding that cannot be read; save it as UTF-8"};

    std::vector<std::shared_ptr<Snippet>> snippets;
    CSVParser parser(std::move(*text), u",", std::nullopt, false, {Abbreviation, Content, Label});
    const bool any = parser.parseRowsForReceiver([&](CSVParser::Row row) {
        auto snippet = std::make_shared<Snippet>(take(row, Abbreviation), take(row, Content));
        snippet->setLabel(take(row, Label));
        snippets.push_back(std::move(snippet));
    });
    if (!any) return Error{"no snippet could be read from it; expected abbreviation,text,label on each line"};

    auto group = SnippetGroup::make();
    group->setName(groupName);
    group->addItems(snippets);
    return group;
}

}  // namespace plume

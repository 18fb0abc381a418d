#include "app/editing/RowsAsText.h"

#include <optional>
#include <sstream>
#include <utility>

#include "Foundation/Strings.h"
#include "Foundation/text/CSV.h"

namespace plume {

namespace {

constexpr const char16_t* AbbreviationColumn = u"abbreviation";
constexpr const char16_t* ContentColumn = u"content";
constexpr const char16_t* LabelColumn = u"label";

std::shared_ptr<Snippet> snippetFromRow(const CSVParser::Row& row) {
    const auto field = [&](const char16_t* name) {
        const auto found = row.find(name);
        return found == row.end() ? std::u16string() : found->second;
    };
    if (field(ContentColumn).empty()) return nullptr;
    auto snippet = std::make_shared<Snippet>(field(AbbreviationColumn), field(ContentColumn));
    if (!field(LabelColumn).empty()) snippet->setLabel(field(LabelColumn));
    return snippet;
}

// Of text that only looks like a table: every line is a row, and quotes are what they are.
CSVParser::Row rowFromLine(std::u16string_view line) {
    const auto fields = split(line, u'\t');
    CSVParser::Row row;
    row[AbbreviationColumn] = fields[0];
    if (fields.size() > 1) row[ContentColumn] = fields[1];
    if (fields.size() > 2) row[LabelColumn] = fields[2];
    return row;
}

std::vector<CSVParser::Row> rowsIn(const std::u16string& text) {
    CSVParser parser(text, u"\t", std::nullopt, false, {AbbreviationColumn, ContentColumn, LabelColumn});
    auto rows = parser.arrayOfParsedRows();
    if (rows && parser.position() == text.size()) return std::move(*rows);
    std::vector<CSVParser::Row> lines;
    for (const auto& line : split(replacingAll(text, u"\r\n", u"\n"), u'\n')) lines.push_back(rowFromLine(line));
    return lines;
}

}  // namespace

std::u16string textFromRows(const std::vector<std::shared_ptr<Snippet>>& snippets) {
    std::ostringstream stream;
    CsvWriter writer(stream, CsvEncoding::Utf8, u'\t');
    for (const auto& snippet : snippets) {
        writer.writeField(snippet->abbreviation());
        writer.writeField(snippet->plainTextContent());
        if (snippet->label() && !snippet->label()->empty()) writer.writeField(snippet->label());
        writer.finishLine();
    }
    return fromUtf8(stream.str());
}

std::vector<std::shared_ptr<Snippet>> rowsFromText(const std::u16string& text) {
    if (trimmed(text).empty()) return {};
    if (text.find(u'\t') == std::u16string::npos) return {std::make_shared<Snippet>(std::nullopt, text)};
    std::vector<std::shared_ptr<Snippet>> snippets;
    for (const auto& row : rowsIn(text)) {
        if (auto snippet = snippetFromRow(row)) snippets.push_back(std::move(snippet));
    }
    return snippets;
}

}  // namespace plume

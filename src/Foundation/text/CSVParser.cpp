#include "Foundation/text/CSVParser.h"

#include <algorithm>
#include <stdexcept>
#include <utility>

#include "Foundation/Strings.h"

namespace plume {

namespace {

constexpr char16_t Quote = u'"';

}  // namespace

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

}  // namespace plume

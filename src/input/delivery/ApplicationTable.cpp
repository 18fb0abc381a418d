#include "input/delivery/ApplicationTable.h"

#include <utility>

#include "Foundation/Strings.h"

namespace plume {

namespace {

std::u16string inSmallLetters(std::u16string_view identifier) {
    std::u16string letters(identifier);
    for (char16_t& c : letters) {
        if (c >= u'A' && c <= u'Z') c = static_cast<char16_t>(c - u'A' + u'a');
    }
    return letters;
}

}  // namespace

const ContextInputSetting* ApplicationRows::find(std::u16string_view identifier) const {
    const std::u16string name = inSmallLetters(identifier);
    if (const auto found = byIdentifier_.find(name); found != byIdentifier_.end()) return &found->second;
    const ContextInputSetting* longest = nullptr;
    for (const auto& [beginning, setting] : byBeginning_) {
        if (name.starts_with(beginning)) longest = &setting;  // the order puts longer ones behind
    }
    return longest;
}

ApplicationRows ApplicationTable::rowsFrom(const JsonNode& node) const {
    ApplicationRows rows;
    for (const auto& [name, value] : node.members()) {
        std::u16string identifier = inSmallLetters(fromUtf8(name));
        const bool isBeginning = identifier.ends_with(u'*');
        if (isBeginning) identifier.pop_back();
        if (identifier.empty()) value.fail("expected the row of an application; what holds for all is the default");
        auto& place = isBeginning ? rows.byBeginning_ : rows.byIdentifier_;
        if (!place.emplace(identifier, readApplicationRow(value, otherwise_, families_)).second) {
            value.fail("expected one row for each application; there is one with the same letters already");
        }
    }
    return rows;
}

ApplicationTable ApplicationTable::readFrom(const JsonNode& node) {
    const JsonObject file = node.object({"about", "default", "families", "applications"});
    ApplicationTable table;
    file.whenSet("default", [&](const JsonNode& row) { table.otherwise_ = readApplicationRow(row, {}, {}); });
    file.whenSet("families", [&](const JsonNode& families) {
        for (const auto& [name, row] : families.members()) {
            table.families_.emplace(name, readApplicationRow(row, table.otherwise_, table.families_));
        }
    });
    file.whenSet("applications", [&](const JsonNode& rows) { table.rows_ = table.rowsFrom(rows); });
    return table;
}

Result<ApplicationTable> ApplicationTable::read(std::string_view text, const std::string& fileName) {
    return readingJson([&] { return readFrom(JsonNode::parse(text, fileName)); });
}

Result<ApplicationRows> ApplicationTable::readRows(std::string_view text, const std::string& fileName) const {
    return readingJson([&] { return rowsFrom(JsonNode::parse(text, fileName)); });
}

}  // namespace plume

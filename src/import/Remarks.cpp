#include "import/Remarks.h"

#include <algorithm>
#include <utility>

#include "Foundation/CharacterSet.h"
#include "Foundation/Strings.h"

namespace plume {

namespace {

std::string quoted(std::u16string_view text) {
    constexpr std::size_t MostUnits = 60;
    std::u16string line(text.substr(0, MostUnits));
    std::replace_if(
        line.begin(), line.end(), [](char16_t unit) { return CharacterSet::newlines().contains(unit); }, u' ');
    return '"' + toUtf8(line) + (text.size() > MostUnits ? "…\"" : "\"");
}

}  // namespace

std::string nameInRemarks(const Snippet& snippet) {
    if (snippet.abbreviation() && !snippet.abbreviation()->empty()) return quoted(*snippet.abbreviation());
    if (snippet.label() && !snippet.label()->empty()) return "the snippet labelled " + quoted(*snippet.label());
    return "a snippet without abbreviation";
}

void Remarks::add(std::string line) {
    if (lines_.size() < MostLines) {
        lines_.push_back(std::move(line));
    } else {
        ++further_;
    }
}

void Remarks::add(const Snippet& snippet, std::string_view why) {
    add(nameInRemarks(snippet) + ": " + std::string(why));
}

void Remarks::addAll(const Snippet& snippet, const std::vector<std::string>& reasons,
                     std::optional<std::size_t> lineNumber) {
    if (reasons.empty()) return;
    std::string line = lineNumber ? "line " + std::to_string(*lineNumber) + ", " : std::string();
    line += nameInRemarks(snippet) + ": ";
    for (std::size_t i = 0; i < reasons.size(); ++i) line += (i > 0 ? "; " : "") + reasons[i];
    add(std::move(line));
}

void Remarks::addCount(std::size_t count, std::string_view one, std::string_view many) {
    if (count == 1) add("1 " + std::string(one));
    if (count > 1) add(std::to_string(count) + " " + std::string(many));
}

void Remarks::addStrange(std::size_t count) {
    addCount(count, "entry is no snippet and is left out", "entries are no snippets and are left out");
}

void Remarks::addTooMany(std::size_t count) {
    const std::string most = std::to_string(MostImportedSnippets);
    addCount(count, "snippet is left out, as an import takes no more than " + most,
             "snippets are left out, as an import takes no more than " + most);
}

std::vector<std::string> Remarks::take() {
    if (further_ > 0) lines_.push_back(std::to_string(further_) + " further remarks are left out");
    further_ = 0;
    return std::exchange(lines_, {});
}

}  // namespace plume

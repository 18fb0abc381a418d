#include "app/editing/RowSearch.h"

#include <unicode/uchar.h>

#include <algorithm>
#include <array>
#include <optional>

#include "Foundation/Strings.h"

namespace plume {

namespace {

enum Fit : std::size_t { WholeName, BeginningOfName, BeginningsOfWords, Anywhere };
constexpr std::size_t FitCount = 4;

bool isWordUnit(char16_t unit) {
    return u_isalnum(unit) != 0 || (unit & 0xF800) == 0xD800;
}

bool isAtWordStart(std::u16string_view text, std::size_t place) {
    return place == 0 || !isWordUnit(text[place - 1]) || !isWordUnit(text[place]);
}

// Nothing when the text does not hold the word.
std::optional<Fit> fitOf(std::u16string_view text, std::u16string_view word) {
    std::size_t place = text.find(word);
    if (place == std::u16string_view::npos) return std::nullopt;
    for (; place != std::u16string_view::npos; place = text.find(word, place + 1)) {
        if (isAtWordStart(text, place)) return BeginningsOfWords;
    }
    return Anywhere;
}

std::vector<std::u16string> wordsOf(std::u16string_view foldedQuery) {
    std::vector<std::u16string> words = split(foldedQuery, u' ');
    std::erase(words, std::u16string());
    return words;
}

}  // namespace

void RowSearch::add(std::u16string_view name, std::u16string_view rest) {
    std::u16string foldedName = folded(name);
    std::u16string all = foldedName + u' ' + folded(rest);
    rows_.push_back({std::move(foldedName), std::move(all)});
}

std::vector<std::size_t> RowSearch::find(std::u16string_view query) const {
    const std::u16string whole = folded(trimmed(query));
    const std::vector<std::u16string> words = wordsOf(whole);
    const auto fitOfRow = [&](const Row& row) -> std::optional<Fit> {
        Fit worst = BeginningsOfWords;
        for (const std::u16string& word : words) {
            const std::optional<Fit> fit = fitOf(row.all, word);
            if (!fit) return std::nullopt;
            worst = std::max(worst, *fit);
        }
        if (!words.empty() && row.name == whole) return WholeName;
        return !words.empty() && row.name.starts_with(whole) ? BeginningOfName : worst;
    };
    std::array<std::vector<std::size_t>, FitCount> found;
    for (std::size_t i = 0; i < rows_.size(); ++i) {
        if (const std::optional<Fit> fit = fitOfRow(rows_[i])) found.at(*fit).push_back(i);
    }
    std::vector<std::size_t> places;
    for (const auto& some : found) places.insert(places.end(), some.begin(), some.end());
    return places;
}

}  // namespace plume

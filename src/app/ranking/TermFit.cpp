#include "app/ranking/TermFit.h"

#include <algorithm>
#include <bit>
#include <utility>
#include <vector>

#include "Foundation/CharacterSet.h"
#include "Foundation/Strings.h"
#include "app/ranking/NormalisedText.h"

namespace plume {

namespace {

constexpr double LeastScoreOfLetter = 14.4;
constexpr std::size_t LongestWordWithSlips = 64;

TermFit fitAt(double tier, const FieldView& field, std::size_t place, std::size_t length) {
    return {tier, qualityOf(scoreOfRun(field, place, length), length)};
}

bool lacks(std::uint64_t mask, const SearchTerm& term) {
    return (term.mask & ~mask) != 0;
}

TermFit better(const TermFit& one, const TermFit& other) {
    if (one.tier != other.tier) return one.tier > other.tier ? one : other;
    return other.quality > one.quality ? other : one;
}

// At the start of a word if it stands there anywhere, else at its first place.
TermFit insideFit(const FieldView& field, std::u16string_view term) {
    const std::size_t first = findUnits(field.units, term);
    if (first == NotFound) return {};
    for (std::size_t place = first; place != NotFound; place = findUnits(field.units, term, place + 1)) {
        if (field.starts[place] >= FirstOfPart) return fitAt(Tier::StartsWord, field, place, term.size());
    }
    return fitAt(Tier::InField, field, first, term.size());
}

TermFit abbreviationFit(const SearchedTexts& texts, std::u16string_view term) {
    const FieldView& field = texts.abbreviation;
    TermFit best;
    for (const std::size_t start : texts.beginnings) {
        const std::u16string_view rest = field.units.substr(start);
        if (!rest.starts_with(term)) continue;
        const double tier = rest.size() == term.size() ? Tier::IsAbbreviation : Tier::BeginsAbbreviation;
        best = better(best, fitAt(tier, field, start, term.size()));
    }
    return best.tier == Tier::None ? insideFit(field, term) : best;
}

TermFit labelFit(const FieldView& label, std::u16string_view term) {
    if (!label.units.starts_with(term)) return insideFit(label, term);
    const double tier = label.units.size() == term.size() ? Tier::IsLabel : Tier::BeginsLabel;
    return fitAt(tier, label, 0, term.size());
}

TermFit subsequenceFit(const FieldView& field, std::u16string_view term) {
    const int score = fuzzyScore(field, term);
    const auto length = static_cast<double>(term.size());
    if (score < LeastScoreOfLetter * length) return {};
    return {Tier::Subsequence, qualityOf(score, term.size())};
}

TermFit slipFit(const FieldView& field, std::u16string_view term, std::size_t forgiven) {
    const CharacterSet& letters = CharacterSet::alphanumerics();
    const auto isLetter = [&letters](char16_t unit) { return letters.contains(unit); };
    std::size_t fewest = forgiven + 1;
    const auto end = field.units.end();
    for (auto at = field.units.begin(); at != end;) {
        const auto start = std::find_if(at, end, isLetter);
        at = std::find_if_not(start, end, isLetter);
        fewest = std::min(fewest, slipsBetween(std::u16string_view(start, at), term, forgiven));
    }
    if (fewest > forgiven) return {};
    return {Tier::Slip, 1 - static_cast<double>(fewest) / static_cast<double>(term.size())};
}

}  // namespace

SearchTerm::SearchTerm(std::u16string term) : units(std::move(term)), mask(letterMask(units)) {
    NormalisedField field = normalisedField(units);
    const FieldView view{field.units, field.starts};
    qualityAtWord = fitAt(Tier::InContent, view, 0, units.size()).quality;
    field.starts.front() = 0;
    qualityInWord = fitAt(Tier::InContent, view, 0, units.size()).quality;
}

TermFit fieldFit(const SearchedTexts& texts, const SearchTerm& term) {
    const TermFit abbreviation = lacks(texts.masks.abbreviation, term) ? TermFit{} : abbreviationFit(texts, term.units);
    if (lacks(texts.masks.label, term)) return abbreviation;
    return better(abbreviation, labelFit(texts.label, term.units));
}

TermFit wholeFit(const SearchedTexts& texts, const SearchTerm& term) {
    const TermFit fit = fieldFit(texts, term);
    if (fit.tier != Tier::None || lacks(texts.masks.content, term)) return fit;
    const std::size_t place = findUnits(texts.content, term.units);
    if (place == NotFound) return {};
    const bool isAtWord = place == 0 || !CharacterSet::alphanumerics().contains(texts.content[place - 1]);
    return {Tier::InContent, isAtWord ? term.qualityAtWord : term.qualityInWord};
}

TermFit looseFit(const SearchedTexts& texts, const SearchTerm& term, bool withSlips) {
    TermFit close;
    if (!lacks(texts.masks.abbreviation, term)) close = subsequenceFit(texts.abbreviation, term.units);
    if (!lacks(texts.masks.label, term)) close = better(close, subsequenceFit(texts.label, term.units));
    const std::size_t forgiven = forgivenSlips(term.units.size());
    if (close.tier != Tier::None || !withSlips || forgiven == 0) return close;
    // A slip brings at most one letter into the term that is not in the word.
    const auto isNear = [&](std::uint64_t mask) {
        return static_cast<std::size_t>(std::popcount(term.mask & ~mask)) <= forgiven;
    };
    if (isNear(texts.masks.abbreviation)) close = slipFit(texts.abbreviation, term.units, forgiven);
    return isNear(texts.masks.label) ? better(close, slipFit(texts.label, term.units, forgiven)) : close;
}

std::size_t forgivenSlips(std::size_t length) {
    if (length > LongestWordWithSlips) return 0;
    if (length >= 8) return 2;
    return length >= 4 ? 1 : 0;
}

std::size_t slipsBetween(std::u16string_view one, std::u16string_view other, std::size_t most) {
    const std::size_t longer = std::max(one.size(), other.size());
    if (longer - std::min(one.size(), other.size()) > most) return most + 1;
    if (other.size() > LongestWordWithSlips) return most + 1;
    // Three rows of the table of slips between their beginnings: this letter's of `one` and the two before.
    using Row = std::array<std::size_t, LongestWordWithSlips + 1>;
    std::array<Row, 3> rows;
    const auto width = static_cast<std::ptrdiff_t>(other.size() + 1);
    Row* beforeLast = rows.data();
    Row* last = beforeLast + 1;
    Row* row = last + 1;
    for (std::size_t j = 0; j <= other.size(); ++j) (*last)[j] = j;
    for (std::size_t i = 1; i <= one.size(); ++i) {
        (*row)[0] = i;
        for (std::size_t j = 1; j <= other.size(); ++j) {
            const bool isSame = one[i - 1] == other[j - 1];
            (*row)[j] = std::min({(*last)[j] + 1, (*row)[j - 1] + 1, (*last)[j - 1] + (isSame ? 0 : 1)});
            const bool isSwapped = i > 1 && j > 1 && one[i - 1] == other[j - 2] && one[i - 2] == other[j - 1];
            if (isSwapped) (*row)[j] = std::min((*row)[j], (*beforeLast)[j - 2] + 1);
        }
        if (*std::min_element(row->begin(), row->begin() + width) > most) return most + 1;
        std::swap(beforeLast, last);
        std::swap(last, row);
    }
    return std::min((*last)[other.size()], most + 1);
}

}  // namespace plume

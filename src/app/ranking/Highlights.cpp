// The marks of what a search has found, in a text as it is shown.
#include <algorithm>

#include "Foundation/CharacterSet.h"
#include "app/ranking/NormalisedText.h"
#include "app/ranking/SearchQuery.h"
#include "app/ranking/SnippetRanking.h"

namespace plume {

namespace {

// Which units of a normalised text are marked.
class Marks {
  public:
    explicit Marks(const TracedText& text)
        : text_(text), field_{text.field.units, text.field.starts}, marked_(text.field.units.size(), false) {}

    bool addWhole(std::u16string_view term) {
        std::size_t place = findUnits(field_.units, term);
        const bool any = place != NotFound;
        for (; place != NotFound; place = findUnits(field_.units, term, place + term.size())) add(place, term.size());
        return any;
    }
    bool addLetters(std::u16string_view term) {
        std::vector<std::size_t> places;
        if (fuzzyScore(field_, term, &places) == 0) return false;
        for (const std::size_t place : places) add(place, 1);
        return true;
    }
    void addWordsWithSlips(std::u16string_view term) {
        const std::size_t forgiven = forgivenSlips(term.size());
        if (forgiven == 0) return;
        const auto isLetter = [](char16_t unit) { return CharacterSet::alphanumerics().contains(unit); };
        for (auto at = field_.units.begin(); at != field_.units.end();) {
            const auto start = std::find_if(at, field_.units.end(), isLetter);
            at = std::find_if_not(start, field_.units.end(), isLetter);
            const std::u16string_view word(start, at);
            if (slipsBetween(word, term, forgiven) > forgiven) continue;
            add(static_cast<std::size_t>(start - field_.units.begin()), word.size());
        }
    }

    // What a pattern for the whole text writes out between its wildcards, when all of it is there.
    void addPieces(std::u16string_view pattern) {
        std::vector<Range> pieces;
        std::size_t end = 0;
        for (std::size_t at = 0; at < pattern.size();) {
            const std::size_t start = std::min(pattern.find_first_not_of(u"*?", at), pattern.size());
            at = std::min(pattern.find_first_of(u"*?", start), pattern.size());
            if (start == at) break;
            const std::u16string_view piece = pattern.substr(start, at - start);
            const bool isLast = at == pattern.size() && field_.units.size() >= end + piece.size();
            const std::size_t from = isLast ? field_.units.size() - piece.size() : end;
            const std::size_t place = findUnits(field_.units, piece, from);
            if (place == NotFound || (pieces.empty() && start == 0 && place != 0)) return;
            pieces.push_back({place, piece.size()});
            end = pieces.back().end();
        }
        for (const Range& piece : pieces) add(piece.location, piece.length);
    }

    // In the text as it is shown; a character that is marked in part is marked, with the accents that follow it.
    std::vector<Range> ranges() const {
        std::vector<Range> ranges;
        for (std::size_t i = 0; i < marked_.size(); ++i) {
            if (!marked_[i]) continue;
            const std::size_t start = text_.origins[i];
            std::size_t next = i + 1;
            while (text_.origins[next] == start && next < marked_.size()) ++next;
            const std::size_t end = text_.origins[next];
            if (!ranges.empty() && ranges.back().end() >= start) {
                ranges.back().length = std::max(end, ranges.back().end()) - ranges.back().location;
            } else {
                ranges.push_back({start, end - start});
            }
        }
        return ranges;
    }

  private:
    void add(std::size_t place, std::size_t length) {
        std::fill_n(marked_.begin() + static_cast<std::ptrdiff_t>(place), length, true);
    }

    const TracedText& text_;
    FieldView field_;
    std::vector<bool> marked_;
};

}  // namespace

std::vector<Range> highlights(std::u16string_view text, std::u16string_view query, const SearchRule& rule,
                              bool isLoose) {
    const TracedText traced = tracedText(text);
    Marks marks(traced);
    if (isWildcardSearch(query, rule)) {
        marks.addPieces(normalised(query));
        return marks.ranges();
    }
    for (const SearchTerm& term : searchQuery(query).terms) {
        if (marks.addWhole(term.units) || !isLoose) continue;
        if (!marks.addLetters(term.units)) marks.addWordsWithSlips(term.units);
    }
    return marks.ranges();
}

}  // namespace plume

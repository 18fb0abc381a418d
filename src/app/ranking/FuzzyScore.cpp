#include "app/ranking/FuzzyScore.h"

#include <algorithm>
#include <cstdint>

#include "app/ranking/NormalisedText.h"

namespace plume {

namespace {

constexpr int LetterScore = 16;
constexpr int FirstGap = -3;
constexpr int LongerGap = -1;
constexpr int InARow = 4;
// Far below every score, and far from the end of the numbers.
constexpr int Impossible = -1'000'000;

// A place where the term's letters up to one end, as a cell of the table: term's letter by row, text's by column.
struct Cell {
    int score = Impossible;  // best with the letter here or further left
    std::uint16_t run = 0;   // how many letters stand in a row up to here, when the letter is here
    bool isGap = false;      // the best has its letter further left
};

// What the letter at `place` adds as the `run`-th in a row; a new word within the run starts another.
int startWorth(const FieldView& field, std::size_t place, std::uint16_t& run) {
    const int own = static_cast<unsigned char>(field.starts[place]);
    if (run == 1) return own;
    const int first = static_cast<unsigned char>(field.starts[place + 1 - run]);
    if (own >= FirstOfWord && own > first) {
        run = 1;
        return own;
    }
    return std::max({own, InARow, first});
}

class FuzzyTable {
  public:
    FuzzyTable(const FieldView& field, std::u16string_view term)
        : field_(field), term_(term), cells_(field.units.size() * term.size()) {
        for (std::size_t row = 0; row < term_.size(); ++row) fillRow(row);
    }

    // The column of the last letter at its best.
    std::size_t bestEnd() const {
        const Cell* const row = &at(term_.size() - 1, 0);
        const auto isWorse = [](const Cell& a, const Cell& b) { return a.score < b.score; };
        return static_cast<std::size_t>(std::max_element(row, row + field_.units.size(), isWorse) - row);
    }
    int scoreAt(std::size_t column) const { return at(term_.size() - 1, column).score; }
    std::vector<std::size_t> placesUpTo(std::size_t column) const {
        std::vector<std::size_t> places(term_.size());
        for (std::size_t row = term_.size(); row-- > 0; --column) {
            while (at(row, column).isGap) --column;
            places[row] = column;
            if (row == 0) break;
        }
        return places;
    }

  private:
    Cell& at(std::size_t row, std::size_t column) { return cells_[row * field_.units.size() + column]; }
    const Cell& at(std::size_t row, std::size_t column) const { return cells_[row * field_.units.size() + column]; }

    void fillRow(std::size_t row) {
        for (std::size_t column = row; column < field_.units.size(); ++column) fillCell(row, column);
    }
    void fillCell(std::size_t row, std::size_t column) {
        Cell& cell = at(row, column);
        if (field_.units[column] == term_[row]) cell = withLetterAt(row, column);
        if (column == 0) return;
        const Cell& left = at(row, column - 1);
        const int gap = left.score + (left.isGap ? LongerGap : FirstGap);
        if (left.score > Impossible / 2 && gap > cell.score) cell = {gap, 0, true};
    }
    Cell withLetterAt(std::size_t row, std::size_t column) const {
        if (row == 0) return {LetterScore + 2 * field_.starts[column], 1, false};
        const Cell& before = at(row - 1, column - 1);
        if (before.score <= Impossible / 2) return {};
        auto run = static_cast<std::uint16_t>(before.run + 1);
        const int worth = startWorth(field_, column, run);
        return {before.score + LetterScore + worth, run, false};
    }

    const FieldView& field_;
    std::u16string_view term_;
    std::vector<Cell> cells_;
};

bool isInOrder(std::u16string_view text, std::u16string_view term) {
    std::size_t next = 0;
    for (const char16_t unit : text) {
        if (unit == term[next] && ++next == term.size()) return true;
    }
    return false;
}

}  // namespace

int scoreOfRun(const FieldView& field, std::size_t place, std::size_t length) {
    int score = LetterScore + 2 * field.starts[place];
    std::uint16_t run = 1;
    const std::size_t scored = std::min(length, MostScoredText);
    for (std::size_t i = 1; i < scored; ++i) {
        ++run;
        score += LetterScore + startWorth(field, place + i, run);
    }
    return score;
}

int fuzzyScore(const FieldView& field, std::u16string_view term, std::vector<std::size_t>* places) {
    if (term.empty() || term.size() > MostScoredTerm || field.units.size() > MostScoredText) return 0;
    if (!isInOrder(field.units, term)) return 0;
    const FuzzyTable table(field, term);
    const std::size_t end = table.bestEnd();
    if (places) *places = table.placesUpTo(end);
    return std::max(0, table.scoreAt(end));
}

double qualityOf(int score, std::size_t length) {
    const double most = 26.0 * static_cast<double>(std::min(length, MostScoredText)) + 10;
    return std::clamp(score / most, 0.0, 1.0);
}

}  // namespace plume

// How well a term fits a text: the score of its letters, which stand in the text in their order, near each other or
// not.
//
// Pure; from any thread. All texts are normalised (NormalisedText.h).
#pragma once

#include <cstddef>
#include <string_view>
#include <vector>

namespace plume {

// A normalised text with where words start in it, both as long as each other and neither owned.
struct FieldView {
    std::u16string_view units;
    std::string_view starts;
};

// What the letters of the term are worth that stand one after another from `place` on.
int scoreOfRun(const FieldView& field, std::size_t place, std::size_t length);

// The best that the term's letters are worth wherever they stand in order; 0 when they do not. Texts and terms longer
// than MostScored have none. The places of the letters go to `places` when it is given.
inline constexpr std::size_t MostScoredText = 1024;
inline constexpr std::size_t MostScoredTerm = 64;
int fuzzyScore(const FieldView& field, std::u16string_view term, std::vector<std::size_t>* places = nullptr);

// A score as a part of the most that a term of this length can be worth: 0 to 1.
double qualityOf(int score, std::size_t length);

}  // namespace plume

// The letters that tick the optional parts of a form, together with Alt.
//
// Pure; from any thread.
#pragma once

#include <QString>
#include <vector>

namespace plume {

// For each name the name with "&" before its letter, as controls want it; every other "&" is doubled. A letter is given
// once, the first that is free in the name; when none is, a digit behind the name; when there are no more digits,
// nothing.
std::vector<QString> withLetters(const std::vector<QString>& names);

}  // namespace plume

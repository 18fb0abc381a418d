#include "engine/AutoTextUtils.h"

#include "Foundation/CharacterSet.h"

namespace plume {

namespace {

const CharacterSet& lineBreaks() {
    static const CharacterSet set = CharacterSet::whitespacesAndNewlines()
                                        .subtracting(CharacterSet::withCharacters(u" "))
                                        .united(CharacterSet::withCharacters(u"\u0003"));
    return set;
}

const CharacterSet& sentenceEnds() {
    static const CharacterSet set = lineBreaks().united(CharacterSet::withCharacters(u".?!"));
    return set;
}

}  // namespace

bool AutoTextUtils::shouldCapitalize(std::u16string_view text) {
    constexpr std::size_t WordAndKey = 2;
    if (text.size() <= WordAndKey) return false;
    const std::u16string_view before = text.substr(0, text.size() - WordAndKey);
    const std::size_t last = before.find_last_not_of(u' ');
    if (last == std::u16string_view::npos) return false;
    const bool spacesFollow = last + 1 < before.size();
    return lineBreaks().contains(before[last]) || (spacesFollow && sentenceEnds().contains(before[last]));
}

}  // namespace plume

#include "library/AbbreviationHash.h"

#include <unicode/utf16.h>

#include <cstddef>

#include "Foundation/Strings.h"

namespace plume {

std::uint64_t hashOfSuffix(std::u16string_view text) {
    std::uint64_t hash = EmptySuffixHash;
    for (std::size_t i = text.size(); i > 0;) {
        const char16_t unit = text[--i];
        if (i > 0 && U16_IS_TRAIL(unit) && U16_IS_LEAD(text[i - 1])) {
            const auto pair = static_cast<char32_t>(U16_GET_SUPPLEMENTARY(text[i - 1], unit));
            const char32_t folded = foldedCodePoint(pair);
            hash = extendSuffixHash(hash, static_cast<char16_t>(U16_TRAIL(folded)));
            hash = extendSuffixHash(hash, static_cast<char16_t>(U16_LEAD(folded)));
            --i;
        } else {
            hash = extendSuffixHash(hash, static_cast<char16_t>(foldedCodePoint(unit)));
        }
    }
    return hash;
}

}  // namespace plume

#include "app/ranking/NormalisedText.h"

#include <unicode/uchar.h>
#include <unicode/unorm2.h>
#include <unicode/ustring.h>
#include <unicode/utf16.h>

#include <algorithm>
#include <array>

#include "Foundation/Strings.h"

namespace plume {

namespace {

// No character becomes longer than this; the longest decomposition has 18 units, and folding makes none of them three.
constexpr std::size_t MostUnits = 64;

struct CharacterForm {
    std::array<char16_t, MostUnits> units{};
    std::size_t count = 0;
    void add(char32_t c) {
        int32_t length = 0;
        std::array<char16_t, 2> encoded{};
        char16_t* const start = encoded.data();
        U16_APPEND_UNSAFE(start, length, c);
        for (int32_t i = 0; i < length && count < MostUnits; ++i) units[count++] = encoded[static_cast<std::size_t>(i)];
    }
};

// An unpaired surrogate is a character of its own.
char32_t nextCharacter(std::u16string_view text, std::size_t& at) {
    const char32_t unit = text[at++];
    if (!U16_IS_LEAD(unit) || at == text.size() || !U16_IS_TRAIL(text[at])) return unit;
    return 0x10000 + ((unit - 0xD800) << 10) + (text[at++] - 0xDC00U);
}

bool isDroppedMark(char32_t c) {
    const auto character = static_cast<UChar32>(c);
    // Vowel signs that stand for themselves have no combining class: they stay.
    return u_getCombiningClass(character) != 0 || u_charType(character) == U_ENCLOSING_MARK ||
           u_hasBinaryProperty(character, UCHAR_VARIATION_SELECTOR);
}

// Characters come apart, and only then are folded in full: so all that folds alike under simple folding has one form.
CharacterForm formOf(char32_t c) {
    static const UNormalizer2* const decomposing = [] {
        UErrorCode status = U_ZERO_ERROR;
        return unorm2_getNFKDInstance(&status);
    }();
    const auto whole = static_cast<UChar32>(c);
    std::array<char16_t, MostUnits> apart{};
    UErrorCode status = U_ZERO_ERROR;
    int32_t length = unorm2_getDecomposition(decomposing, whole, apart.data(), MostUnits / 2, &status);
    if (length < 0 || U_FAILURE(status)) {
        length = 0;
        char16_t* const start = apart.data();
        U16_APPEND_UNSAFE(start, length, whole);
    }
    std::array<char16_t, MostUnits> all{};
    status = U_ZERO_ERROR;
    const int32_t foldedLength =
        u_strFoldCase(all.data(), MostUnits, apart.data(), length, U_FOLD_CASE_DEFAULT, &status);
    CharacterForm form;
    const std::u16string_view folded(all.data(), static_cast<std::size_t>(foldedLength));
    for (std::size_t i = 0; i < folded.size();) {
        const char32_t each = nextCharacter(folded, i);
        if (!isDroppedMark(each)) form.add(each);
    }
    return form;
}

enum class LetterKind { Other, Small, Capital, Digit };

LetterKind asciiKind(char16_t unit) {
    if (unit >= u'a' && unit <= u'z') return LetterKind::Small;
    if (unit >= u'A' && unit <= u'Z') return LetterKind::Capital;
    return unit >= u'0' && unit <= u'9' ? LetterKind::Digit : LetterKind::Other;
}

LetterKind kindOf(char32_t c) {
    if (c < 0x80) return asciiKind(static_cast<char16_t>(c));
    const auto character = static_cast<UChar32>(c);
    if (u_isdigit(character)) return LetterKind::Digit;
    if (!u_isalnum(character)) return LetterKind::Other;
    return u_isupper(character) || u_istitle(character) ? LetterKind::Capital : LetterKind::Small;
}

char startBetween(LetterKind before, LetterKind kind) {
    if (kind == LetterKind::Other) return 0;
    if (before == LetterKind::Other) return FirstOfWord;
    if (kind == LetterKind::Capital && before == LetterKind::Small) return FirstOfPart;
    return kind == LetterKind::Digit && before != LetterKind::Digit ? FirstOfPart : 0;
}

// Tells `take(units, origin, kind)` of each character in turn; for a dropped mark there are no units.
template <typename Take>
void normaliseEach(std::u16string_view text, Take&& take) {
    for (std::size_t i = 0; i < text.size();) {
        const std::size_t origin = i;
        char16_t unit = text[i];
        if (unit < 0x80) {
            const LetterKind kind = asciiKind(unit);
            if (kind == LetterKind::Capital) unit = static_cast<char16_t>(unit + (u'a' - u'A'));
            take(std::u16string_view(&unit, 1), origin, kind);
            ++i;
            continue;
        }
        const char32_t c = nextCharacter(text, i);
        const CharacterForm form = formOf(c);
        take(std::u16string_view(form.units.data(), form.count), origin, kindOf(c));
    }
}

// Adds up the starts of words of one text.
class StartsRecorder {
  public:
    explicit StartsRecorder(NormalisedField& field) : field_(field) {}
    void add(std::u16string_view units, LetterKind kind) {
        if (units.empty()) return;
        field_.starts += field_.units.empty() ? FirstOfWord : startBetween(before_, kind);
        field_.starts.append(units.size() - 1, 0);
        field_.units += units;
        before_ = kind;
    }

  private:
    NormalisedField& field_;
    LetterKind before_ = LetterKind::Other;
};

constexpr unsigned FirstDigitBit = 26;
constexpr unsigned FirstOtherBit = 36;
constexpr unsigned OtherBits = 64 - FirstOtherBit;

unsigned bitOf(char16_t unit) {
    if (unit >= u'a' && unit <= u'z') return static_cast<unsigned>(unit - u'a');
    if (unit >= u'0' && unit <= u'9') return FirstDigitBit + static_cast<unsigned>(unit - u'0');
    return FirstOtherBit + unit % OtherBits;
}

}  // namespace

std::u16string normalised(std::u16string_view text) {
    std::u16string result;
    result.reserve(text.size());
    normaliseEach(text, [&](std::u16string_view units, std::size_t, LetterKind) { result += units; });
    return result;
}

NormalisedField normalisedField(std::u16string_view text) {
    NormalisedField field;
    StartsRecorder recorder(field);
    normaliseEach(text, [&](std::u16string_view units, std::size_t, LetterKind kind) { recorder.add(units, kind); });
    return field;
}

TracedText tracedText(std::u16string_view text) {
    TracedText traced;
    StartsRecorder recorder(traced.field);
    normaliseEach(text, [&](std::u16string_view units, std::size_t origin, LetterKind kind) {
        recorder.add(units, kind);
        traced.origins.insert(traced.origins.end(), units.size(), origin);
    });
    traced.origins.push_back(text.size());
    return traced;
}

std::uint64_t letterMask(std::u16string_view normalisedText) {
    std::uint64_t mask = 0;
    for (const char16_t unit : normalisedText) mask |= std::uint64_t{1} << bitOf(unit);
    return mask;
}

std::size_t findUnits(std::u16string_view text, std::u16string_view pattern, std::size_t from) {
    if (from > text.size() || text.size() - from < pattern.size()) return NotFound;
    // A block at a time for its first and last unit together, which hardly ever stand so by chance; the compiler makes
    // wide instructions of the inner loop.
    constexpr std::size_t Block = 16;
    const char16_t first = pattern.front();
    const char16_t last = pattern.back();
    const std::size_t apart = pattern.size() - 1;
    const std::size_t end = text.size() - apart;
    std::size_t at = from;
    const auto isAt = [&](std::size_t place) { return text.substr(place, pattern.size()) == pattern; };
    for (; at + Block <= end; at += Block) {
        const char16_t* const here = text.data() + at;
        unsigned hits = 0;
        for (std::size_t i = 0; i < Block; ++i) {
            hits |= static_cast<unsigned>(here[i] == first) & static_cast<unsigned>(here[i + apart] == last);
        }
        if (hits == 0) continue;
        for (std::size_t i = 0; i < Block; ++i) {
            if (here[i] == first && isAt(at + i)) return at + i;
        }
    }
    for (; at < end; ++at) {
        if (text[at] == first && isAt(at)) return at;
    }
    return NotFound;
}

}  // namespace plume

#include "Foundation/Strings.h"

#include <unicode/uchar.h>
#include <unicode/ustring.h>
#include <unicode/utf16.h>
#include <unicode/utf8.h>

#include <algorithm>
#include <array>
#include <limits>

#include "Foundation/CharacterSet.h"

namespace plume {

namespace {

// Folding of the units below this (Latin with its extensions) is one look-up.
constexpr std::size_t FoldTableSize = 0x250;

constexpr char32_t Replacement = 0xFFFD;

char32_t foldedByUnicodeData(char32_t c) {
    const auto folded =
        static_cast<char32_t>(u_foldCase(static_cast<UChar32>(c), static_cast<std::uint32_t>(U_FOLD_CASE_DEFAULT)));
    const bool staysInPlane = (c > 0xFFFF) == (folded > 0xFFFF);
    return staysInPlane ? folded : c;
}

std::array<char16_t, FoldTableSize> makeFoldTable() {
    std::array<char16_t, FoldTableSize> table{};
    for (std::size_t i = 0; i < table.size(); ++i) {
        table[i] = static_cast<char16_t>(foldedByUnicodeData(static_cast<char32_t>(i)));
    }
    return table;
}

char32_t codePointOf(char16_t lead, char16_t trail) {
    return 0x10000 + ((static_cast<char32_t>(lead) - 0xD800) << 10) + (static_cast<char32_t>(trail) - 0xDC00);
}

char16_t leadOf(char32_t c) {
    return static_cast<char16_t>(0xD7C0 + (c >> 10));
}
char16_t trailOf(char32_t c) {
    return static_cast<char16_t>(0xDC00 + (c & 0x3FF));
}

// The code point whose first unit stands at `index`; an unpaired surrogate stands for itself.
char32_t codePointAt(std::u16string_view text, std::size_t index) {
    const char16_t unit = text[index];
    if (U16_IS_LEAD(unit) && index + 1 < text.size() && U16_IS_TRAIL(text[index + 1])) {
        return codePointOf(unit, text[index + 1]);
    }
    return unit;
}

// The unit that stands at `index` in folded(text).
char16_t foldedUnitAt(std::u16string_view text, std::size_t index) {
    const char16_t unit = text[index];
    if (!U16_IS_SURROGATE(unit)) return static_cast<char16_t>(foldedCodePoint(unit));
    if (U16_IS_LEAD(unit)) {
        const char32_t c = codePointAt(text, index);
        return c == unit ? unit : leadOf(foldedCodePoint(c));
    }
    if (index > 0 && U16_IS_LEAD(text[index - 1])) return trailOf(foldedCodePoint(codePointOf(text[index - 1], unit)));
    return unit;
}

using CaseMapping = int32_t (*)(UChar*, int32_t, const UChar*, int32_t, const char*, UErrorCode*);

std::u16string mapped(std::u16string_view text, CaseMapping mapping) {
    // No case mapping grows a text more than threefold; ICU counts in 32 bits.
    if (text.size() > static_cast<std::size_t>(std::numeric_limits<int32_t>::max()) / 3) return std::u16string(text);
    const auto length = static_cast<int32_t>(text.size());
    std::u16string result(text.size(), u'\0');
    UErrorCode status = U_ZERO_ERROR;
    int32_t needed = mapping(result.data(), length, text.data(), length, "", &status);
    if (status == U_BUFFER_OVERFLOW_ERROR) {
        status = U_ZERO_ERROR;
        result.resize(static_cast<std::size_t>(needed));
        needed = mapping(result.data(), needed, text.data(), length, "", &status);
    }
    if (U_FAILURE(status)) return std::u16string(text);
    result.resize(static_cast<std::size_t>(needed));
    return result;
}

void appendUtf16(char32_t c, std::u16string& result) {
    if (c <= 0xFFFF) {
        result += static_cast<char16_t>(c);
    } else {
        result += leadOf(c);
        result += trailOf(c);
    }
}

void appendUtf8(char32_t c, std::string& result) {
    const auto continuation = [c](int shift) { return static_cast<char>(0x80 | ((c >> shift) & 0x3F)); };
    if (c < 0x80) {
        result += static_cast<char>(c);
    } else if (c < 0x800) {
        result += {static_cast<char>(0xC0 | (c >> 6)), continuation(0)};
    } else if (c < 0x10000) {
        result += {static_cast<char>(0xE0 | (c >> 12)), continuation(6), continuation(0)};
    } else {
        result += {static_cast<char>(0xF0 | (c >> 18)), continuation(12), continuation(6), continuation(0)};
    }
}

// ICU's macro mixes signed and unsigned bytes on purpose.
#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wconversion"
#pragma GCC diagnostic ignored "-Wsign-conversion"
// The code point that starts at `index`, which is moved behind it; negative when the bytes there are malformed.
UChar32 nextCodePoint(std::string_view bytes, std::size_t& index) {
    const char* data = bytes.data();
    UChar32 c = 0;
    U8_NEXT(data, index, bytes.size(), c);
    return c;
}
#pragma GCC diagnostic pop

std::size_t unitCount(char32_t c) {
    return c > 0xFFFF ? 2 : 1;
}

int sign(bool less, bool greater) {
    return static_cast<int>(greater) - static_cast<int>(less);
}

// The decimal digit at `index`, or -1.
int digitAt(std::u16string_view text, std::size_t index) {
    const char16_t unit = text[index];
    if (unit < 0x80) return unit >= u'0' && unit <= u'9' ? unit - u'0' : -1;
    return u_charDigitValue(static_cast<UChar32>(codePointAt(text, index)));
}

// A run of decimal digits without its leading zeros.
struct DigitRun {
    std::size_t begin = 0;   // where the first digit that counts stands
    std::size_t end = 0;     // behind the last digit
    std::size_t digits = 0;  // how many digits count
};

DigitRun digitRunAt(std::u16string_view text, std::size_t index) {
    DigitRun run{index, index, 0};
    while (run.end < text.size()) {
        const int digit = digitAt(text, run.end);
        if (digit < 0) break;
        run.end += unitCount(codePointAt(text, run.end));
        if (digit == 0 && run.digits == 0) {
            run.begin = run.end;
        } else {
            ++run.digits;
        }
    }
    return run;
}

// By the numbers written, however long they are.
int compareNumbers(std::u16string_view a, const DigitRun& inA, std::u16string_view b, const DigitRun& inB) {
    if (inA.digits != inB.digits) return inA.digits < inB.digits ? -1 : 1;
    std::size_t i = inA.begin;
    std::size_t j = inB.begin;
    while (i < inA.end) {
        const int digitA = digitAt(a, i);
        const int digitB = digitAt(b, j);
        if (digitA != digitB) return digitA < digitB ? -1 : 1;
        i += unitCount(codePointAt(a, i));
        j += unitCount(codePointAt(b, j));
    }
    return 0;
}

std::size_t find(std::u16string_view text, std::u16string_view pattern, std::size_t from, bool ignoringCase) {
    if (pattern.empty()) return NotFound;
    return ignoringCase ? findIgnoringCase(text, pattern, from) : text.find(pattern, from);
}

}  // namespace

std::string toUtf8(std::u16string_view text) {
    std::string result;
    result.reserve(text.size());
    for (std::size_t i = 0; i < text.size();) {
        const char32_t c = codePointAt(text, i);
        i += unitCount(c);
        appendUtf8(U_IS_SURROGATE(c) ? Replacement : c, result);
    }
    return result;
}

std::u16string fromUtf8(std::string_view bytes) {
    std::u16string result;
    result.reserve(bytes.size());
    for (std::size_t i = 0; i < bytes.size();) {
        const UChar32 c = nextCodePoint(bytes, i);
        appendUtf16(c < 0 ? Replacement : static_cast<char32_t>(c), result);
    }
    return result;
}

std::optional<std::u16string> fromStrictUtf8(std::string_view bytes) {
    std::u16string result;
    result.reserve(bytes.size());
    for (std::size_t i = 0; i < bytes.size();) {
        const UChar32 c = nextCodePoint(bytes, i);
        if (c < 0) return std::nullopt;
        appendUtf16(static_cast<char32_t>(c), result);
    }
    return result;
}

std::u16string lowercased(std::u16string_view text) {
    return mapped(text, u_strToLower);
}

std::u16string uppercased(std::u16string_view text) {
    return mapped(text, u_strToUpper);
}

char32_t foldedCodePoint(char32_t c) {
    static const std::array<char16_t, FoldTableSize> table = makeFoldTable();
    return c < FoldTableSize ? table[c] : foldedByUnicodeData(c);
}

std::u16string folded(std::u16string_view text) {
    std::u16string result(text.size(), u'\0');
    for (std::size_t i = 0; i < text.size(); ++i) result[i] = foldedUnitAt(text, i);
    return result;
}

bool equalsIgnoringCase(std::u16string_view a, std::u16string_view b) {
    return a.size() == b.size() && compareIgnoringCase(a, b) == 0;
}

int compareIgnoringCase(std::u16string_view a, std::u16string_view b) {
    const std::size_t common = std::min(a.size(), b.size());
    for (std::size_t i = 0; i < common; ++i) {
        const char16_t unitA = foldedUnitAt(a, i);
        const char16_t unitB = foldedUnitAt(b, i);
        if (unitA != unitB) return unitA < unitB ? -1 : 1;
    }
    return sign(a.size() < b.size(), a.size() > b.size());
}

int compareNaturally(std::u16string_view a, std::u16string_view b) {
    std::size_t i = 0;
    std::size_t j = 0;
    while (i < a.size() && j < b.size()) {
        const bool digitInA = digitAt(a, i) >= 0;
        const bool digitInB = digitAt(b, j) >= 0;
        if (digitInA && digitInB) {
            const DigitRun runA = digitRunAt(a, i);
            const DigitRun runB = digitRunAt(b, j);
            if (const int order = compareNumbers(a, runA, b, runB); order != 0) return order;
            i = runA.end;
            j = runB.end;
            continue;
        }
        // A number of any script stands where '0' does among other characters, or the order would run in circles.
        const char16_t unitA = digitInA ? u'0' : foldedUnitAt(a, i);
        const char16_t unitB = digitInB ? u'0' : foldedUnitAt(b, j);
        if (unitA != unitB) return unitA < unitB ? -1 : 1;
        ++i;
        ++j;
    }
    return sign(j < b.size(), i < a.size());
}

std::size_t findIgnoringCase(std::u16string_view text, std::u16string_view pattern, std::size_t from) {
    if (pattern.empty() || from > text.size() || pattern.size() > text.size() - from) return NotFound;
    const char16_t first = foldedUnitAt(pattern, 0);
    const std::size_t last = text.size() - pattern.size();
    for (std::size_t start = from; start <= last; ++start) {
        if (foldedUnitAt(text, start) != first) continue;
        std::size_t same = 1;
        while (same < pattern.size() && foldedUnitAt(text, start + same) == foldedUnitAt(pattern, same)) ++same;
        if (same == pattern.size()) return start;
    }
    return NotFound;
}

std::vector<Range> rangesOfString(std::u16string_view text, std::u16string_view pattern, bool ignoringCase) {
    std::vector<Range> ranges;
    std::size_t found = find(text, pattern, 0, ignoringCase);
    while (found != NotFound) {
        ranges.push_back({found, pattern.size()});
        found = find(text, pattern, found + pattern.size(), ignoringCase);
    }
    return ranges;
}

bool containsIgnoringCase(std::u16string_view text, std::u16string_view pattern) {
    return findIgnoringCase(text, pattern) != NotFound;
}

std::vector<std::u16string> split(std::u16string_view text, char16_t separator) {
    std::vector<std::u16string> pieces;
    std::size_t start = 0;
    for (std::size_t end = text.find(separator); end != NotFound; end = text.find(separator, start)) {
        pieces.emplace_back(text.substr(start, end - start));
        start = end + 1;
    }
    pieces.emplace_back(text.substr(start));
    return pieces;
}

std::u16string_view trimmed(std::u16string_view text) {
    const CharacterSet& blank = CharacterSet::whitespacesAndNewlines();
    while (!text.empty() && blank.contains(text.front())) text.remove_prefix(1);
    while (!text.empty() && blank.contains(text.back())) text.remove_suffix(1);
    return text;
}

std::u16string replacingAll(std::u16string_view text, std::u16string_view pattern, std::u16string_view replacement) {
    std::u16string result;
    std::size_t start = 0;
    for (const Range& range : rangesOfString(text, pattern, false)) {
        result.append(text.substr(start, range.location - start)).append(replacement);
        start = range.end();
    }
    return result.append(text.substr(start));
}

std::int64_t integerValue(std::u16string_view text) {
    constexpr std::int64_t Least = std::numeric_limits<std::int64_t>::min();
    constexpr std::int64_t Most = std::numeric_limits<std::int64_t>::max();
    const CharacterSet& blank = CharacterSet::whitespacesAndNewlines();
    while (!text.empty() && blank.contains(text.front())) text.remove_prefix(1);
    const bool negative = text.starts_with(u'-');
    if (negative || text.starts_with(u'+')) text.remove_prefix(1);
    // Counted downwards, as the negative numbers reach one further.
    std::int64_t value = 0;
    for (const char16_t unit : text) {
        if (unit < u'0' || unit > u'9') break;
        const int digit = unit - u'0';
        if (value < (Least + digit) / 10) return negative ? Least : Most;
        value = value * 10 - digit;
    }
    if (negative) return value;
    return value == Least ? Most : -value;
}

}  // namespace plume

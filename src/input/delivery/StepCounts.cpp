#include "input/delivery/StepCounts.h"

#include <unicode/ubrk.h>
#include <unicode/uchar.h>
#include <unicode/uscript.h>
#include <unicode/utf16.h>

#include <algorithm>
#include <array>
#include <memory>
#include <string>

#include "Foundation/CharacterSet.h"

namespace plume {

namespace {

constexpr UChar32 Joiner = 0x200D;
constexpr UChar32 KeycapMark = 0x20E3;

// Below combining marks, and no end of a line of two units.
bool isSimple(std::u16string_view text) {
    constexpr char16_t FirstMark = 0x300;
    return std::all_of(text.begin(), text.end(), [](char16_t unit) { return unit < FirstMark && unit != u'\r'; });
}

// Finds the clusters of one text after the other: opening takes far longer than a short text does.
class Clusters {
  public:
    Clusters() : iterator_(ubrk_open(UBRK_CHARACTER, "", nullptr, 0, &status_), ubrk_close) {}

    template <class Visit>
    void forEach(std::u16string_view text, Visit visit) {
        ubrk_setText(iterator_.get(), text.data(), static_cast<std::int32_t>(text.size()), &status_);
        if (U_FAILURE(status_)) return;
        std::int32_t start = 0;
        for (auto end = ubrk_next(iterator_.get()); end != UBRK_DONE; end = ubrk_next(iterator_.get())) {
            visit(text.substr(static_cast<std::size_t>(start), static_cast<std::size_t>(end - start)));
            start = end;
        }
    }

  private:
    UErrorCode status_ = U_ZERO_ERROR;
    std::unique_ptr<UBreakIterator, void (*)(UBreakIterator*)> iterator_;
};

// Those that are a cluster by themselves between others of their kind, in most scripts nearly all.
bool standsAlone(char16_t unit) {
    static const CharacterSet alone = [] {
        CharacterSet::Ranges ranges;
        for (char32_t c = 0; c < 0x10000; ++c) {
            const auto kind = u_getIntPropertyValue(static_cast<UChar32>(c), UCHAR_GRAPHEME_CLUSTER_BREAK);
            const bool isAlone = kind == U_GCB_OTHER || kind == U_GCB_CONTROL || kind == U_GCB_LF || kind == U_GCB_LV ||
                                 kind == U_GCB_LVT;
            if (isAlone && !U16_IS_SURROGATE(c)) ranges.emplace_back(c, c);
        }
        return CharacterSet::withRanges(ranges);
    }();
    return alone.contains(unit);
}

// How far the text goes that has to be looked at as a whole, from a unit on that may belong to one behind it. Clusters
// end between two units that stand alone; a few more of them are left to the next look, which takes longer to begin.
std::size_t endOfMixedText(std::u16string_view text, std::size_t from) {
    constexpr std::size_t Enough = 32;
    std::size_t alone = 0;
    for (std::size_t at = from; at < text.size(); ++at) {
        alone = standsAlone(text[at]) ? alone + 1 : 0;
        if (alone == Enough) return at;
    }
    return text.size();
}

// What one extended grapheme cluster is made of.
struct Cluster {
    explicit Cluster(std::u16string_view text) {
        for (std::size_t i = 0; i < text.size();) {
            const std::size_t start = i;
            U16_FWD_1(text, i, text.size());
            const bool isPair = i - start == 2;
            const UChar32 c = isPair ? U16_GET_SUPPLEMENTARY(text[start], text[start + 1]) : UChar32{text[start]};
            if (characters++ == 0) {
                first = c;
            } else {
                const std::int8_t type = u_charType(c);
                hasOnlyMarks = hasOnlyMarks && (type == U_NON_SPACING_MARK || type == U_ENCLOSING_MARK);
            }
            if (c == Joiner) ++joiners;
            hasTags = hasTags || (c >= 0xE0020 && c <= 0xE007F);
            isKeycap = isKeycap || c == KeycapMark;
        }
    }

    bool isEmoji() const {
        return isKeycap || u_hasBinaryProperty(first, UCHAR_EXTENDED_PICTOGRAPHIC) ||
               u_hasBinaryProperty(first, UCHAR_REGIONAL_INDICATOR);
    }
    bool isEndOfLine() const { return first == u'\r'; }
    // Of other scripts GTK deletes one mark after the other.
    bool isMarkedLetter() const {
        constexpr std::array Scripts = {USCRIPT_LATIN, USCRIPT_GREEK, USCRIPT_CYRILLIC, USCRIPT_HIRAGANA,
                                        USCRIPT_KATAKANA};
        UErrorCode status = U_ZERO_ERROR;
        const UScriptCode script = uscript_getScript(first, &status);
        return hasOnlyMarks && std::find(Scripts.begin(), Scripts.end(), script) != Scripts.end();
    }

    UChar32 first = 0;
    std::uint64_t characters = 0;
    std::uint64_t joiners = 0;
    bool hasOnlyMarks = true;  // behind the first character
    bool hasTags = false;
    bool isKeycap = false;
};

std::uint64_t backspacesForCluster(const Cluster& cluster, ErasedAtOnce atOnce) {
    if (cluster.isEndOfLine()) return 1;
    switch (atOnce) {
        case ErasedAtOnce::Character:
            break;
        case ErasedAtOnce::EmojiPart:
            if (cluster.isEmoji() && !cluster.hasTags) return 1 + cluster.joiners;
            break;
        case ErasedAtOnce::Emoji:
            if (cluster.isEmoji()) return 1;
            break;
        case ErasedAtOnce::Letter:
            if (cluster.isEmoji() && !cluster.hasTags) return 1;
            if (cluster.isMarkedLetter()) return 1;
            break;
    }
    return cluster.characters;
}

}  // namespace

std::uint64_t backspacesFor(std::u16string_view text, ErasedAtOnce atOnce) {
    if (isSimple(text)) return text.size();
    std::uint64_t count = 0;
    Clusters().forEach(text, [&](std::u16string_view piece) { count += backspacesForCluster(Cluster(piece), atOnce); });
    return count;
}

std::uint64_t leftArrowsFor(std::u16string_view text) {
    if (isSimple(text)) return text.size();
    Clusters clusters;
    std::uint64_t count = 0;
    for (std::size_t position = 0; position < text.size();) {
        std::size_t end = position;
        while (end < text.size() && standsAlone(text[end])) ++end;
        if (end == text.size()) return count + (end - position);
        // The last of them may belong to what is behind it.
        const std::size_t start = std::max(position, end - std::min<std::size_t>(end, 1));
        count += start - position;
        position = endOfMixedText(text, end);
        clusters.forEach(text.substr(start, position - start), [&](std::u16string_view /*piece*/) { ++count; });
    }
    return count;
}

}  // namespace plume

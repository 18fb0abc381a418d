#include "library/SnippetUtils.h"

#include <unicode/utf16.h>

#include <cstddef>

#include "Foundation/CharacterSet.h"
#include "Foundation/Strings.h"
#include "Foundation/Uuid.h"

namespace plume {

namespace {

// The code point at `index`, which moves behind it. Unpaired surrogates stand for themselves.
char32_t nextCodePoint(std::u16string_view text, std::size_t& index) {
    const char16_t unit = text[index++];
    if (!U16_IS_LEAD(unit) || index == text.size() || !U16_IS_TRAIL(text[index])) return unit;
    return static_cast<char32_t>(U16_GET_SUPPLEMENTARY(unit, text[index++]));
}

// Upper-cases a content piece by piece. The pieces are read as one text, so that words and surrogate pairs may run
// across the borders between them.
class CaseCorrector {
  public:
    CaseCorrector(std::u16string_view content, CaseClass caseClass) : content_(content), caseClass_(caseClass) {}

    // What stands for the content from where the last piece ended up to `end`. A pair across `end` belongs to this
    // piece as a whole.
    std::u16string pieceUpTo(std::size_t end) {
        std::u16string piece;
        while (position_ < end) {
            const std::size_t start = position_;
            const char32_t c = nextCodePoint(content_, position_);
            const std::u16string_view character = content_.substr(start, position_ - start);
            if (becomesUpperCase(start, c)) {
                piece += uppercased(character);
            } else {
                piece += character;
            }
        }
        return piece;
    }

  private:
    bool becomesUpperCase(std::size_t start, char32_t c) {
        if (caseClass_ == CaseClass::Capitalised) return start == 0;
        const bool isLetter = CharacterSet::letters().contains(c);
        const bool startsWord = isLetter && atWordStart_;
        atWordStart_ = !isLetter;
        return startsWord && CharacterSet::lowercaseLetters().contains(c);
    }

    std::u16string_view content_;
    CaseClass caseClass_;
    std::size_t position_ = 0;
    bool atWordStart_ = true;
};

template <typename Matches>
std::shared_ptr<Snippet> findSnippet(const SnippetUtils::Groups& groups, std::shared_ptr<SnippetGroup>* parentGroup,
                                     Matches matches) {
    for (const auto& group : groups) {
        for (const auto& snippet : group->items()) {
            if (!matches(*group, *snippet)) continue;
            if (parentGroup) *parentGroup = group;
            return snippet;
        }
    }
    return nullptr;
}

}  // namespace

CaseClass SnippetUtils::caseOf(std::u16string_view typed, std::int64_t flags) {
    std::size_t letters = 0;
    std::size_t upper = 0;
    bool firstIsUpper = false;
    bool lastIsUpper = false;
    for (std::size_t i = 0; i < typed.size();) {
        const char32_t c = nextCodePoint(typed, i);
        if (!CharacterSet::letters().contains(c)) continue;
        lastIsUpper = !CharacterSet::lowercaseLetters().contains(c);
        if (letters == 0) firstIsUpper = lastIsUpper;
        if (lastIsUpper) ++upper;
        ++letters;
    }
    if (letters == 0) return CaseClass::Unspecific;
    if (upper == 0) return CaseClass::LowerCase;
    if (firstIsUpper) return upper == 1 ? CaseClass::Capitalised : CaseClass::UpperCase;
    if (lastIsUpper || (flags & MixedCaseCapitalisesWords) != 0) return CaseClass::CapitaliseWords;
    return CaseClass::Unspecific;
}

std::u16string SnippetUtils::correctedCase(std::u16string_view content, std::u16string_view typed, std::int64_t flags) {
    const CaseClass caseClass = caseOf(typed, flags);
    switch (caseClass) {
        case CaseClass::UpperCase:
            return uppercased(content);
        case CaseClass::Capitalised:
        case CaseClass::CapitaliseWords:
            return CaseCorrector(content, caseClass).pieceUpTo(content.size());
        case CaseClass::Unspecific:
        case CaseClass::LowerCase:
            break;
    }
    return std::u16string(content);
}

AttributedString SnippetUtils::correctedCase(const AttributedString& content, std::u16string_view typed,
                                             std::int64_t flags) {
    const CaseClass caseClass = caseOf(typed, flags);
    if (caseClass == CaseClass::UpperCase) return content.upperCaseAttributedString();
    if (caseClass != CaseClass::Capitalised && caseClass != CaseClass::CapitaliseWords) return content;
    CaseCorrector corrector(content.string(), caseClass);
    AttributedString corrected;
    std::size_t end = 0;
    for (const AttributedString::Run& run : content.runs()) {
        end += run.length;
        corrected.append(corrector.pieceUpTo(end), run.attributes);
    }
    return corrected;
}

std::shared_ptr<Snippet> SnippetUtils::findSnippetByAbbreviation(std::u16string_view abbreviation, const Groups& groups,
                                                                 std::shared_ptr<SnippetGroup>* parentGroup) {
    return findSnippetByAbbreviation(abbreviation, groups, false, parentGroup);
}

std::shared_ptr<Snippet> SnippetUtils::findSnippetByAbbreviation(std::u16string_view abbreviation, const Groups& groups,
                                                                 bool checkPrefix,
                                                                 std::shared_ptr<SnippetGroup>* parentGroup) {
    return findSnippet(groups, parentGroup, [&](const SnippetGroup& group, const Snippet& snippet) {
        if (!snippet.abbreviation()) return false;
        if (!checkPrefix || !group.abbreviationPrefix()) return *snippet.abbreviation() == abbreviation;
        const std::u16string& prefix = *group.abbreviationPrefix();
        return abbreviation.starts_with(prefix) && abbreviation.substr(prefix.size()) == *snippet.abbreviation();
    });
}

std::shared_ptr<Snippet> SnippetUtils::findSnippetByUUID(std::u16string_view uuid, const Groups& groups,
                                                         std::shared_ptr<SnippetGroup>* parentGroup) {
    const auto wanted = Uuid::parse(uuid);
    if (!wanted) return nullptr;
    return findSnippet(groups, parentGroup,
                       [&](const SnippetGroup&, const Snippet& snippet) { return snippet.uuid() == wanted; });
}

}  // namespace plume

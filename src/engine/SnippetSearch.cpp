#include "engine/SnippetSearch.h"

#include <unicode/utf16.h>

#include <cstddef>

#include "Foundation/Strings.h"

namespace plume {

namespace {

// The character that starts at `position`, folded, and `position` behind it. Half a pair counts as a character.
char32_t nextFolded(std::u16string_view text, std::size_t& position) {
    const char16_t unit = text[position++];
    if (!U16_IS_LEAD(unit) || position == text.size() || !U16_IS_TRAIL(text[position])) return foldedCodePoint(unit);
    return foldedCodePoint(static_cast<char32_t>(U16_GET_SUPPLEMENTARY(unit, text[position++])));
}

class WildcardPattern {
  public:
    explicit WildcardPattern(std::u16string_view pattern) {
        for (std::size_t position = 0; position < pattern.size();) {
            const char32_t character = nextFolded(pattern, position);
            characters_ += character == U'*' ? AnyRun : character == U'?' ? AnyCharacter : character;
        }
    }

    bool matches(std::u16string_view text) const {
        std::size_t position = 0;
        std::size_t place = 0;
        Run run;
        while (position < text.size()) {
            if (isAt(place, AnyRun)) {
                run = {++place, position};
                continue;
            }
            const char32_t character = nextFolded(text, position);
            if (isAt(place, AnyCharacter) || isAt(place, character)) {
                ++place;
            } else if (run.placeBehind != NotFound) {
                // Only the last run is ever made longer: what stands before it is settled. So the time grows with the
                // product of both lengths at worst.
                nextFolded(text, run.end);
                position = run.end;
                place = run.placeBehind;
            } else {
                return false;
            }
        }
        return characters_.find_first_not_of(AnyRun, place) == std::u32string::npos;
    }

  private:
    // What the last "*" that was passed stands for.
    struct Run {
        std::size_t placeBehind = NotFound;  // in the pattern
        std::size_t end = 0;                 // in the text
    };
    // Beyond all characters.
    static constexpr char32_t AnyRun = 0x110000;
    static constexpr char32_t AnyCharacter = 0x110001;

    bool isAt(std::size_t place, char32_t character) const {
        return place < characters_.size() && characters_[place] == character;
    }

    std::u32string characters_;
};

class SearchedText {
  public:
    SearchedText(std::u16string_view text, bool isWildcard) : text_(text) {
        const bool hasWildcard = text.find_first_of(u"*?") != std::u16string_view::npos;
        const bool hasOther = text.find_first_not_of(u"*?") != std::u16string_view::npos;
        if (isWildcard && hasWildcard && hasOther) pattern_.emplace(text);
    }

    bool isIn(std::u16string_view text) const {
        return pattern_ ? !text.empty() && pattern_->matches(text) : containsIgnoringCase(text, text_);
    }

    bool isIn(const Snippet& snippet, std::int64_t searchBy) const {
        if ((searchBy & SnippetSearch::Abbreviation) != 0 && isIn(snippet.abbreviationWithPrefix().value_or(u""))) {
            return true;
        }
        const auto& content = snippet.richTextContent();
        if ((searchBy & SnippetSearch::Content) != 0 && content && isIn(content->string())) return true;
        return (searchBy & SnippetSearch::Label) != 0 && snippet.label() && isIn(*snippet.label());
    }

  private:
    std::u16string_view text_;
    std::optional<WildcardPattern> pattern_;
};

}  // namespace

std::optional<SnippetSearch::Found> SnippetSearch::filter(const std::optional<std::u16string>& searchText,
                                                          const Groups& inGourps, bool isWildcard,
                                                          std::int64_t searchBy, Groups* orderedGroups) {
    if (!searchText || searchText->empty()) return std::nullopt;
    const SearchedText searched(*searchText, isWildcard);
    Found found;
    if (orderedGroups) orderedGroups->clear();
    for (const auto& group : inGourps) {
        Snippets matching;
        for (const auto& snippet : group->items()) {
            if (searched.isIn(*snippet, searchBy)) matching.push_back(snippet);
        }
        if (matching.empty()) continue;
        found.emplace(group, std::move(matching));
        if (orderedGroups) orderedGroups->push_back(group);
    }
    return found;
}

}  // namespace plume

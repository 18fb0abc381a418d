// The fast search for suggestions held against a naive one, written straight from the rules, on random libraries, edits
// and buffers.
#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include "Foundation/Strings.h"
#include "engine/SuggestionController.h"
#include "tests/engine/MatcherSupport.h"
#include "tests/engine/RandomLibrary.h"

namespace plume {
namespace {

using Groups = SnippetMatcher::Groups;
// A snippet, and the text that made it a suggestion.
using Suggestion = SnippetMatcher::Match;

class NaiveSuggestions {
  public:
    NaiveSuggestions(std::u16string letters, const Groups& groups) : letters_(std::move(letters)), groups_(groups) {}

    std::vector<Suggestion> find() const {
        std::vector<Suggestion> prefixed;
        std::vector<Suggestion> plain;
        for (const auto& group : groups_) {
            const std::vector<std::u16string> candidates = tailsAtPrefix(*group);
            for (const auto& snippet : group->items()) {
                if (!snippet->hasContent() || snippet->abbreviation().value_or(u"").empty()) continue;
                if (group->hasAbbreviationPrefix()) {
                    addPrefixed(*group->abbreviationPrefix(), snippet, candidates, prefixed);
                } else {
                    addPlain(*group, snippet, plain);
                }
            }
        }
        std::stable_sort(plain.begin(), plain.end(), [](const Suggestion& a, const Suggestion& b) {
            if (a.second.size() != b.second.size()) return a.second.size() > b.second.size();
            return compareIgnoringCase(a.second, b.second) < 0;
        });
        prefixed.insert(prefixed.end(), plain.begin(), plain.end());
        return prefixed;
    }

  private:
    static bool mayStandAfter(const SnippetGroup& group, char16_t before) {
        switch (static_cast<int>(group.expandAfter())) {
            case 0:
                return std::u16string(u" ;.\n").find(before) != std::u16string::npos || (before & 0xf800) == 0xd800;
            case 1:
                return before == u' ' || before == u'\n';
            case 2:
                return true;
            case 3:
                return before == u'1';
            default:
                return false;
        }
    }

    static bool areEqual(const Snippet& snippet, std::u16string_view a, std::u16string_view b) {
        return snippet.caseSensitivity() == CaseSensitivity::CaseSensitive ? a == b : folded(a) == folded(b);
    }

    std::vector<std::u16string> tailsAtPrefix(const SnippetGroup& group) const {
        std::vector<std::u16string> tails;
        const std::u16string prefix = folded(group.abbreviationPrefix().value_or(u""));
        if (prefix.empty()) return tails;
        for (std::size_t start = 0; start < letters_.size(); ++start) {
            if (folded(letters_).substr(start, prefix.size()) != prefix) continue;
            if (start == 0 || mayStandAfter(group, letters_[start - 1])) tails.push_back(letters_.substr(start));
        }
        return tails;
    }

    static void addPrefixed(const std::u16string& prefix, const std::shared_ptr<Snippet>& snippet,
                            const std::vector<std::u16string>& candidates, std::vector<Suggestion>& found) {
        const std::u16string whole = prefix + *snippet->abbreviation();
        for (const std::u16string& typed : candidates) {
            if (whole.size() < typed.size()) continue;
            if (areEqual(*snippet, whole.substr(0, typed.size()), typed)) found.push_back({snippet, typed});
        }
    }

    void addPlain(const SnippetGroup& group, const std::shared_ptr<Snippet>& snippet,
                  std::vector<Suggestion>& found) const {
        const std::u16string& abbreviation = *snippet->abbreviation();
        for (std::size_t length = std::min(abbreviation.size(), letters_.size()); length > 0; --length) {
            const std::size_t start = letters_.size() - length;
            if (start > 0 && !mayStandAfter(group, letters_[start - 1])) continue;
            if (!areEqual(*snippet, abbreviation.substr(0, length), letters_.substr(start))) continue;
            found.push_back({snippet, abbreviation.substr(0, length)});
            return;
        }
    }

    std::u16string letters_;
    const Groups& groups_;
};

// Any text, or one that ends in the middle of an abbreviation, perhaps in another case.
std::u16string randomBuffer(const Groups& groups) {
    std::u16string letters = randomText(6);
    const auto group = *rc::gen::elementOf(groups);
    if (group->items().empty() || *rc::gen::inRange(0, 5) == 0) return letters;
    std::u16string typing = *(*rc::gen::elementOf(group->items()))->abbreviationWithPrefix();
    typing.resize(*rc::gen::inRange<std::size_t>(0, typing.size() + 1));
    if (*rc::gen::inRange(0, 4) == 0) typing = uppercased(typing);
    return letters + typing;
}

void editForSuggestions(Groups& groups) {
    editLibrary(groups);
    const auto group = *rc::gen::elementOf(groups);
    constexpr int NoRule = 7;
    if (*rc::gen::inRange(0, 10) == 0) group->setExpandAfter(static_cast<ExpandAfter>(NoRule));
    // Long enough to be told apart by more than their first letters.
    if (*rc::gen::inRange(0, 3) == 0) group->addItem(std::make_shared<Snippet>(randomText(9, 3), u"content"));
}

RC_GTEST_PROP(SuggestionModel, AgreesWithTheRules, ()) {
    Groups groups = randomLibrary();
    SnippetMatcher matcher(testDelimiters());
    std::size_t seen = 0;
    const int rounds = *rc::gen::inRange(1, 12);
    for (int i = 0; i < rounds; ++i) {
        if (*rc::gen::inRange(0, 2) == 0) editForSuggestions(groups);
        matcher.setSnippetGroups(groups);
        const std::u16string letters = randomBuffer(groups);
        Groups asked;
        std::copy_if(groups.begin(), groups.end(), std::back_inserter(asked),
                     [](const auto& group) { return group->suggestAbbreviations(); });
        SuggestionList list;
        matcher.findSuggestions(letters, asked, list);
        std::vector<Suggestion> found;
        for (std::size_t j = 0; j < list.size(); ++j) found.push_back({list.suggestions[j], list.suggestionFilters[j]});
        RC_ASSERT(found == NaiveSuggestions(letters, asked).find());
        seen += found.size();
    }
    RC_CLASSIFY(seen > 0);
}

// What many edits leave behind never comes out again, and never hides what is there.
TEST(SuggestionIndex, FollowsThousandsOfEdits) {
    const auto group = SnippetGroup::make();
    SnippetMatcher matcher(testDelimiters());
    matcher.setSnippetGroups({group});
    constexpr std::size_t Snippets = 3000;
    std::vector<std::shared_ptr<Snippet>> snippets;
    for (std::size_t i = 0; i < Snippets; ++i) {
        snippets.push_back(std::make_shared<Snippet>(u"old" + fromUtf8(std::to_string(i)), u"content"));
    }
    const auto count = [&](std::u16string_view letters) {
        SuggestionList list;
        matcher.findSuggestions(letters, {group}, list);
        return list.size();
    };
    group->addItems(snippets);
    EXPECT_EQ(count(u"ol"), Snippets);
    EXPECT_EQ(count(u"old299"), 11U);
    for (std::size_t i = 0; i < Snippets; i += 2) snippets[i]->setAbbreviation(u"new" + *snippets[i]->abbreviation());
    EXPECT_EQ(count(u"old"), Snippets / 2);
    EXPECT_EQ(count(u"newold29"), 55U);
    group->setExpandTrigger(ExpandTrigger::Never);
    EXPECT_EQ(count(u"ne"), Snippets / 2) << "they are suggested all the same";
    snippets[0]->setAbbreviation(u"other");
    EXPECT_EQ(count(u"oth"), 1U);
    group->setAbbreviationPrefix(u";");
    EXPECT_EQ(count(u"ne"), 0U);
    EXPECT_EQ(count(u";"), Snippets);
    group->replaceItems({snippets[1], snippets[2]});
    EXPECT_EQ(count(u";"), 2U);
}

}  // namespace
}  // namespace plume

// The fast matcher held against a naive one, written straight from the rules without index or hash, on random
// libraries, edits and typings.
#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include "Foundation/Strings.h"
#include "engine/SnippetMatcher.h"
#include "tests/engine/MatcherSupport.h"
#include "tests/engine/RandomLibrary.h"

namespace plume {
namespace {

class NaiveMatcher {
  public:
    NaiveMatcher(std::vector<std::shared_ptr<SnippetGroup>> groups, std::u16string before, std::u16string key,
                 const Place& place)
        : groups_(std::move(groups)), before_(std::move(before)), key_(std::move(key)), place_(place) {}

    std::vector<SnippetMatcher::Match> find() const {
        std::vector<SnippetMatcher::Match> found;
        for (const auto& group : groups_) {
            if (!triggers(*group) || !isActive(group->availability())) continue;
            const bool atOnce = group->expandTrigger() == ExpandTrigger::Immediately;
            const std::u16string text = atOnce ? before_ + key_ : before_;
            if (group->hasAbbreviationPrefix()) {
                findPrefixed(*group, text, found);
            } else {
                findPlain(*group, text, found);
            }
        }
        return found;
    }

  private:
    bool triggers(const SnippetGroup& group) const {
        const bool hotKey = key_.empty();
        switch (static_cast<int>(group.expandTrigger())) {
            case 0:
                return !hotKey;
            case 1:
            case 2:
                return !hotKey && group.delimiters().value_or(testDelimiters()).contains(key_[0]);
            case 4:
                return hotKey;
            default:
                return false;
        }
    }

    static bool lists(const std::optional<std::vector<std::u16string>>& list,
                      const std::optional<std::u16string>& item) {
        return list && item && std::find(list->begin(), list->end(), *item) != list->end();
    }

    bool isActive(const PLFunctionAvailability& where) const {
        const bool inApplications = lists(where.applications, place_.application);
        const bool inSources = lists(where.inputMethods, place_.inputSource);
        const bool application = where.availability == 0 || (where.availability == 1 && !inApplications) ||
                                 (where.availability == 2 && inApplications);
        const bool source = where.inputMethodsOption == 0 || (where.inputMethodsOption == 1 ? !inSources : inSources);
        return application && source;
    }

    static bool mayStandAfter(const SnippetGroup& group, const std::u16string& text, std::size_t index) {
        const std::u16string before = text.substr(0, index);
        if (group.expandAfter() == ExpandAfter::Anything) return true;
        if (before.empty()) return group.expandAfter() != ExpandAfter::Digits;
        const char16_t last = before.back() == u'\n' ? u'\r' : before.back();
        if (last == 0xfffc) return true;
        if (group.expandAfter() == ExpandAfter::Delimiter) {
            return group.expandAfterDelimiters().value_or(testDelimiters()).contains(last);
        }
        if (group.expandAfter() == ExpandAfter::Whitespace) return isWhite(last);
        const std::size_t digits = before.size() - (before.find_last_not_of(u"0123456789") + 1);
        if (digits == 0) return false;
        if (digits == before.size()) return true;
        const char16_t edge = before[before.size() - digits - 1];
        return isWhite(edge) || testDelimiters().contains(edge);
    }
    static bool isWhite(char16_t unit) { return unit == u' ' || unit == u'\t' || unit == u'\n' || unit == u'\r'; }

    static void findPlain(const SnippetGroup& group, const std::u16string& text,
                          std::vector<SnippetMatcher::Match>& found) {
        for (const auto& snippet : group.items()) {
            const std::u16string wanted = snippet->abbreviation().value_or(u"");
            if (wanted.empty() || wanted.size() > text.size() || !snippet->hasContent()) continue;
            const std::size_t start = text.size() - wanted.size();
            const std::u16string typed = text.substr(start);
            const bool equal = snippet->caseSensitivity() == CaseSensitivity::CaseSensitive
                                   ? typed == wanted
                                   : folded(typed) == folded(wanted);
            if (equal && mayStandAfter(group, text, start)) found.push_back({snippet, typed});
        }
    }

    static void findPrefixed(const SnippetGroup& group, const std::u16string& text,
                             std::vector<SnippetMatcher::Match>& found) {
        const std::u16string prefix = *group.abbreviationPrefix();
        const std::u16string foldedText = folded(text);
        std::size_t start = 0;
        while ((start = foldedText.find(folded(prefix), start)) != std::u16string::npos) {
            const std::size_t end = start + prefix.size();
            const std::u16string rest = text.substr(end);
            if (!rest.empty() && mayStandAfter(group, text, start)) {
                for (const auto& snippet : group.items()) {
                    if (!snippet->hasContent() || folded(snippet->abbreviation().value_or(u"")) != folded(rest))
                        continue;
                    const std::u16string typed = text.substr(start);
                    const bool exact = snippet->caseSensitivity() == CaseSensitivity::CaseSensitive;
                    if (exact && typed != prefix + *snippet->abbreviation()) continue;
                    found.push_back({snippet, typed});
                }
            }
            start = end;
        }
    }

    std::vector<std::shared_ptr<SnippetGroup>> groups_;
    std::u16string before_;
    std::u16string key_;
    const Place& place_;
};

// What somebody types next: an abbreviation and a delimiter, or anything.
std::u16string plannedTyping(const std::vector<std::shared_ptr<SnippetGroup>>& groups) {
    const auto group = *rc::gen::elementOf(groups);
    if (group->items().empty() || *rc::gen::inRange(0, 4) == 0) return randomText(4) + u"a";
    std::u16string typing = *(*rc::gen::elementOf(group->items()))->abbreviationWithPrefix();
    if (*rc::gen::inRange(0, 4) == 0) typing = uppercased(typing);
    return *rc::gen::element<std::u16string>(u"", u" ", u"1", u"b", u"\n") + typing +
           *rc::gen::element<std::u16string>(u"", u" ", u"b", u".");
}

// One character of the plan, or, now and then, the hot key.
std::u16string nextKey(std::u16string& planned) {
    if (planned.empty() || *rc::gen::inRange(0, 8) == 0) return u"";
    const bool pair = (planned[0] & 0xfc00) == 0xd800 && planned.size() > 1;
    const std::u16string key = planned.substr(0, pair ? 2 : 1);
    planned.erase(0, key.size());
    return key;
}

RC_GTEST_PROP(MatcherModel, AgreesWithTheRules, ()) {
    SnippetMatcher::Groups groups = randomLibrary();
    SnippetMatcher matcher(testDelimiters());
    matcher.setSnippetGroups(groups);

    // Sometimes a long buffer, and sometimes one full of prefixes that overlap themselves.
    std::u16string letters = *rc::gen::element(0, 0, 1) ? std::u16string(5000, u'x') : randomText(8);
    if (*rc::gen::inRange(0, 4) == 0) letters += std::u16string(*rc::gen::inRange<std::size_t>(1, 40), u';');
    const Place place(*rc::gen::element<std::optional<std::u16string>>(u"org.editor", u"org.mail", std::nullopt),
                      *rc::gen::element<std::optional<std::u16string>>(u"US", u"German"));
    const int keys = *rc::gen::inRange(1, 40);
    std::size_t matchesSeen = 0;
    std::u16string planned;
    for (int i = 0; i < keys; ++i) {
        if (*rc::gen::inRange(0, 8) == 0) {
            editLibrary(groups);
            matcher.setSnippetGroups(groups);
        }
        if (planned.empty()) planned = plannedTyping(groups);
        const std::u16string key = nextKey(planned);
        const auto expected = NaiveMatcher(groups, letters, key, place).find();
        RC_ASSERT(typeKey(matcher, letters, key, place) == expected);
        matchesSeen += expected.size();
        letters += key;
    }
    RC_CLASSIFY(matchesSeen > 0);
}

}  // namespace
}  // namespace plume

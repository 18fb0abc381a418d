// Random libraries and edits of them, for tests that hold what is fast against what is simple.
#pragma once

#include <rapidcheck.h>

#include <algorithm>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "engine/SnippetMatcher.h"
#include "library/SnippetGroup.h"

namespace plume {

// Few characters, so that random typings complete random abbreviations often.
inline const std::vector<std::u16string> Alphabet = {u"a",      u"A",      u"b",      u";",          u" ",
                                                     u"1",      u".",      u"\n",     u"\u00e9",     u"\u00c9",
                                                     u"\u03c3", u"\u03a3", u"\u03c2", u"\U00010400", u"\U00010428"};

inline std::u16string randomText(int most, std::size_t letters = Alphabet.size()) {
    std::u16string text;
    const int length = *rc::gen::inRange(0, most + 1);
    for (int i = 0; i < length; ++i) text += Alphabet[*rc::gen::inRange<std::size_t>(0, letters)];
    return text;
}

inline void randomizeSettings(SnippetGroup& group) {
    group.setExpandTrigger(static_cast<ExpandTrigger>(*rc::gen::element(0, 0, 0, 1, 2, 3, 4)));
    group.setExpandAfter(static_cast<ExpandAfter>(*rc::gen::element(0, 1, 2, 2, 3)));
    group.setSuggestAbbreviations(*rc::gen::inRange(0, 5) > 0);
    group.setAbbreviationPrefix(*rc::gen::element<std::u16string>(u"", u"", u";", u";;", u"aA", u"a;a", u"\u00e9"));
    group.setDelimiters(*rc::gen::element<std::optional<CharacterSet>>(
        std::nullopt, CharacterSet::withCharacters(u"b "), CharacterSet::withCharacters(u".")));
    group.availability().availability = *rc::gen::element(0, 0, 0, 1, 2);
    group.availability().applications = {{u"org.editor"}};
    group.availability().inputMethodsOption = *rc::gen::element(0, 0, 0, 1, 2);
    group.availability().inputMethods = {{u"US"}};
}

inline std::shared_ptr<Snippet> randomSnippet() {
    const bool hasContent = *rc::gen::inRange(0, 10) > 0;
    auto snippet = std::make_shared<Snippet>(randomText(3), hasContent ? Snippet::Text(u"content") : std::nullopt);
    snippet->setCaseSensitivity(static_cast<CaseSensitivity>(*rc::gen::inRange(0, 3)));
    return snippet;
}

inline SnippetMatcher::Groups randomLibrary() {
    SnippetMatcher::Groups groups;
    const int groupCount = *rc::gen::inRange(1, 6);
    for (int i = 0; i < groupCount; ++i) {
        groups.push_back(SnippetGroup::make());
        randomizeSettings(*groups.back());
        const int snippets = *rc::gen::inRange(0, 12);
        for (int j = 0; j < snippets; ++j) groups.back()->addItem(randomSnippet());
    }
    return groups;
}

inline void editLibrary(SnippetMatcher::Groups& groups) {
    if (groups.empty()) return;
    const auto group = *rc::gen::elementOf(groups);
    switch (*rc::gen::inRange(0, 5)) {
        case 0:
            randomizeSettings(*group);
            break;
        case 1:
            group->insertItem(randomSnippet(), *rc::gen::inRange<std::size_t>(0, group->items().size() + 1));
            break;
        case 2:
            if (!group->items().empty()) group->removeItem(*rc::gen::elementOf(group->items()));
            break;
        case 3:
            if (!group->items().empty()) (*rc::gen::elementOf(group->items()))->setAbbreviation(randomText(3));
            break;
        default:
            std::rotate(groups.begin(), groups.begin() + 1, groups.end());
    }
}

}  // namespace plume

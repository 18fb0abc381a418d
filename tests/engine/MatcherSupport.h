// What the tests of matching share: a place where keys go, and one key typed after a buffer.
#pragma once

#include <optional>
#include <string>
#include <vector>

#include "engine/SnippetMatcher.h"

namespace plume {

// The default delimiters.
inline CharacterSet testDelimiters() {
    return CharacterSet::withCharacters(u" \t\r\x03.!?,;:-\"'(){}[]/\\&+*=<>\u00ab\u00bb%^#_@$`|~");
}

struct Place final : MatchContext {
    Place(std::optional<std::u16string> anApplication, std::optional<std::u16string> anInputSource)
        : application(std::move(anApplication)), inputSource(std::move(anInputSource)) {}
    const std::optional<std::u16string>& bundleIdentifier() const override { return application; }
    const std::optional<std::u16string>& inputSourceIdentifier() const override { return inputSource; }

    std::optional<std::u16string> application;
    std::optional<std::u16string> inputSource;
};

// What the matcher finds when `key` is typed after `before`; an empty key, or U+0000, stands for the expand hot key.
inline std::vector<SnippetMatcher::Match> typeKey(const SnippetMatcher& matcher, const std::u16string& before,
                                                  const std::u16string& key,
                                                  const Place& place = {u"org.editor", u"US"}) {
    if (key.empty() || key[0] == 0) return matcher.findSnippetsInLetters(before, 0, before, place);
    const std::u16string letters = before + key;
    return matcher.findSnippetsInLetters(letters, key[0], before, place);
}

inline std::vector<std::u16string> contentsOf(const std::vector<SnippetMatcher::Match>& matches) {
    std::vector<std::u16string> contents;
    for (const auto& match : matches) contents.push_back(*match.first->plainTextContent());
    return contents;
}

}  // namespace plume

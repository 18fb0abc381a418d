// What the tests of matching share: a place where keys go, and one key typed after a buffer.
#pragma once

#include <optional>
#include <string>
#include <vector>

#include "engine/SnippetMatcher.h"
#include "ports/simulated/SimulatedInputSources.h"
#include "ports/simulated/SimulatedProcessManager.h"

namespace plume {

// The default delimiters.
inline CharacterSet testDelimiters() {
    return CharacterSet::withCharacters(u" \t\r\x03.!?,;:-\"'(){}[]/\\&+*=<>\u00ab\u00bb%^#_@$`|~");
}

// Where keys go. Without a name the application is one that nobody knows.
class Place {
  public:
    Place(std::optional<std::u16string> anApplication, std::optional<std::u16string> anInputSource)
        : application(std::move(anApplication)), inputSource(std::move(anInputSource)) {
        if (application) process_ = processes_.launch(application);
        sources_.setIdentifier(inputSource);
    }
    Place(const Place&) = delete;
    Place& operator=(const Place&) = delete;

    KeyDestination destination() const { return {resolver_, sources_, process_}; }

    const std::optional<std::u16string> application;
    const std::optional<std::u16string> inputSource;

  private:
    SimulatedProcessManager processes_;
    SimulatedInputSources sources_;
    mutable BundleIdentifierResolver resolver_{processes_};
    ProcessSerialNumber process_;
};

// What the matcher finds when `key` is typed after `before`; an empty key, or U+0000, stands for the expand hot key.
inline std::vector<SnippetMatcher::Match> typeKey(const SnippetMatcher& matcher, const std::u16string& before,
                                                  const std::u16string& key,
                                                  const Place& place = Place(u"org.editor", u"US")) {
    SnippetMatcher::Refusals refusals;
    if (key.empty() || key[0] == 0) {
        return matcher.findSnippetsInLetters(before, 0, before, place.destination(), refusals);
    }
    const std::u16string letters = before + key;
    return matcher.findSnippetsInLetters(letters, key[0], before, place.destination(), refusals);
}

inline std::vector<std::u16string> contentsOf(const std::vector<SnippetMatcher::Match>& matches) {
    std::vector<std::u16string> contents;
    for (const auto& match : matches) contents.push_back(*match.first->plainTextContent());
    return contents;
}

}  // namespace plume

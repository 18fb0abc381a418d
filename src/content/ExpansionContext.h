// What all the texts of one expansion share: the snippet, how much may still be done, and what was found already.
#pragma once

#include <chrono>
#include <cstddef>
#include <memory>
#include <optional>
#include <string>
#include <unordered_map>
#include <vector>

#include "Foundation/text/AttributedString.h"
#include "content/ContentEnvironment.h"
#include "content/SnippetAbbreviationVariable.h"
#include "library/SnippetGroup.h"

namespace plume {

// Lives on the stack of one parse; refers to its arguments.
class ExpansionContext {
  public:
    using Groups = std::vector<std::shared_ptr<SnippetGroup>>;

    // One expansion gives up beyond these.
    static constexpr std::size_t MaximumReplacements = 100'000;
    static constexpr std::size_t MaximumLength = std::size_t{16} * 1024 * 1024;  // UTF-16 units
    // Find-and-replace with patterns may take this long in one expansion; what comes later leaves the clipboard's text
    // as it is. The keyboard waits meanwhile.
    static constexpr std::chrono::milliseconds MaximumPatternTime{200};

    ExpansionContext(const ContentEnvironment& anEnvironment, const std::shared_ptr<Snippet>& aSnippet,
                     const Groups& groups);

    const ContentEnvironment& environment() const { return environment_; }
    // The snippet that is expanded, whatever snippets are nested in it.
    const Snippet& snippet() const { return *snippet_; }

    // Each takes something off what this expansion may still do. False, from then on always, once that is used up.
    bool takeReplacement();
    bool takeUnits(std::size_t count);
    bool enterScript();
    void leaveScript() { --scriptDepth_; }
    bool isExhausted() const { return exhausted_; }

    // What find-and-replace with patterns may still take; the caller takes off what it took.
    std::chrono::nanoseconds& patternTimeLeft() { return patternTimeLeft_; }

    // To be called before a date or time is written. Where the system's zone is asked for, it is that of now, but the
    // same throughout the expansion.
    void settleTimeZone();

    // The snippet that the placeholder names, looked up once for equal names. Null when there is none, or when it is
    // the expanded snippet itself.
    std::shared_ptr<Snippet> nestedSnippet(const SnippetAbbreviationVariable& variable);

    // The clipboard, read once. Nothing when it holds no content of that form.
    const std::optional<std::u16string>& clipboardText();
    const std::optional<AttributedString>& richClipboard();

  private:
    // Scripts within scripts: the only nesting that takes stack.
    static constexpr std::size_t MaximumScriptDepth = 100;

    bool giveUp();

    const ContentEnvironment& environment_;
    const std::shared_ptr<Snippet>& snippet_;
    const Groups& groups_;
    std::size_t replacementsLeft_ = MaximumReplacements;
    std::size_t unitsLeft_ = MaximumLength;
    std::chrono::nanoseconds patternTimeLeft_ = MaximumPatternTime;
    std::size_t scriptDepth_ = 0;
    bool exhausted_ = false;
    bool timeZoneSettled_ = false;
    std::unordered_map<std::u16string, std::shared_ptr<Snippet>> found_;
    // The outer level: whether it was read.
    std::optional<std::optional<std::u16string>> clipboardText_;
    std::optional<std::optional<AttributedString>> richClipboard_;
};

}  // namespace plume

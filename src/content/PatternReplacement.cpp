#include "content/PatternReplacement.h"

#include <unicode/regex.h>

#include <cstdint>
#include <memory>
#include <optional>
#include <variant>
#include <vector>

#include "content/ContentEnvironment.h"

namespace plume {
namespace {

using Clock = std::chrono::steady_clock;
using MatchingOption = SnippetClipboardVariable::MatchingOption;

constexpr std::int32_t MatcherStackBytes = 8 * 1024 * 1024;
constexpr std::size_t LongestPattern = std::size_t{16} * 1024;

icu::UnicodeString aliasOf(std::u16string_view text) {
    return icu::UnicodeString(false, text.data(), static_cast<std::int32_t>(text.size()));
}

// A replacement with references to groups ("$1", "${name}"; a backslash takes the meaning from what follows it), read
// once for all matches.
class ReplacementTemplate {
  public:
    // Nothing when the text refers to a group that the pattern does not have, or ends in a lone backslash.
    static std::optional<ReplacementTemplate> read(std::u16string_view text, const icu::RegexPattern& pattern,
                                                   std::int32_t groupCount) {
        ReplacementTemplate result;
        for (std::size_t i = 0; i < text.size();) {
            const char16_t unit = text[i++];
            if (unit == u'\\') {
                if (i == text.size()) return std::nullopt;
                result.addLiteral(text[i++]);
            } else if (unit == u'$' && i < text.size() && (isDigit(text[i]) || text[i] == u'{')) {
                if (!result.addGroup(text, i, pattern, groupCount)) return std::nullopt;
            } else {
                result.addLiteral(unit);
            }
        }
        return result;
    }

    // The replacement of the matcher's present match; cut off where no result can be that long.
    std::u16string expand(const icu::RegexMatcher& matcher, std::u16string_view content) const {
        std::u16string text;
        for (const Piece& piece : pieces_) {
            if (const auto* literal = std::get_if<std::u16string>(&piece)) {
                text += *literal;
            } else {
                UErrorCode status = U_ZERO_ERROR;
                const std::int32_t group = std::get<std::int32_t>(piece);
                const std::int32_t start = matcher.start(group, status);
                const std::int32_t end = matcher.end(group, status);
                if (start < 0) continue;
                text += content.substr(static_cast<std::size_t>(start), static_cast<std::size_t>(end - start));
            }
            if (text.size() > LongestReplacementResult) break;
        }
        return text;
    }

  private:
    using Piece = std::variant<std::u16string, std::int32_t>;  // a literal text, or a group's number

    static bool isDigit(char16_t unit) { return unit >= u'0' && unit <= u'9'; }

    void addLiteral(char16_t unit) {
        if (pieces_.empty() || !std::holds_alternative<std::u16string>(pieces_.back())) {
            pieces_.emplace_back(std::u16string());
        }
        std::get<std::u16string>(pieces_.back()) += unit;
    }

    // `next` stands after the "$". Digits belong to the number as long as there is such a group.
    bool addGroup(std::u16string_view text, std::size_t& next, const icu::RegexPattern& pattern,
                  std::int32_t groupCount) {
        if (text[next] == u'{') return addNamedGroup(text, next, pattern);
        std::int32_t group = text[next++] - u'0';
        if (group > groupCount) return false;
        while (next < text.size() && isDigit(text[next]) && group * 10 + (text[next] - u'0') <= groupCount) {
            group = group * 10 + (text[next++] - u'0');
        }
        pieces_.emplace_back(group);
        return true;
    }

    bool addNamedGroup(std::u16string_view text, std::size_t& next, const icu::RegexPattern& pattern) {
        const std::size_t close = text.find(u'}', next);
        if (close == std::u16string_view::npos) return false;
        UErrorCode status = U_ZERO_ERROR;
        const std::int32_t group =
            pattern.groupNumberFromName(aliasOf(text.substr(next + 1, close - next - 1)), status);
        if (U_FAILURE(status)) return false;
        next = close + 1;
        pieces_.emplace_back(group);
        return true;
    }

    std::vector<Piece> pieces_;
};

// The text as a pattern that matches just it. Quoting ends at "\E", so one in the text is put outside the quotes.
std::u16string quotedPattern(std::u16string_view text) {
    return u"\\Q" + replacingAll(text, u"\\E", u"\\E\\\\E\\Q") + u"\\E";
}

std::u16string patternOf(const SnippetClipboardVariable& variable) {
    const std::u16string& find = *variable.find;
    if (variable.regularExpressions) return find;
    const bool atStart = variable.matchingOption != MatchingOption::WordEnd;
    const bool atEnd = variable.matchingOption != MatchingOption::WordStart;
    return (atStart ? u"(?<=\\W|\\A)" : u"") + quotedPattern(find) + (atEnd ? u"(?=\\W|\\z)" : u"");
}

UBool inTime(const void* deadline) {
    return Clock::now() < *static_cast<const Clock::time_point*>(deadline);
}

UBool matchInTime(const void* deadline, std::int32_t) {
    return inTime(deadline);
}

UBool findInTime(const void* deadline, std::int64_t) {
    return inTime(deadline);
}

// As visitMatches, with a pattern and a replacement that could be read.
std::string visitMatchesOf(icu::RegexMatcher& matcher, const ReplacementTemplate& replacement,
                           std::u16string_view content, const Clock::time_point& deadline,
                           const ReplacementVisitor& visitor) {
    UErrorCode status = U_ZERO_ERROR;
    matcher.setStackLimit(MatcherStackBytes, status);
    matcher.setMatchCallback(matchInTime, &deadline, status);
    matcher.setFindProgressCallback(findInTime, &deadline, status);
    while (matcher.find(status)) {
        const auto start = static_cast<std::size_t>(matcher.start(status));
        const auto end = static_cast<std::size_t>(matcher.end(status));
        if (!inTime(&deadline)) return "takes too much time or memory to search for";
        if (!visitor({start, end - start}, replacement.expand(matcher, content))) return "makes the text too long";
    }
    return U_FAILURE(status) ? "takes too much time or memory to search for" : "";
}

}  // namespace

bool usesPattern(const SnippetClipboardVariable& variable) {
    return variable.regularExpressions || variable.matchingOption != MatchingOption::Anywhere;
}

std::string visitMatches(const SnippetClipboardVariable& variable, std::u16string_view content,
                         std::chrono::steady_clock::time_point deadline, const ReplacementVisitor& visitor) {
    const std::u16string text = patternOf(variable);
    if (text.size() > LongestPattern) return "is too long to search for";
    UErrorCode status = U_ZERO_ERROR;
    const std::uint32_t flags = variable.matchCase ? 0 : UREGEX_CASE_INSENSITIVE;
    UParseError problem;
    const std::unique_ptr<icu::RegexPattern> pattern(icu::RegexPattern::compile(aliasOf(text), flags, problem, status));
    if (U_FAILURE(status)) return "is not a regular expression that can be read";
    const icu::UnicodeString input = aliasOf(content);
    const std::unique_ptr<icu::RegexMatcher> matcher(pattern->matcher(input, status));
    if (U_FAILURE(status)) return "cannot be searched for";
    const std::u16string replacement = variable.replacement.value_or(std::u16string());
    const auto pieces = ReplacementTemplate::read(replacement, *pattern, matcher->groupCount());
    if (!pieces) return "has the replacement " + quotedForReport(replacement) + ", which cannot be read";
    return visitMatchesOf(*matcher, *pieces, content, deadline, visitor);
}

}  // namespace plume

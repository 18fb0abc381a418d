#include "content/ClipboardReplacement.h"

#include <unicode/regex.h>

#include <algorithm>
#include <chrono>
#include <functional>
#include <limits>
#include <memory>
#include <optional>
#include <string_view>
#include <variant>
#include <vector>

#include "Foundation/Strings.h"
#include "content/AttributedStringRewriter.h"
#include "content/ReportOnce.h"

namespace plume {
namespace {

using Clock = std::chrono::steady_clock;
using MatchingOption = SnippetClipboardVariable::MatchingOption;

constexpr auto TimeLimit = std::chrono::milliseconds(100);
constexpr std::int32_t MatcherStackBytes = 8 * 1024 * 1024;
constexpr std::size_t LongestPattern = std::size_t{16} * 1024;
// What replacing may let a text grow to, in UTF-16 units.
constexpr std::size_t LongestResult = std::size_t{16} * 1024 * 1024;

// Called for every replacement, from left to right; false stops.
using Visitor = std::function<bool(Range, const std::u16string&)>;

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
            if (text.size() > LongestResult) break;
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

bool usesPattern(const SnippetClipboardVariable& variable) {
    return variable.regularExpressions || variable.matchingOption != MatchingOption::Anywhere;
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

// The matches of a pattern in a text, one after the other.
class PatternReplacement {
  public:
    PatternReplacement(const SnippetClipboardVariable& variable, std::u16string_view content,
                       Clock::time_point deadline)
        : variable_(variable), content_(content), deadline_(deadline) {}

    // What is wrong, in words that follow the find text; empty when all matches were visited.
    std::string visit(const Visitor& visitor) {
        const std::u16string text = patternOf(variable_);
        if (text.size() > LongestPattern) return "is too long to search for";
        UErrorCode status = U_ZERO_ERROR;
        const std::uint32_t flags = variable_.matchCase ? 0 : UREGEX_CASE_INSENSITIVE;
        UParseError problem;
        const std::unique_ptr<icu::RegexPattern> pattern(
            icu::RegexPattern::compile(aliasOf(text), flags, problem, status));
        if (U_FAILURE(status)) return "is not a regular expression that can be read";
        const icu::UnicodeString input = aliasOf(content_);
        const std::unique_ptr<icu::RegexMatcher> matcher(pattern->matcher(input, status));
        if (U_FAILURE(status)) return "cannot be searched for";
        const std::u16string replacement = variable_.replacement.value_or(std::u16string());
        const auto pieces = ReplacementTemplate::read(replacement, *pattern, matcher->groupCount());
        if (!pieces) return "has the replacement " + quotedForReport(replacement) + ", which cannot be read";
        return visitMatches(*matcher, *pieces, visitor);
    }

  private:
    std::string visitMatches(icu::RegexMatcher& matcher, const ReplacementTemplate& pieces, const Visitor& visitor) {
        UErrorCode status = U_ZERO_ERROR;
        matcher.setStackLimit(MatcherStackBytes, status);
        matcher.setMatchCallback(matchInTime, &deadline_, status);
        matcher.setFindProgressCallback(findInTime, &deadline_, status);
        while (matcher.find(status)) {
            const auto start = static_cast<std::size_t>(matcher.start(status));
            const auto end = static_cast<std::size_t>(matcher.end(status));
            if (!inTime(&deadline_)) return "takes too much time or memory to search for";
            if (!visitor({start, end - start}, pieces.expand(matcher, content_))) return "makes the text too long";
        }
        return U_FAILURE(status) ? "takes too much time or memory to search for" : "";
    }

    const SnippetClipboardVariable& variable_;
    std::u16string_view content_;
    const Clock::time_point deadline_;
};

// The occurrences of a literal text, one after the other, in time linear in both texts: the content is anybody's.
class LiteralReplacement {
  public:
    LiteralReplacement(const SnippetClipboardVariable& variable, std::u16string_view content)
        : find_(comparable(*variable.find, variable)),
          content_(comparable(content, variable)),
          replacement_(variable.replacement.value_or(std::u16string())) {}

    // As PatternReplacement::visit.
    std::string visit(const Visitor& visitor) {
        const std::vector<std::size_t> fallback = fallbackLengths();
        std::size_t matched = 0;
        for (std::size_t i = 0; i < content_.size(); ++i) {
            while (matched > 0 && content_[i] != find_[matched]) matched = fallback[matched - 1];
            if (content_[i] == find_[matched]) ++matched;
            if (matched < find_.size()) continue;
            if (!visitor({i + 1 - matched, matched}, replacement_)) return "makes the text too long";
            matched = 0;
        }
        return "";
    }

  private:
    static std::u16string comparable(std::u16string_view text, const SnippetClipboardVariable& variable) {
        return variable.matchCase ? std::u16string(text) : folded(text);
    }

    // For each length of the find text's start: how much of it is also its end, so that a search that fails there goes
    // on from here.
    std::vector<std::size_t> fallbackLengths() const {
        std::vector<std::size_t> lengths(find_.size(), 0);
        for (std::size_t i = 1; i < find_.size(); ++i) {
            std::size_t length = lengths[i - 1];
            while (length > 0 && find_[i] != find_[length]) length = lengths[length - 1];
            lengths[i] = find_[i] == find_[length] ? length + 1 : 0;
        }
        return lengths;
    }

    std::u16string find_;
    std::u16string content_;
    std::u16string replacement_;
};

// As PatternReplacement::visit.
std::string visitPattern(const SnippetClipboardVariable& variable, std::u16string_view content,
                         std::chrono::nanoseconds& timeLeft, const Visitor& visitor) {
    if (timeLeft <= std::chrono::nanoseconds::zero())
        return "is not searched for, because others have taken too much time";
    const Clock::time_point start = Clock::now();
    const Clock::time_point deadline = start + std::min<Clock::duration>(TimeLimit, timeLeft);
    std::string problem = PatternReplacement(variable, content, deadline).visit(visitor);
    timeLeft -= Clock::now() - start;
    return problem;
}

// Calls the visitor for every replacement to make. False, with the reason reported, when the content is to stay.
bool visitReplacements(const SnippetClipboardVariable& variable, std::u16string_view content,
                       const ContentEnvironment& environment, std::chrono::nanoseconds& timeLeft,
                       const Visitor& visitor) {
    if (!variable.find || variable.find->empty()) return false;
    if (content.size() > std::numeric_limits<std::int32_t>::max()) return false;
    const std::string problem = usesPattern(variable) ? visitPattern(variable, content, timeLeft, visitor)
                                                      : LiteralReplacement(variable, content).visit(visitor);
    if (problem.empty()) return true;
    reportOnce(environment, "The clipboard is inserted unchanged: the find text " + quotedForReport(*variable.find) +
                                " of its placeholder " + problem + ".");
    return false;
}

// Text that takes the place of an attached file does not show that file.
SharedAttributes forText(const SharedAttributes& attributes) {
    if (!attributes || !attributes->attachment) return attributes;
    TextAttributes rest = *attributes;
    rest.attachment = nullptr;
    return std::make_shared<const TextAttributes>(std::move(rest));
}

}  // namespace

std::u16string processClipboardVariable(const SnippetClipboardVariable& variable, const std::u16string& content,
                                        const ContentEnvironment& environment, std::chrono::nanoseconds& timeLeft) {
    std::u16string result;
    std::size_t copied = 0;
    const auto replace = [&](Range range, const std::u16string& replacement) {
        result.append(content, copied, range.location - copied);
        result += replacement;
        copied = range.end();
        return result.size() <= std::max(LongestResult, content.size());
    };
    if (!visitReplacements(variable, content, environment, timeLeft, replace)) return content;
    result.append(content, copied);
    return result;
}

AttributedString processClipboardVariable(const SnippetClipboardVariable& variable, const AttributedString& content,
                                          const ContentEnvironment& environment, std::chrono::nanoseconds& timeLeft) {
    AttributedStringRewriter rewriter(content);
    const auto replace = [&](Range range, const std::u16string& replacement) {
        rewriter.copyTo(range.location);
        rewriter.append(replacement, forText(range.length > 0 ? rewriter.attributes() : rewriter.attributesBefore()));
        rewriter.skipTo(range.end());
        return rewriter.resultLength() <= std::max(LongestResult, content.length());
    };
    return visitReplacements(variable, content.string(), environment, timeLeft, replace) ? rewriter.finish() : content;
}

}  // namespace plume

#include "content/ClipboardReplacement.h"

#include <algorithm>
#include <limits>
#include <memory>
#include <string_view>
#include <vector>

#include "Foundation/Strings.h"
#include "content/ContentRewriter.h"
#include "content/PatternReplacement.h"

namespace plume {
namespace {

using Clock = std::chrono::steady_clock;

// For one placeholder.
constexpr auto TimeLimit = std::chrono::milliseconds(100);

// The occurrences of a literal text, one after the other, in time linear in both texts: the content is anybody's.
class LiteralReplacement {
  public:
    LiteralReplacement(const SnippetClipboardVariable& variable, std::u16string_view content)
        : find_(comparable(*variable.find, variable)),
          content_(comparable(content, variable)),
          replacement_(variable.replacement.value_or(std::u16string())) {}

    // As visitMatches.
    std::string visit(const ReplacementVisitor& visitor) {
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

// As visitMatches.
std::string visitPattern(const SnippetClipboardVariable& variable, std::u16string_view content,
                         std::chrono::nanoseconds& timeLeft, const ReplacementVisitor& visitor) {
    if (timeLeft <= std::chrono::nanoseconds::zero())
        return "is not searched for, because others have taken too much time";
    const Clock::time_point start = Clock::now();
    const Clock::time_point deadline = start + std::min<Clock::duration>(TimeLimit, timeLeft);
    std::string problem = visitMatches(variable, content, deadline, visitor);
    timeLeft -= Clock::now() - start;
    return problem;
}

// Calls the visitor for every replacement to make. False, with the reason reported, when the content is to stay.
bool visitReplacements(const SnippetClipboardVariable& variable, std::u16string_view content,
                       const ContentEnvironment& environment, std::chrono::nanoseconds& timeLeft,
                       const ReplacementVisitor& visitor) {
    if (!variable.find || variable.find->empty()) return false;
    if (content.size() > std::numeric_limits<std::int32_t>::max()) return false;
    const std::string problem = usesPattern(variable) ? visitPattern(variable, content, timeLeft, visitor)
                                                      : LiteralReplacement(variable, content).visit(visitor);
    if (problem.empty()) return true;
    environment.reportOnce("The clipboard is inserted unchanged: the find text " + quotedForReport(*variable.find) +
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
        return result.size() <= std::max(LongestReplacementResult, content.size());
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
        return rewriter.resultLength() <= std::max(LongestReplacementResult, content.length());
    };
    return visitReplacements(variable, content.string(), environment, timeLeft, replace) ? rewriter.finish() : content;
}

}  // namespace plume

#include "import/TextExpanderMacros.h"

#include <algorithm>
#include <array>
#include <map>
#include <optional>
#include <utility>

#include "Foundation/Strings.h"
#include "content/ContentRewriter.h"
#include "content/OldSyntax.h"
#include "content/PlaceholderBody.h"
#include "content/SnippetKeyVariable.h"
#include "import/TextExpanderDates.h"
#include "import/TextExpanderFields.h"

namespace plume {

namespace {

using View = std::u16string_view;
using Text = std::u16string;

constexpr char16_t Percent = u'%';
constexpr View PartEnd = u"%fillpartend%";

// A unit for private use that the text does not have: it stands for percent signs that are text, so that they do not
// start a placeholder of the old syntax. The percent sign itself in the odd text that has them all.
char16_t standInFor(View text) {
    constexpr char16_t First = 0xE000;
    constexpr std::size_t Count = 0x1900;
    std::array<bool, Count> used{};
    for (const char16_t unit : text) {
        if (unit >= First && unit < First + Count) used[static_cast<std::size_t>(unit - First)] = true;
    }
    const auto free = std::find(used.begin(), used.end(), false);
    return free == used.end() ? Percent : static_cast<char16_t>(First + (free - used.begin()));
}

std::string shortened(View name) {
    constexpr std::size_t Most = 40;
    return toUtf8(name.substr(0, Most));
}

void replaceUnit(Snippet& snippet, char16_t unit, View replacement) {
    const AttributedString source = *snippet.richTextContent();
    const View text = source.string();
    if (text.find(unit) == View::npos) return;
    AttributedStringRewriter rewriter(source);
    for (std::size_t at = text.find(unit); at != View::npos; at = text.find(unit, at + 1)) {
        rewriter.copyTo(at);
        rewriter.append(replacement, rewriter.attributes());
        rewriter.skipTo(at + 1);
    }
    snippet.setRichTextContent(rewriter.finish());
}

class MacroRewriting {
  public:
    MacroRewriting(const AttributedString& source, bool isScript)
        : text_(source.string()),
          isPlain_(source.runs().size() <= 1),
          isScript_(isScript),
          standIn_(standInFor(text_)),
          rewriter_(source) {}

    AttributedString rewritten() {
        for (std::size_t at = text_.find(Percent); at != View::npos; at = text_.find(Percent, at)) {
            const std::size_t length = rewriteAt(at);
            at += std::max<std::size_t>(length, 1);
        }
        return rewriter_.finish();
    }

    char16_t standIn() const { return standIn_; }
    std::vector<std::string> takeLosses() { return std::move(losses_); }

  private:
    // The length of what starts here; 0 when it is text.
    std::size_t rewriteAt(std::size_t at) {
        const View text = text_.substr(at);
        if (const std::size_t length = rewriteNamed(text, at)) return length;
        if (isScript_) return put(at, 1, Text(1, standIn_));
        if (text.starts_with(u"%%")) return put(at, 2, Text(1, standIn_));
        if (text.starts_with(u"%\\")) {
            lose("the selection up to %\\ is left out");
            return put(at, 2, {});
        }
        if (const std::size_t length = dates_.takeShift(text)) return put(at, length, {});
        const TextExpanderDates::Codes codes = dates_.codesIn(text, isPlain_);
        if (codes.length == 0) return 0;
        return putBody(at, codes.length, codes.body);
    }

    // A macro that is a word, or words between percent signs.
    std::size_t rewriteNamed(View text, std::size_t at) {
        if (text.starts_with(u"%clipboard")) return View(u"%clipboard").size();
        if (text.starts_with(u"%pasteboard")) return putBody(at, View(u"%pasteboard").size(), u"clipboard");
        const View word = wordOf(text);
        if (word.empty()) return 0;
        const std::size_t end = text.find(Percent, word.size() + 1);
        // Without its end it is text, and no code of a date either.
        if (end == View::npos) return word.size() + 1;
        const View macro = text.substr(1, end - 1);
        const std::size_t length = end + 1;
        if (macro == u"filltop" || macro == u"fillpartend") return put(at, length, {});
        if (macro.size() == word.size()) return 0;
        return rewriteMacro(macro, word, at, length);
    }

    std::size_t rewriteMacro(View macro, View word, std::size_t at, std::size_t length) {
        if (const auto part = partFromTextExpander(macro)) return rewritePart(*part, at, length);
        if (const auto body = fieldFromTextExpander(macro)) return putBody(at, length, *body);
        const View parameter = macro.substr(word.size() + 1);
        if (word == u"date") return putBody(at, length, dates_.dateBody(parameter));
        if (word == u"time") return putBody(at, length, dates_.timeBody(parameter));
        if (word == u"snippet" || word == u"field" || word == u"fill") return length;
        if (word == u"key" && !isScript_) return rewriteKey(parameter, at, length);
        if (word.size() < ShortestUnknown || macro.find(u'\n') != View::npos) return 0;
        lose("the macro %" + toUtf8(word) + ": is not known and stays as text");
        return put(at, length, Text(text_.substr(at, length)));
    }

    // Letters between a percent sign and a colon or percent sign.
    static View wordOf(View text) {
        constexpr View Letters = u"abcdefghijklmnopqrstuvwxyz";
        const std::size_t end = text.substr(0, LongestWord + 2).find_first_not_of(Letters, 1);
        if (end == View::npos || end == 1 || (text[end] != u':' && text[end] != Percent)) return {};
        return text.substr(1, end - 1);
    }

    std::size_t rewriteKey(View name, std::size_t at, std::size_t length) {
        const Text key = lowercased(name);
        if (key == u"enter" || key == u"tab" || key == u"esc") return put(at, length, u"%key:" + key + u"%", true);
        if (key == u"return") return put(at, length, u"%key:enter%", true);
        if (key == u"space") return put(at, length, u" ");
        lose("the key " + shortened(name) + " is not known and stays as text");
        return put(at, length, Text(text_.substr(at, length)));
    }

    // What can be left out becomes a field with this text, when it is no more than text.
    std::size_t rewritePart(TextExpanderPart part, std::size_t at, std::size_t length) {
        const std::size_t start = at + length;
        const std::size_t end = partEndBehind(start);
        const std::string name = shortened(part.name);
        if (end == View::npos) {
            lose("the optional part " + name + " has no end and is always written");
            return put(at, length, {});
        }
        const View content = text_.substr(start, end - start);
        if (content.find_first_of(u"%\u3010\u3011") != View::npos) {
            lose("the optional part " + name + " holds macros and is always written");
            return put(at, length, {});
        }
        if (!isPlain_) lose("the optional part " + name + " has one look throughout");
        part.name = unusedName(part.name);
        return putBody(at, length + content.size() + PartEnd.size(), bodyOfPart(part, content));
    }

    std::size_t partEndBehind(std::size_t start) {
        if (partEnd_ != View::npos && partEnd_ < start) partEnd_ = text_.find(PartEnd, start);
        return partEnd_;
    }

    // Fields of one name share what they hold, so every part needs its own.
    Text unusedName(const Text& name) {
        std::size_t& number = partNames_[name];
        if (++number == 1) return name;
        return name + u" " + fromUtf8(std::to_string(number));
    }

    std::size_t putBody(std::size_t at, std::size_t length, Text body) {
        if (dates_.hasTimeShift() && body.starts_with(u"date:")) {
            lose("a date does not go on to the next day when hours are added");
        }
        // There is no way to write the markers within a body.
        std::replace(body.begin(), body.end(), OpeningMarker, u'[');
        std::replace(body.begin(), body.end(), ClosingMarker, u']');
        return put(at, length, OpeningMarker + body + ClosingMarker);
    }

    // `isMacro`: the percent signs of the replacement start placeholders.
    std::size_t put(std::size_t at, std::size_t length, Text replacement, bool isMacro = false) {
        if (!isMacro) std::replace(replacement.begin(), replacement.end(), Percent, standIn_);
        rewriter_.copyTo(at);
        rewriter_.append(replacement, rewriter_.attributes());
        rewriter_.skipTo(at + length);
        return length;
    }

    // Each loss once.
    void lose(std::string what) {
        constexpr std::size_t Most = 20;
        if (losses_.size() < Most && std::find(losses_.begin(), losses_.end(), what) == losses_.end()) {
            losses_.push_back(std::move(what));
        }
    }

    static constexpr std::size_t ShortestUnknown = 4;
    static constexpr std::size_t LongestWord = 20;

    View text_;
    bool isPlain_;
    bool isScript_;
    char16_t standIn_;
    AttributedStringRewriter rewriter_;
    TextExpanderDates dates_;
    std::size_t partEnd_ = 0;                // the next one, as far as it was looked for; npos: there is none
    std::map<Text, std::size_t> partNames_;  // how often each was met
    std::vector<std::string> losses_;
};

}  // namespace

std::vector<std::string> convertTextExpanderMacros(Snippet& snippet) {
    if (!snippet.hasContent()) return {};
    const AttributedString source = *snippet.richTextContent();
    if (source.string().find(Percent) == View::npos) return {};
    MacroRewriting rewriting(source, snippet.isScript());
    snippet.setRichTextContent(rewriting.rewritten());
    convertOldSnippet(snippet);
    replaceUnit(snippet, rewriting.standIn(), View(&Percent, 1));
    return rewriting.takeLosses();
}

bool holdsTextExpanderMacros(View text) {
    constexpr std::array<View, 6> Signs = {u"%fill", u"%clipboard", u"%snippet:", u"%key:", u"%@+", u"%@-"};
    for (std::size_t at = text.find(Percent); at != View::npos; at = text.find(Percent, at + 1)) {
        const View behind = text.substr(at);
        if (std::any_of(Signs.begin(), Signs.end(), [&](View sign) { return behind.starts_with(sign); })) return true;
    }
    return false;
}

}  // namespace plume

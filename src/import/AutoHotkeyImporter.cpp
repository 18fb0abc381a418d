// Hotstrings of AutoHotkey scripts: "::btw::by the way".
#include <algorithm>
#include <optional>
#include <utility>

#include "Foundation/Strings.h"
#include "import/AutoHotkeyOptions.h"
#include "import/ForeignFile.h"
#include "import/Remarks.h"
#include "import/TextFile.h"
#include "import/TextLines.h"

namespace plume {

namespace {

using View = std::u16string_view;

struct Hotstring {
    AutoHotkeyOptions options;
    View abbreviation;
    std::u16string content;
};

View withoutIndent(View line) {
    return line.substr(std::min(line.find_first_not_of(u" \t\u00A0\u3000"), line.size()));
}

bool isBlank(char16_t unit) {
    return unit == u' ' || unit == u'\t';
}

View withoutBlanksBehind(View text) {
    while (!text.empty() && isBlank(text.back())) text.remove_suffix(1);
    return text;
}

// A semicolon behind a blank starts a comment.
View withoutComment(View content) {
    for (std::size_t at = content.find(u';'); at != View::npos; at = content.find(u';', at + 1)) {
        if (at > 0 && isBlank(content[at - 1])) return withoutBlanksBehind(content.substr(0, at));
    }
    return content;
}

std::optional<Hotstring> hotstringIn(View line) {
    constexpr std::size_t LongestOptions = 40;
    if (line.size() >= 2 && line.starts_with(u'"') && line.ends_with(u'"')) line = line.substr(1, line.size() - 2);
    if (!line.starts_with(u':')) return std::nullopt;
    const std::size_t second = line.substr(0, LongestOptions + 2).find(u':', 1);
    if (second == View::npos) return std::nullopt;
    const std::size_t end = line.find(u"::", second + 2);
    if (end == View::npos) return std::nullopt;
    auto options = autoHotkeyOptions(line.substr(1, second - 1));
    if (!options) return std::nullopt;
    return Hotstring{std::move(*options), line.substr(second + 1, end - second - 1),
                     std::u16string(withoutComment(line.substr(end + 2)))};
}

bool hasKeyInBraces(View content) {
    const std::size_t open = content.find(u'{');
    return open != View::npos && content.find(u'}', open) != View::npos;
}

class AutoHotkeyReading {
  public:
    explicit AutoHotkeyReading(View text) : lines_(text) {}

    Result<ImportedLibrary> read(const ForeignFile& file) {
        while (const auto line = lines_.next()) readLine(withoutIndent(*line));
        if (snippets_.empty())
            return file.fault("no hotstring with a replacement is in it; expected ::btw::by the way");
        tellOfRest();
        auto group = SnippetGroup::make();
        group->setName(file.title());
        group->setExpandTrigger(ExpandTrigger::DelimiterKept);
        group->addItems(snippets_);
        return ImportedLibrary{{std::move(group)}, remarks_.take()};
    }

  private:
    void readLine(View line) {
        if (line.empty() || line.starts_with(u';')) return;
        if (line.starts_with(u"/*")) return skipComment(line);
        auto hotstring = hotstringIn(line);
        if (!hotstring) return leaveOut(line);
        const std::size_t number = lines_.number();
        readContinuation(hotstring->content);
        add(std::move(*hotstring), number);
    }

    // Up to the line that starts or ends with its end; without one all of the rest.
    void skipComment(View line) {
        std::optional<View> inner = line.substr(2);
        for (; inner; inner = lines_.next()) {
            const View text = withoutIndent(*inner);
            if (text.starts_with(u"*/") || withoutBlanksBehind(text).ends_with(u"*/")) return;
            if (hotstringIn(text)) ++commented_;
        }
    }

    // Lines between one that starts with "(" and one that starts with ")" belong to the line before them.
    void readContinuation(std::u16string& content) {
        const auto start = lines_.peek();
        if (!start) return;
        const View opening = withoutIndent(*start);
        if (!opening.starts_with(u'(') || opening.find(u')') != View::npos) return;
        lines_.next();
        const bool trims = containsIgnoringCase(opening, u"LTrim") && !containsIgnoringCase(opening, u"LTrim0");
        bool isFirst = true;
        while (const auto line = lines_.next()) {
            if (withoutIndent(*line).starts_with(u')')) return;
            if (!isFirst) content += u'\n';
            isFirst = false;
            content += withoutBlanksBehind(trims ? withoutIndent(*line) : *line);
        }
    }

    void leaveOut(View line) {
        if (line.starts_with(u"#")) {
            const bool limits = findIgnoringCase(line, u"#if") == 0 || findIgnoringCase(line, u"#hotif") == 0;
            if (limits) tell("the condition behind #If is left out; its hotstrings hold everywhere");
            if (findIgnoringCase(line, u"#hotstring") == 0) tell("the options of #Hotstring are left out");
        } else if (line.starts_with(u':')) {
            tell("this is no hotstring that can be read; expected ::btw::by the way");
        } else {
            ++codeLines_;
        }
    }

    void tell(const std::string& what) { remarks_.add("line " + std::to_string(lines_.number()) + ": " + what); }

    void add(Hotstring hotstring, std::size_t number) {
        if (hotstring.content.empty()) {
            ++withoutReplacement_;
            return;
        }
        if (snippets_.size() == MostImportedSnippets) {
            ++tooMany_;
            return;
        }
        auto snippet = std::make_shared<Snippet>(std::u16string(hotstring.abbreviation), hotstring.content);
        snippet->setCaseSensitivity(hotstring.options.caseSensitivity);
        remarkOn(*snippet, hotstring, number);
        snippets_.push_back(std::move(snippet));
    }

    void remarkOn(const Snippet& snippet, const Hotstring& hotstring, std::size_t number) {
        std::vector<std::string> lost = hotstring.options.lost;
        if (hotstring.options.isCommand) lost.emplace_back("its command is taken as text");
        if (!hotstring.options.isRaw && hasKeyInBraces(hotstring.content)) {
            lost.emplace_back("keys in braces are taken as text");
        }
        if (hotstring.content.find(u'`') != View::npos) lost.emplace_back("escapes with ` are taken as text");
        remarks_.addAll(snippet, lost, number);
    }

    void tellOfRest() {
        remarks_.addCount(withoutReplacement_, "hotstring without a replacement is left out",
                          "hotstrings without a replacement are left out");
        remarks_.addCount(commented_, "hotstring inside /* */ is left out", "hotstrings inside /* */ are left out");
        remarks_.addCount(codeLines_, "line of other code is left out", "lines of other code are left out");
        remarks_.addTooMany(tooMany_);
    }

    TextLines lines_;
    std::vector<std::shared_ptr<Snippet>> snippets_;
    Remarks remarks_;
    std::size_t withoutReplacement_ = 0;
    std::size_t commented_ = 0;
    std::size_t codeLines_ = 0;
    std::size_t tooMany_ = 0;
};

}  // namespace

Result<ImportedLibrary> importAutoHotkey(const ForeignFile& file) {
    const Result<std::u16string> text = textOfFile(file.bytes, CodePage::Windows1252);
    if (!text) return file.fault(text.error().message);
    return AutoHotkeyReading(text.value()).read(file);
}

}  // namespace plume

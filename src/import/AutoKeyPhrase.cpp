#include "import/AutoKeyPhrase.h"

#include <algorithm>
#include <array>
#include <utility>

#include "Foundation/CharacterSet.h"
#include "Foundation/KeyModifiers.h"
#include "Foundation/Strings.h"
#include "import/ForeignPlaceholders.h"
#include "import/ShellText.h"

namespace plume {

namespace {

constexpr std::size_t LongestTag = 2000;

struct NamedModifier {
    std::u16string_view name;
    EventFlag flag;
};

constexpr std::array<NamedModifier, 6> Modifiers = {{{u"ctrl", EventFlag::Control},
                                                     {u"alt", EventFlag::Option},
                                                     {u"shift", EventFlag::Shift},
                                                     {u"super", EventFlag::Command},
                                                     {u"meta", EventFlag::Command},
                                                     {u"hyper", EventFlag::Command}}};

const NamedModifier* modifierNamed(std::u16string_view name) {
    const auto found = std::find_if(Modifiers.begin(), Modifiers.end(), [&](const auto& m) { return m.name == name; });
    return found == Modifiers.end() ? nullptr : &*found;
}

// What is between "<" at the start of the text and the next ">"; empty when there is none nearby.
std::u16string_view tagAt(std::u16string_view text) {
    const std::size_t close = text.substr(0, LongestTag).find(u'>');
    if (!text.starts_with(u'<') || close == std::u16string_view::npos) return {};
    return text.substr(1, close - 1);
}

// The value of "name=" in a macro, which goes up to the end or to the next such name.
std::u16string_view argumentOf(std::u16string_view tag, std::u16string_view name) {
    const std::u16string start = u" " + std::u16string(name) + u"=";
    const std::size_t at = tag.find(start);
    if (at == std::u16string_view::npos) return {};
    const std::u16string_view value = tag.substr(at + start.size());
    return trimmed(value.substr(0, value.find(u" args=")));
}

class PhraseReader {
  public:
    PhraseReader(std::u16string_view phrase, const std::u16string& name, ScriptShelf& scripts,
                 std::vector<std::string>& problems)
        : rest_(phrase), name_(name), scripts_(scripts), problems_(problems) {}

    std::u16string read() {
        if (holdsMarker(rest_)) problem("its text holds \xe3\x80\x90, with which Plume's placeholders begin");
        while (!rest_.empty()) {
            const std::size_t open = std::min(rest_.find(u'<'), rest_.size());
            result_ += rest_.substr(0, open);
            rest_.remove_prefix(open);
            if (!rest_.empty() && !takeKeys() && !takeMacro()) {
                result_ += u'<';
                rest_.remove_prefix(1);
            }
        }
        return std::move(result_);
    }

  private:
    void problem(const std::string& text) {
        if (std::find(problems_.begin(), problems_.end(), text) == problems_.end()) problems_.push_back(text);
    }

    // "<enter>", "<ctrl>+<shift>+x".
    bool takeKeys() {
        std::u16string_view rest = rest_;
        EventFlags flags;
        for (std::u16string_view tag = tagAt(rest); const NamedModifier* const modifier = modifierNamed(tag);
             tag = tagAt(rest)) {
            if (rest.substr(tag.size() + 2, 1) != u"+") return false;
            flags = flags | modifier->flag;
            rest.remove_prefix(tag.size() + 3);
        }
        const std::u16string_view tag = tagAt(rest);
        const bool isCharacter = tag.empty() && !rest.empty() && flags != EventFlags();
        if (tag.size() < 2 && !isCharacter) return false;
        const std::u16string_view key = isCharacter ? rest.substr(0, 1) : tag;
        const auto placeholder = keyPlaceholder(toUtf8(key), flags.bits(), 1);
        if (!placeholder) return false;
        result_ += *placeholder;
        rest_ = rest.substr(isCharacter ? 1 : tag.size() + 2);
        return true;
    }

    bool takeMacro() {
        const std::u16string_view tag = tagAt(rest_);
        const std::u16string_view kind = tag.substr(0, tag.find(u' '));
        if (kind == u"cursor") {
            result_ += CaretPlaceholder;
        } else if (kind == u"clipboard") {
            result_ += ClipboardPlaceholder;
        } else if (kind == u"date") {
            result_ += dateOf(argumentOf(tag, u"format"));
        } else if (kind == u"file") {
            result_ += shelved(u"cat " + quotedForShell(argumentOf(tag, u"name")) + u"\n");
        } else if (kind == u"system") {
            result_ += shelved(std::u16string(argumentOf(tag, u"command")) + u"\n");
        } else if (kind == u"script") {
            problem("it includes the script \"" + toUtf8(argumentOf(tag, u"name")) + "\", which only AutoKey can run");
        } else {
            return false;
        }
        rest_.remove_prefix(tag.size() + 2);
        return true;
    }

    std::u16string dateOf(std::u16string_view format) {
        if (format.empty()) return u"\u3010date:short\u3011";
        const auto pieces = piecesOfStrftime(format);
        const auto value = pieces ? datePlaceholders(*pieces, {}, {}) : std::nullopt;
        return value ? *value : shelved(u"date " + quotedForShell(u"+" + std::u16string(format)) + u"\n");
    }

    std::u16string shelved(const std::u16string& script) {
        return scripts_.placeholderFor(script, name_ + u" " + fromUtf8(std::to_string(++scriptCount_)));
    }

    std::u16string_view rest_;
    const std::u16string& name_;
    ScriptShelf& scripts_;
    std::vector<std::string>& problems_;
    std::u16string result_;
    int scriptCount_ = 0;
};

bool isNameUnit(char16_t unit) {
    return CharacterSet::alphanumerics().contains(unit) || unit == u'_';
}

// Whether the source uses an object of this name that it did not make itself; comments count too.
bool uses(std::u16string_view source, std::u16string_view name) {
    for (std::size_t at = source.find(name); at != std::u16string_view::npos; at = source.find(name, at + 1)) {
        const bool starts = at == 0 || (!isNameUnit(source[at - 1]) && source[at - 1] != u'.');
        if (starts && source.substr(at + name.size(), 1) == u".") return true;
    }
    return false;
}

}  // namespace

std::u16string contentOfAutoKeyPhrase(std::u16string_view phrase, const std::u16string& name, ScriptShelf& scripts,
                                      std::vector<std::string>& problems) {
    return PhraseReader(phrase, name, scripts, problems).read();
}

std::optional<std::u16string> shellScriptOfPython(std::u16string_view source) {
    for (const std::u16string_view name : {u"keyboard", u"mouse", u"clipboard", u"window", u"dialog", u"engine",
                                           u"store", u"system", u"highlevel", u"qt_helper", u"autokey"}) {
        if (uses(source, name)) return std::nullopt;
    }
    std::u16string end = u"PYTHON_ENDS";
    while (source.find(end) != std::u16string_view::npos) end += u'_';
    return u"python3 - <<'" + end + u"'\n" + std::u16string(source) + u"\n" + end + u"\n";
}

}  // namespace plume

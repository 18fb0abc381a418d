#include "app/editor/ScriptHighlighter.h"

#include <QTextDocument>
#include <algorithm>

#include "app/editor/LegibleColor.h"

namespace plume {

ScriptHighlighter::ScriptHighlighter(QTextDocument* document, const QPalette& palette) : QSyntaxHighlighter(document) {
    makeFormats(palette);
}

void ScriptHighlighter::setPalette(const QPalette& palette) {
    makeFormats(palette);
    rehighlight();
}

void ScriptHighlighter::setAppleScript(bool isAppleScript) {
    if (isAppleScript_ == isAppleScript) return;
    isAppleScript_ = isAppleScript;
    rehighlight();
}

// Who sees no colours has bold, slanted and underlined text.
void ScriptHighlighter::makeFormats(const QPalette& palette) {
    const auto format = [this](ScriptToken token) -> QTextCharFormat& {
        return formats_.at(static_cast<std::size_t>(token)) = QTextCharFormat();
    };
    QTextCharFormat& keyword = format(ScriptToken::Keyword);
    keyword.setForeground(legibleColor(TextHue::Blue, palette));
    keyword.setFontWeight(QFont::Bold);
    format(ScriptToken::String).setForeground(legibleColor(TextHue::Green, palette));
    QTextCharFormat& comment = format(ScriptToken::Comment);
    comment.setForeground(palette.color(QPalette::PlaceholderText));
    comment.setFontItalic(true);
    format(ScriptToken::Variable).setForeground(legibleColor(TextHue::Violet, palette));
    QTextCharFormat& placeholder = format(ScriptToken::Placeholder);
    placeholder.setForeground(palette.color(QPalette::Text));
    placeholder.setBackground(palette.color(QPalette::AlternateBase));
    placeholder.setUnderlineStyle(QTextCharFormat::DashUnderline);
}

void ScriptHighlighter::highlightBlock(const QString& text) {
    const std::u16string_view line(reinterpret_cast<const char16_t*>(text.utf16()),
                                   static_cast<std::size_t>(text.size()));
    found_.clear();
    setCurrentBlockState(numberOf(scanScriptLine(line, stateBefore(line), found_)));
    for (const ScriptStretch& stretch : found_) {
        const auto& range = stretch.range;
        if (range.location >= MaximumColoured) continue;
        const std::size_t end = std::min(range.end(), MaximumColoured);
        setFormat(static_cast<int>(range.location), static_cast<int>(end - range.location), formatOf(stretch.token));
    }
}

// The language is part of the state: another first line has all other lines looked at again.
ScriptState ScriptHighlighter::stateBefore(std::u16string_view line) {
    if (const int previous = previousBlockState(); previous >= 0) return states_[static_cast<std::size_t>(previous)];
    language_ = isAppleScript_ ? ScriptLanguage::AppleScript : languageOfScript(line);
    return {.language = language_};
}

int ScriptHighlighter::numberOf(const ScriptState& state) {
    const auto [known, isNew] = numbers_.try_emplace(state, static_cast<int>(states_.size()));
    if (isNew) states_.push_back(state);
    return known->second;
}

}  // namespace plume

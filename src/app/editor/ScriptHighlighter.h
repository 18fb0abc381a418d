// The colours of a script: keywords, texts, comments, variables, and placeholders, which expansions replace.
//
// On the main thread; the document owns it.
#pragma once

#include <QPalette>
#include <QSyntaxHighlighter>
#include <QTextCharFormat>
#include <array>
#include <map>
#include <vector>

#include "app/editing/ScriptSyntax.h"

namespace plume {

class ScriptHighlighter final : public QSyntaxHighlighter {
    Q_OBJECT
  public:
    // Lines are not coloured beyond this, which lays out a text of one long line without delay.
    static constexpr std::size_t MaximumColoured = 2'000;  // UTF-16 units

    ScriptHighlighter(QTextDocument* document, const QPalette& palette);

    void setPalette(const QPalette& palette);
    // Otherwise the script's first line says what it is.
    void setAppleScript(bool isAppleScript);
    ScriptLanguage language() const { return language_; }
    // What tells stretches of this kind from other text.
    const QTextCharFormat& formatOf(ScriptToken token) const { return formats_.at(static_cast<std::size_t>(token)); }

  protected:
    void highlightBlock(const QString& text) override;

  private:
    void makeFormats(const QPalette& palette);
    ScriptState stateBefore(std::u16string_view line);
    // A block keeps one number of its state.
    int numberOf(const ScriptState& state);

    bool isAppleScript_ = false;
    ScriptLanguage language_ = ScriptLanguage::Shell;
    std::array<QTextCharFormat, 5> formats_;
    std::map<ScriptState, int> numbers_;
    std::vector<ScriptState> states_;
    std::vector<ScriptStretch> found_;  // of one line
};

}  // namespace plume

#include "app/editor/ScriptEdit.h"

#include <QFontDatabase>
#include <QKeyEvent>
#include <QMimeData>
#include <QScrollBar>
#include <QTextBlock>
#include <algorithm>
#include <memory>
#include <utility>

#include "app/editor/BracketPair.h"
#include "app/editor/LineNumbers.h"
#include "app/editor/ScriptHighlighter.h"
#include "app/qt/RawText.h"
#include "app/qt/Text.h"

namespace plume {

namespace {

constexpr int TabWidth = 4;           // blanks
constexpr float BracketTint = 0.35F;  // of the colour that marks what is selected

// As the document has it: one kind of line break.
QString withPlainBreaks(QString text) {
    text.replace(QStringLiteral("\r\n"), QStringLiteral("\n"));
    text.replace(QLatin1Char('\r'), QLatin1Char('\n'));
    return text.replace(QChar::ParagraphSeparator, QLatin1Char('\n'));
}

bool isUndoKey(const QKeyEvent& event) {
    return event.matches(QKeySequence::Undo) || event.matches(QKeySequence::Redo);
}

bool isModifierKey(int key) {
    return key == Qt::Key_Shift || key == Qt::Key_Control || key == Qt::Key_Alt || key == Qt::Key_Meta;
}

// How much two texts have in common at their beginnings and ends.
std::pair<qsizetype, qsizetype> commonEnds(const QString& one, const QString& other) {
    const qsizetype longest = std::min(one.size(), other.size());
    const auto differs = std::mismatch(one.cbegin(), one.cbegin() + longest, other.cbegin());
    qsizetype before = differs.first - one.cbegin();
    if (before > 0 && one[before - 1].isHighSurrogate()) --before;
    qsizetype behind = 0;
    while (behind < longest - before && one[one.size() - behind - 1] == other[other.size() - behind - 1]) ++behind;
    if (behind > 0 && one[one.size() - behind].isLowSurrogate()) --behind;
    return {before, behind};
}

}  // namespace

ScriptEdit::ScriptEdit()
    : lineNumbers_(new LineNumbers(*this)), highlighter_(new ScriptHighlighter(document(), palette())) {
    setUndoRedoEnabled(false);
    setLineWrapMode(NoWrap);
    // Programs run from left to right in every language.
    setLayoutDirection(Qt::LeftToRight);
    setFont(QFontDatabase::systemFont(QFontDatabase::FixedFont));
    setAccessibleName(tr("Script"));
    setAccessibleDescription(help());
    setWhatsThis(help());
    connect(this, &QPlainTextEdit::textChanged, this, &ScriptEdit::noteChange);
    connect(this, &QPlainTextEdit::cursorPositionChanged, this, &ScriptEdit::showBrackets);
    connect(this, &QPlainTextEdit::cursorPositionChanged, lineNumbers_, qOverload<>(&QWidget::update));
    connect(this, &QPlainTextEdit::blockCountChanged, this, &ScriptEdit::placeLineNumbers);
    connect(this, &QPlainTextEdit::updateRequest, lineNumbers_, qOverload<>(&QWidget::update));
    placeLineNumbers();
}

QString ScriptEdit::help() {
    return tr("Tab writes a tab. To leave the script with the keyboard, press Ctrl+Tab, or Escape and then Tab.");
}

// ---- The text ----

void ScriptEdit::setContent(const AttributedString& content) {
    original_ = content;
    isChanged_ = false;
    const QString text = withPlainBreaks(toQString(content.string()));
    const QString shown = rawText(*document());
    if (text == shown) return;
    const auto [before, behind] = commonEnds(shown, text);
    const bool isSame = 2 * (before + behind) >= std::max(shown.size(), text.size());
    const int caret = textCursor().position();
    isSetting_ = true;
    QTextCursor change(document());
    change.setPosition(static_cast<int>(before));
    change.setPosition(static_cast<int>(shown.size() - behind), QTextCursor::KeepAnchor);
    change.insertText(text.mid(before, text.size() - before - behind));
    isSetting_ = false;
    QTextCursor own = textCursor();
    if (!isSame) {
        own.setPosition(0);
    } else if (caret <= shown.size() - behind) {
        own.setPosition(static_cast<int>(std::min<qsizetype>(caret, text.size() - behind)));
    }
    setTextCursor(own);
}

AttributedString ScriptEdit::content() const {
    return isChanged_ ? AttributedString(fromQString(rawText(*document()))) : original_;
}

void ScriptEdit::setAppleScript(bool isAppleScript) {
    highlighter_->setAppleScript(isAppleScript);
}

void ScriptEdit::insertPlaceholder(const std::u16string& body) {
    textCursor().insertText(toQString(u"【" + body + u"】"));
    ensureCursorVisible();
}

// Qt tells of colours and fonts in the same way.
void ScriptEdit::noteChange() {
    QString text = document()->toRawText();
    if (text == told_) return;
    told_ = std::move(text);
    if (isSetting_) return;
    isChanged_ = true;
    Q_EMIT edited();
}

// ---- Keys ----

bool ScriptEdit::event(QEvent* event) {
    if (event->type() == QEvent::ShortcutOverride && isUndoKey(static_cast<const QKeyEvent&>(*event))) {
        event->ignore();
        return false;
    }
    return QPlainTextEdit::event(event);
}

void ScriptEdit::keyPressEvent(QKeyEvent* event) {
    const int key = event->key();
    if (isUndoKey(*event)) return event->ignore();
    if (isModifierKey(key)) return QPlainTextEdit::keyPressEvent(event);
    const bool followsEscape = std::exchange(leavesWithTab_, key == Qt::Key_Escape);
    const bool hasControl = event->modifiers().testFlag(Qt::ControlModifier);
    if (key == Qt::Key_Tab || key == Qt::Key_Backtab) {
        const bool isForward = key == Qt::Key_Tab && !event->modifiers().testFlag(Qt::ShiftModifier);
        if (!followsEscape && !hasControl && !isReadOnly()) return takeTab(isForward);
        // The text's own does nothing where Tab writes a tab.
        QAbstractScrollArea::focusNextPrevChild(isForward);  // NOLINT(bugprone-parent-virtual-call)
    } else if ((key == Qt::Key_Return || key == Qt::Key_Enter) && !hasControl && !isReadOnly()) {
        breakLine();
    } else {
        QPlainTextEdit::keyPressEvent(event);
    }
}

void ScriptEdit::focusOutEvent(QFocusEvent* event) {
    leavesWithTab_ = false;
    QPlainTextEdit::focusOutEvent(event);
}

void ScriptEdit::takeTab(bool isForward) {
    const bool hasLines = textCursor().selectedText().contains(QChar::ParagraphSeparator);
    if (hasLines || !isForward) return shiftLines(isForward);
    textCursor().insertText(QStringLiteral("\t"));
    ensureCursorVisible();
}

// Those that are selected, by one level.
void ScriptEdit::shiftLines(bool isForward) {
    QTextCursor change = textCursor();
    const int end = std::max(change.selectionEnd() - 1, change.selectionStart());
    const QTextBlock behind = document()->findBlock(end).next();
    change.beginEditBlock();
    for (QTextBlock line = document()->findBlock(change.selectionStart()); line != behind; line = line.next()) {
        QTextCursor start(line);
        if (isForward) {
            if (line.length() > 1) start.insertText(QStringLiteral("\t"));
            continue;
        }
        const QString text = line.text().left(TabWidth);
        const auto isOther = [](QChar c) { return c != QLatin1Char(' '); };
        const auto blanks = std::find_if(text.cbegin(), text.cend(), isOther) - text.cbegin();
        const auto length = text.startsWith(QLatin1Char('\t')) ? 1 : static_cast<int>(blanks);
        start.movePosition(QTextCursor::Right, QTextCursor::KeepAnchor, length);
        start.removeSelectedText();
    }
    change.endEditBlock();
}

void ScriptEdit::breakLine() {
    QTextCursor caret = textCursor();
    caret.beginEditBlock();
    caret.removeSelectedText();
    const std::u16string before = fromQString(caret.block().text().left(caret.positionInBlock()));
    caret.insertText(QLatin1Char('\n') + toQString(indentBelow(before, highlighter_->language())));
    caret.endEditBlock();
    setTextCursor(caret);
    ensureCursorVisible();
}

// ---- The clipboard ----

QMimeData* ScriptEdit::createMimeDataFromSelection() const {
    auto selected = std::make_unique<QMimeData>();
    selected->setText(textCursor().selectedText().replace(QChar::ParagraphSeparator, QLatin1Char('\n')));
    return selected.release();
}

// A sign that stands for an object is no text.
void ScriptEdit::insertFromMimeData(const QMimeData* source) {
    textCursor().insertText(withPlainBreaks(source->text()).remove(QChar::ObjectReplacementCharacter));
    ensureCursorVisible();
}

// ---- How it looks ----

void ScriptEdit::changeEvent(QEvent* event) {
    QPlainTextEdit::changeEvent(event);
    if (event->type() == QEvent::PaletteChange) {
        highlighter_->setPalette(palette());
        showBrackets();
    }
    if (event->type() == QEvent::FontChange) {
        setTabStopDistance(TabWidth * QFontMetricsF(font()).horizontalAdvance(QLatin1Char(' ')));
        placeLineNumbers();
    }
}

void ScriptEdit::showBrackets() {
    QList<QTextEdit::ExtraSelection> marks;
    if (const auto pair = bracketPairAt(*document(), textCursor().position())) {
        QColor ground = palette().color(QPalette::Highlight);
        ground.setAlphaF(BracketTint);
        for (const int place : {pair->first, pair->second}) {
            QTextEdit::ExtraSelection mark{textCursor(), {}};
            mark.cursor.setPosition(place);
            mark.cursor.movePosition(QTextCursor::Right, QTextCursor::KeepAnchor);
            mark.format.setBackground(ground);
            mark.format.setFontWeight(QFont::Bold);
            marks.append(mark);
        }
    }
    setExtraSelections(marks);
}

void ScriptEdit::resizeEvent(QResizeEvent* event) {
    QPlainTextEdit::resizeEvent(event);
    placeLineNumbers();
}

void ScriptEdit::placeLineNumbers() {
    const int width = lineNumbers_->sizeHint().width();
    setViewportMargins(width, 0, 0, 0);
    const QRect inside = contentsRect();
    lineNumbers_->setGeometry(inside.left(), inside.top(), width, viewport()->height());
}

std::vector<ScriptEdit::VisibleLine> ScriptEdit::visibleLines() const {
    std::vector<VisibleLine> lines;
    QTextBlock block = firstVisibleBlock();
    double top = blockBoundingGeometry(block).translated(contentOffset()).top();
    while (block.isValid() && top < viewport()->height()) {
        const double height = blockBoundingRect(block).height();
        lines.push_back({block.blockNumber() + 1, qRound(top), qRound(height)});
        top += height;
        block = block.next();
    }
    return lines;
}

}  // namespace plume

#include "app/editor/ContentEdit.h"

#include <QAbstractTextDocumentLayout>
#include <QAccessible>
#include <QClipboard>
#include <QContextMenuEvent>
#include <QGuiApplication>
#include <QHelpEvent>
#include <QKeyEvent>
#include <QMenu>
#include <QMimeData>
#include <QScopedValueRollback>
#include <QScrollBar>
#include <QTextBlock>
#include <QToolTip>
#include <algorithm>
#include <memory>
#include <utility>

#include "app/editor/ContentDifference.h"
#include "app/editor/ContentMimeData.h"
#include "app/editor/RichTextDocument.h"
#include "app/editor/TextFormats.h"
#include "app/qt/Text.h"
#include "content/PlaceholderBody.h"
#include "content/PlaceholderKinds.h"
#include "content/SnippetEditContent.h"

namespace plume {

namespace {

constexpr char16_t ChipUnit = u'\uFFFC';

std::u16string placeholder(const std::u16string& body) {
    return OpeningMarker + body + ClosingMarker;
}

// Where a place in one text is in another that differs only there.
class MovedPlace {
  public:
    MovedPlace(const ContentDifference& difference, const AttributedString& before, const AttributedString& after)
        : start_(positionsFor(before, difference.start)),
          oldEnd_(positionsFor(before, difference.endInFirst)),
          newEnd_(positionsFor(after, difference.endInSecond)) {
        const std::size_t changed = std::max(difference.endInFirst, difference.endInSecond) - difference.start;
        isOtherText_ = 2 * changed > std::max(before.length(), after.length());
    }

    int of(int position) const {
        if (position <= start_) return position;
        if (position >= oldEnd_) return position - oldEnd_ + newEnd_;
        return isOtherText_ ? 0 : newEnd_;
    }

  private:
    int start_;
    int oldEnd_;
    int newEnd_;
    bool isOtherText_ = false;
};

// The positions of a shown text that stand for so many units of its content.
int positionsForStored(const AttributedString& shown, std::size_t units) {
    std::size_t stored = 0;
    std::size_t i = 0;
    for (const AttributedString::Run& run : shown.runs()) {
        const bool isChip =
            run.attributes && run.attributes->attachment && !run.attributes->attachment->cellText.empty();
        const std::size_t each = isChip ? run.attributes->attachment->cellText.size() + 2 : 1;
        for (std::size_t k = 0; k < run.length && stored < units; ++k, ++i) stored += each;
    }
    return positionsFor(shown, i);
}

bool isUndoKey(const QKeyEvent& event) {
    return event.matches(QKeySequence::Undo) || event.matches(QKeySequence::Redo);
}

bool isReturn(const QKeyEvent& event) {
    return event.key() == Qt::Key_Return || event.key() == Qt::Key_Enter;
}

}  // namespace

ContentEdit::ContentEdit(ContentEnvironment environment) : chips_(std::move(environment)) {
    document()->setUndoRedoEnabled(false);
    QAbstractTextDocumentLayout* const layout = document()->documentLayout();
    layout->registerHandler(InlineObject::Chip, &chips_);
    layout->registerHandler(InlineObject::File, &files_);
    setTabChangesFocus(true);
    setAcceptRichText(false);
    setAccessibleDescription(tr("Ctrl+Tab types a tab."));
    connect(document(), &QTextDocument::contentsChanged, this, [this] {
        if (!isLoading_) Q_EMIT edited();
    });
    connect(this, &QTextEdit::cursorPositionChanged, this, &ContentEdit::lookChanged);
    connect(this, &QTextEdit::selectionChanged, this, &ContentEdit::lookChanged);
}

// ---- Content ----

AttributedString ContentEdit::shown(const AttributedString& content) const {
    const AttributedString text = isRich_ ? content : AttributedString(content.string());
    return showsSource_ ? text : convertToSnippetEditContent(text);
}

void ContentEdit::setContent(const AttributedString& content, bool isRich) {
    isRich_ = isRich;
    setAcceptRichText(isRich);
    chips_.forgetWords();
    files_.forgetPictures();
    showContent(shown(content));
}

AttributedString ContentEdit::content() const {
    AttributedString content = contentOf(*document());
    return isRich_ ? content : AttributedString(content.string());
}

void ContentEdit::showContent(const AttributedString& shown) {
    const QScopedValueRollback loading(isLoading_, true);
    opening_ = activated_ = QTextCursor();
    const int length = document()->characterCount() - 1;
    const AttributedString before = editContentBetween(*document(), 0, length);
    const ContentDifference difference = differenceBetween(before, shown);
    if (difference.isEmpty()) return;
    if (positionsFor(before, before.length()) != length) return plume::setDocument(*document(), shown);
    const MovedPlace moved(difference, before, shown);
    const int anchor = moved.of(textCursor().anchor());
    const int caret = moved.of(textCursor().position());
    const int scrolled = verticalScrollBar()->value();
    const ContentDifference wide = difference.inParagraphs(before, shown);
    QTextCursor cursor = selecting(positionsFor(before, wide.start), positionsFor(before, wide.endInFirst));
    cursor.beginEditBlock();
    cursor.removeSelectedText();
    insertContent(cursor, shown, wide.start, wide.endInSecond);
    cursor.endEditBlock();
    setTextCursor(selecting(anchor, caret));
    verticalScrollBar()->setValue(caret == 0 ? 0 : scrolled);
}

void ContentEdit::setShowsSource(bool showsSource) {
    if (showsSource == showsSource_) return;
    const std::size_t before = contentBetween(*document(), 0, textCursor().position()).length();
    const AttributedString stored = content();
    showsSource_ = showsSource;
    const AttributedString now = shown(stored);
    showContent(now);
    const int caret = positionsForStored(now, before);
    setTextCursor(selecting(caret, caret));
    ensureCursorVisible();
}

// ---- Inserting ----

void ContentEdit::insertBody(QTextCursor& cursor, const std::u16string& body) const {
    const SharedAttributes look = isRich_ ? typingAttributes(cursor.charFormat()) : nullptr;
    if (showsSource_ || !startsWithKeyword(body)) {
        cursor.insertText(toQString(placeholder(body)), charFormatOf(look));
    } else {
        cursor.insertText(QString(QChar(ChipUnit)), chipFormatOf(body, look));
    }
}

void ContentEdit::insertPlaceholder(const std::u16string& body) {
    QTextCursor cursor = textCursor();
    cursor.beginEditBlock();
    const bool followsOpening = opening_.hasSelection() && opening_.selectionEnd() == cursor.position() &&
                                document()->characterAt(opening_.selectionStart()) == OpeningMarker;
    if (followsOpening && !cursor.hasSelection()) opening_.removeSelectedText();
    opening_ = QTextCursor();
    insertBody(cursor, body);
    cursor.endEditBlock();
    setTextCursor(cursor);
    ensureCursorVisible();
}

void ContentEdit::replaceActivatedChip(const std::u16string& body) {
    const bool isThere =
        activated_.selectionEnd() - activated_.selectionStart() == 1 && isChipAt(activated_.selectionStart());
    if (!isThere || bodyOf(formatAt(activated_.selectionStart())) == body) return;
    const int position = activated_.selectionStart();
    QTextCursor cursor = std::exchange(activated_, QTextCursor());
    insertBody(cursor, body);
    activated_ = selecting(position, position + 1);
    setTextCursor(activated_);
    activated_.setKeepPositionOnInsert(true);
}

void ContentEdit::insertShown(const AttributedString& content) {
    QTextCursor cursor = textCursor();
    insertForeignContent(cursor, shown(content));
    setTextCursor(cursor);
    ensureCursorVisible();
}

void ContentEdit::insertRich(const AttributedString& content) {
    insertShown(content);
}

// ---- Clipboard and drags ----

QMimeData* ContentEdit::createMimeDataFromSelection() const {
    const QTextCursor cursor = textCursor();
    // Qt takes it over.
    return std::make_unique<ContentMimeData>(
               contentBetween(*document(), cursor.selectionStart(), cursor.selectionEnd()), isRich_)
        .release();
}

bool ContentEdit::canInsertFromMimeData(const QMimeData* source) const {
    return holdsContent(*source);
}

void ContentEdit::insertFromMimeData(const QMimeData* source) {
    insertMimeContent(*source, isRich_);
}

void ContentEdit::pastePlain() {
    if (const QMimeData* const copied = QGuiApplication::clipboard()->mimeData()) insertMimeContent(*copied, false);
}

void ContentEdit::insertMimeContent(const QMimeData& source, bool asRich) {
    if (isReadOnly()) return;
    std::optional<AttributedString> content = contentFrom(source, asRich);
    if (!content) return;
    const bool saysNothing = content->runs().size() == 1 && !content->runs().front().attributes;
    if (isRich_ && saysNothing) content = AttributedString(content->string(), typingAttributes(currentCharFormat()));
    insertShown(*content);
}

// ---- Keys ----

bool ContentEdit::event(QEvent* event) {
    if (event->type() == QEvent::ShortcutOverride && isUndoKey(*static_cast<QKeyEvent*>(event))) {
        event->ignore();
        return false;
    }
    return QTextEdit::event(event);
}

bool ContentEdit::takesKey(QKeyEvent& event) {
    const bool isPlainKey = (event.modifiers() & ~Qt::KeypadModifier) == Qt::NoModifier;
    const std::optional<int> chip = selectedChip();
    if (chip && isPlainKey && (isReturn(event) || event.key() == Qt::Key_Space)) {
        activateChip(*chip);
        return true;
    }
    if (isReadOnly()) return false;
    if (event.key() == Qt::Key_Tab && event.modifiers() == Qt::ControlModifier) {
        textCursor().insertText(QStringLiteral("\t"));
        return true;
    }
    if (!isRich_ || !isPlainKey) return false;
    if (event.key() == Qt::Key_Backspace) return endListAtItemStart(textCursor());
    if (!isReturn(event)) return false;
    QTextCursor cursor = textCursor();
    if (!continueList(cursor)) return false;
    setTextCursor(cursor);
    ensureCursorVisible();
    return true;
}

void ContentEdit::keyPressEvent(QKeyEvent* event) {
    if (isUndoKey(*event)) return event->ignore();
    if (takesKey(*event)) return event->accept();
    QTextEdit::keyPressEvent(event);
    if (!event->text().isEmpty()) markerTyped();
}

void ContentEdit::inputMethodEvent(QInputMethodEvent* event) {
    QTextEdit::inputMethodEvent(event);
    if (!event->commitString().isEmpty()) markerTyped();
}

// Looks at the character before the caret alone.
void ContentEdit::markerTyped() {
    const QTextCursor cursor = textCursor();
    if (isReadOnly() || cursor.hasSelection() || cursor.atBlockStart()) return;
    const QChar typed = document()->characterAt(cursor.position() - 1);
    const bool isNew = opening_.selectionEnd() != cursor.position() || !opening_.hasSelection();
    if (typed == OpeningMarker && isNew) {
        opening_ = selecting(cursor.position() - 1, cursor.position());
        opening_.setKeepPositionOnInsert(true);
        Q_EMIT openingTyped();
    } else if (typed == ClosingMarker && !showsSource_) {
        closingTyped(cursor);
    }
}

void ContentEdit::closingTyped(QTextCursor cursor) {
    const QTextBlock block = cursor.block();
    const QString before = block.text().left(cursor.positionInBlock() - 1);
    const qsizetype opening = before.lastIndexOf(QChar(OpeningMarker));
    if (opening < 0) return;
    const std::u16string body = fromQString(before.mid(opening + 1));
    const bool isText = body.find(ChipUnit) == std::u16string::npos && body.find(ClosingMarker) == std::u16string::npos;
    if (!isText || !startsWithKeyword(body)) return;
    const int start = block.position() + static_cast<int>(opening);
    const SharedAttributes look = isRich_ ? attributesIn(formatAt(start)) : nullptr;
    cursor.setPosition(start, QTextCursor::KeepAnchor);
    cursor.insertText(QString(QChar(ChipUnit)), chipFormatOf(body, look));
}

// ---- Chips ----

QTextCursor ContentEdit::selecting(int from, int to) const {
    QTextCursor cursor(document());
    const int end = document()->characterCount() - 1;
    cursor.setPosition(std::clamp(from, 0, end));
    cursor.setPosition(std::clamp(to, 0, end), QTextCursor::KeepAnchor);
    return cursor;
}

// A cursor tells the format of the character before it.
QTextCharFormat ContentEdit::formatAt(int position) const {
    QTextCursor cursor(document());
    cursor.setPosition(position + 1);
    return cursor.charFormat();
}

bool ContentEdit::isChipAt(int position) const {
    return position >= 0 && document()->characterAt(position) == ChipUnit && isChip(formatAt(position));
}

std::optional<int> ContentEdit::selectedChip() const {
    const QTextCursor cursor = textCursor();
    const int start = cursor.selectionStart();
    return cursor.selectionEnd() - start == 1 && isChipAt(start) ? std::optional(start) : std::nullopt;
}

std::optional<int> ContentEdit::chipUnder(QPoint place) const {
    const int near = cursorForPosition(place).position();
    for (const int position : {near - 1, near}) {
        if (!isChipAt(position)) continue;
        const QRect left = cursorRect(selecting(position, position));
        const QRect right = cursorRect(selecting(position + 1, position + 1));
        const bool isInLine = place.y() >= left.top() && place.y() <= left.bottom();
        const bool wraps = right.top() != left.top();
        if (isInLine && place.x() >= left.left() && (wraps || place.x() <= right.right())) return position;
    }
    return std::nullopt;
}

void ContentEdit::activateChip(int position) {
    activated_ = selecting(position, position + 1);
    setTextCursor(activated_);
    activated_.setKeepPositionOnInsert(true);
    Q_EMIT chipActivated(bodyOf(formatAt(position)));
}

void ContentEdit::mouseReleaseEvent(QMouseEvent* event) {
    QTextEdit::mouseReleaseEvent(event);
    if (event->button() != Qt::LeftButton || textCursor().hasSelection()) return;
    if (const std::optional<int> chip = chipUnder(event->pos())) setTextCursor(selecting(*chip, *chip + 1));
}

void ContentEdit::mouseDoubleClickEvent(QMouseEvent* event) {
    const std::optional<int> chip = event->button() == Qt::LeftButton ? chipUnder(event->pos()) : std::nullopt;
    if (!chip) return QTextEdit::mouseDoubleClickEvent(event);
    event->accept();
    activateChip(*chip);
}

bool ContentEdit::viewportEvent(QEvent* event) {
    if (event->type() == QEvent::ToolTip) {
        const auto* const help = static_cast<QHelpEvent*>(event);
        if (const std::optional<int> chip = chipUnder(help->pos())) {
            const QTextCharFormat format = formatAt(*chip);
            const QString words = chips_.wordsOf(format) + u'\n' + toQString(placeholder(bodyOf(format)));
            QToolTip::showText(help->globalPos(), words.toHtmlEscaped().replace(u'\n', QStringLiteral("<br>")),
                               viewport());
            return true;
        }
    }
    return QTextEdit::viewportEvent(event);
}

void ContentEdit::contextMenuEvent(QContextMenuEvent* event) {
    auto* const menu = new QMenu(this);
    menu->setAttribute(Qt::WA_DeleteOnClose);
    const bool hasSelection = textCursor().hasSelection();
    const bool isEditable = !isReadOnly();
    const auto add = [&](const QString& text, auto slot, bool isEnabled) {
        menu->addAction(text, this, slot)->setEnabled(isEnabled);
    };
    if (const std::optional<int> chip = selectedChip()) {
        add(
            tr("Cha&nge…"), [this, position = *chip] { activateChip(position); }, isEditable);
        menu->addSeparator();
    }
    add(tr("Cu&t"), &QTextEdit::cut, isEditable && hasSelection);
    add(tr("&Copy"), &QTextEdit::copy, hasSelection);
    add(tr("&Paste"), &QTextEdit::paste, isEditable && canPaste());
    if (isRich_) add(tr("Paste Without &Formatting"), &ContentEdit::pastePlain, isEditable && canPaste());
    menu->addSeparator();
    add(tr("Select &All"), &QTextEdit::selectAll, !document()->isEmpty());
    menu->popup(event->globalPos());
}

// ---- The look of rich text ----

TextAttributes ContentEdit::attributesAtCaret() const {
    const QTextCursor cursor = textCursor();
    // Of a selection, that of its first character.
    const SharedAttributes look =
        cursor.hasSelection() ? attributesIn(formatAt(cursor.selectionStart())) : typingAttributes(currentCharFormat());
    return look ? *look : TextAttributes();
}

void ContentEdit::changeAttributes(const AttributesChange& change) {
    if (!isRich_ || isReadOnly()) return;
    if (textCursor().hasSelection()) {
        plume::changeAttributes(textCursor(), change);
    } else {
        TextAttributes look = attributesAtCaret();
        change(look);
        setCurrentCharFormat(charFormatOf(std::make_shared<const TextAttributes>(std::move(look))));
    }
    Q_EMIT lookChanged();
}

void ContentEdit::changeStyle(const StyleChange& change) {
    if (!isRich_ || isReadOnly()) return;
    plume::changeStyle(textCursor(), change);
    Q_EMIT lookChanged();
}

void ContentEdit::toggleList(const std::u16string& markerFormat) {
    if (!isRich_ || isReadOnly()) return;
    plume::toggleList(textCursor(), markerFormat);
    Q_EMIT lookChanged();
}

}  // namespace plume

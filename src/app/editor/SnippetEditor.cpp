#include "app/editor/SnippetEditor.h"

#include <QDateTime>
#include <QFormLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QLocale>
#include <QPlainTextEdit>
#include <QVBoxLayout>
#include <utility>

#include "app/FirstLine.h"
#include "app/editing/AbbreviationConflict.h"
#include "app/editor/CaseReset.h"
#include "app/editor/ChoiceBox.h"
#include "app/editor/ContentPane.h"
#include "app/qt/Labels.h"
#include "app/qt/RawText.h"
#include "app/qt/Text.h"

namespace plume {

namespace {

using namespace std::chrono_literals;

constexpr auto CommitDelay = 200ms;
// What was typed so lately is still being edited when another library comes.
constexpr auto EditLasts = 10s;

std::optional<std::u16string> textOrNil(const QString& text) {
    return text.isEmpty() ? std::nullopt : std::optional(fromQString(text));
}

// Kept as the user put it: a caret in the middle does not move for what stands there already.
void setText(QLineEdit& field, const std::optional<std::u16string>& text) {
    const QString wanted = toQString(text.value_or(u""));
    if (field.text() != wanted) field.setText(wanted);
}

QString dayOf(const Date& date) {
    const auto sinceEpoch = std::chrono::duration_cast<std::chrono::milliseconds>(date.time_since_epoch());
    const auto time = QDateTime::fromMSecsSinceEpoch(sinceEpoch.count());
    return QLocale().toString(time.date(), QLocale::ShortFormat);
}

}  // namespace

SnippetEditor::SnippetEditor(LibraryEditor& editor, ContentPane& content)
    : editor_(editor),
      content_(content),
      abbreviation_(new QLineEdit),
      conflict_(makeTextLabel()),
      label_(new QLineEdit),
      // In the order of their numbers.
      kind_(new ChoiceBox({tr("Plain text"), tr("Formatted text"), tr("AppleScript"), tr("Shell script")})),
      case_(new ChoiceBox(caseSensitivityNames())),
      note_(new QPlainTextEdit),
      dates_(makeHelpLabel({})) {
    commitTimer_.setSingleShot(true);
    commitTimer_.setInterval(CommitDelay);
    connect(&commitTimer_, &QTimer::timeout, this, &SnippetEditor::commit);
    auto* layout = new QVBoxLayout(this);
    auto* top = new QFormLayout;
    auto* bottom = new QFormLayout;
    makeForm(*top);
    bottom->addRow(tr("N&ote:"), note_);
    bottom->addRow(dates_);
    layout->addLayout(top);
    layout->addWidget(&content_, 1);
    layout->addLayout(bottom);
    connect(abbreviation_, &QLineEdit::textEdited, this, &SnippetEditor::edited);
    connect(abbreviation_, &QLineEdit::textChanged, this, &SnippetEditor::showConflict);
    connect(label_, &QLineEdit::textEdited, this, &SnippetEditor::edited);
    connect(note_, &QPlainTextEdit::textChanged, this, &SnippetEditor::edited);
    connect(&content_, &ContentPane::edited, this, &SnippetEditor::edited);
    connect(kind_, &ChoiceBox::chosen, this, &SnippetEditor::chooseKind);
    connect(case_, &ChoiceBox::chosen, this, &SnippetEditor::chooseCase);
}

void SnippetEditor::makeForm(QFormLayout& form) {
    label_->setPlaceholderText(tr("Optional: a name for lists"));
    note_->setTabChangesFocus(true);
    note_->setUndoRedoEnabled(false);
    for (QLineEdit* field : {abbreviation_, label_}) field->installEventFilter(this);
    note_->setPlaceholderText(tr("Optional: for yourself"));
    note_->setMaximumHeight(3 * fontMetrics().lineSpacing());
    conflict_->setAccessibleName(tr("About the abbreviation"));
    // One line is kept free for it: nothing jumps while one types.
    conflict_->setMinimumSize(24 * fontMetrics().height(), fontMetrics().lineSpacing());
    form.setFieldGrowthPolicy(QFormLayout::AllNonFixedFieldsGrow);
    form.addRow(tr("&Abbreviation:"), abbreviation_);
    form.addRow(QString(), conflict_);
    form.addRow(tr("La&bel:"), label_);
    form.addRow(tr("&Kind:"), kind_);
    form.addRow(tr("&Case:"), case_);
}

// ---- What is shown ----

void SnippetEditor::show(const std::shared_ptr<Snippet>& snippet) {
    commit();
    snippet_ = snippet;
    beforeTyping_ = nullptr;
    if (snippet_) setFields();
}

void SnippetEditor::refresh() {
    commit();
    if (snippet_) setFields();
}

void SnippetEditor::setFields() {
    isSetting_ = true;
    setText(*abbreviation_, snippet_->abbreviation());
    setText(*label_, snippet_->label());
    const QString note = toQString(snippet_->note().value_or(u""));
    if (rawText(*note_->document()) != note) note_->setPlainText(note);
    kind_->showValue(static_cast<std::int64_t>(snippet_->contentType()));
    case_->showValue(static_cast<std::int64_t>(snippet_->caseSensitivity()));
    content_.show(snippet_);
    showDates();
    isSetting_ = false;
    showConflict();
}

void SnippetEditor::focusAbbreviation() {
    abbreviation_->setFocus();
    abbreviation_->selectAll();
}

void SnippetEditor::showConflict() {
    // While the fields are set, it is told once at the end.
    if (!snippet_ || isSetting_) return;
    const std::u16string abbreviation = fromQString(abbreviation_->text());
    const AbbreviationConflict conflict = conflictOf(*snippet_, abbreviation, editor_.groups());
    if (abbreviation.empty()) {
        conflict_->setText(tr("Without an abbreviation it can only be chosen from lists."));
        return;
    }
    if (!conflict.other) return conflict_->clear();
    const auto group = conflict.other->parentGroup();
    const QString groupName = group ? toQString(firstLine(group->name().value_or(u""))) : QString();
    const QString shown = toQString(firstLine(conflict.other->sortingContent().value_or(u"")));
    if (conflict.kind == AbbreviationConflict::Kind::Same) {
        conflict_->setText(tr("⚠ “%1” in “%2” has this abbreviation, too.").arg(shown, groupName));
    } else {
        const QString first = toQString(conflict.other->abbreviationWithPrefix().value_or(u""));
        conflict_->setText(tr("⚠ “%1” in “%2” expands before this is typed.").arg(first, groupName));
    }
}

void SnippetEditor::showDates() {
    QStringList dates;
    if (snippet_->dateCreated()) dates.append(tr("Created %1").arg(dayOf(*snippet_->dateCreated())));
    if (snippet_->dateModified()) dates.append(tr("Changed %1").arg(dayOf(*snippet_->dateModified())));
    // A new one counts as used when it was made.
    const auto& lastUse = snippet_->lastTimeUsed();
    const bool isUsed = lastUse && (!snippet_->dateCreated() || *lastUse - *snippet_->dateCreated() > 1s);
    dates.append(isUsed ? tr("Used last %1").arg(dayOf(*lastUse)) : tr("Not used yet"));
    dates_->setText(dates.join(QStringLiteral(" · ")));
}

// ---- What is typed ----

void SnippetEditor::edited() {
    if (isSetting_ || !snippet_) return;
    const auto now = std::chrono::steady_clock::now();
    if (!beforeTyping_ || now - lastTyped_ > EditLasts) beforeTyping_ = snippet_->snapshot();
    lastTyped_ = now;
    isTyped_ = true;
    // Not put off by further letters.
    if (!commitTimer_.isActive()) commitTimer_.start();
    Q_EMIT typed();
}

void SnippetEditor::commit() {
    commitTimer_.stop();
    if (!std::exchange(isTyped_, false) || !snippet_) return;
    editor_.setSnippetAbbreviation(snippet_, fromQString(abbreviation_->text()));
    editor_.setLabel(snippet_, textOrNil(label_->text()));
    editor_.setNote(snippet_, textOrNil(rawText(*note_->document())));
    editor_.setContent(snippet_, content_.content());
    showDates();
}

// The record with what the library does not know yet.
std::shared_ptr<Snippet> SnippetEditor::shownRecord() const {
    auto record = snippet_->snapshot();
    if (!isTyped_) return record;
    const std::u16string abbreviation = fromQString(abbreviation_->text());
    const AttributedString content = content_.content();
    if (record->abbreviation().value_or(u"") != abbreviation) record->setAbbreviation(abbreviation);
    if (toQString(record->label().value_or(u"")) != label_->text()) record->setLabel(textOrNil(label_->text()));
    const QString note = rawText(*note_->document());
    if (toQString(record->note().value_or(u"")) != note) record->setNote(textOrNil(note));
    if (record->richTextContent() != content) record->setRichTextContent(content);
    return record;
}

std::optional<SnippetEditor::OpenEdit> SnippetEditor::takeOpenEdit() {
    std::optional<OpenEdit> edit;
    const bool isOpen = beforeTyping_ && std::chrono::steady_clock::now() - lastTyped_ <= EditLasts;
    if (isOpen && snippet_) edit = OpenEdit{beforeTyping_, shownRecord()};
    commitTimer_.stop();
    isTyped_ = false;
    snippet_ = nullptr;
    return edit;
}

// What is undone is what was done to the library; the fields keep nothing of their own.
bool SnippetEditor::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() != QEvent::ShortcutOverride) return QWidget::eventFilter(watched, event);
    const auto* key = static_cast<QKeyEvent*>(event);
    if (!key->matches(QKeySequence::Undo) && !key->matches(QKeySequence::Redo)) return false;
    event->ignore();
    return true;
}

void SnippetEditor::chooseKind() {
    if (isSetting_ || !snippet_) return;
    commit();
    editor_.setContentType(snippet_, static_cast<ContentType>(kind_->value()));
    setFields();
}

void SnippetEditor::chooseCase() {
    if (isSetting_ || !snippet_) return;
    commit();
    editor_.setCaseSensitivity({snippet_}, static_cast<CaseSensitivity>(case_->value()));
}

}  // namespace plume

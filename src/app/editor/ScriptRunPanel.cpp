#include "app/editor/ScriptRunPanel.h"

#include <QEvent>
#include <QFontDatabase>
#include <QHBoxLayout>
#include <QHideEvent>
#include <QLabel>
#include <QLocale>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QTextCursor>
#include <QVBoxLayout>
#include <utility>

#include "app/TextOnPasteboard.h"
#include "app/editor/LegibleColor.h"
#include "app/qt/Labels.h"
#include "app/qt/Sentences.h"
#include "app/qt/Text.h"

namespace plume {

namespace {

constexpr double TickInterval = 1;  // seconds
constexpr int OutputLines = 6;      // that can be seen without scrolling, at least

QString wholeSeconds(double seconds) {
    return QLocale().toString(qRound(seconds));
}

bool mayReadClipboard(std::u16string_view text) {
    return text.find(u'【') != std::u16string_view::npos;
}

}  // namespace

ScriptRunPanel::ScriptRunPanel(ScriptRunServices services)
    : services_(std::move(services)),
      runButton_(new QPushButton(tr("Run &Now"))),
      cancelButton_(new QPushButton(tr("Cance&l"))),
      status_(makeTextLabel()),
      notes_(makeTextLabel()),
      output_(new QPlainTextEdit) {
    runButton_->setAutoDefault(false);
    cancelButton_->setAutoDefault(false);
    output_->setReadOnly(true);
    output_->setTabChangesFocus(true);
    output_->setUndoRedoEnabled(false);
    output_->setWordWrapMode(QTextOption::WrapAnywhere);
    output_->setFont(QFontDatabase::systemFont(QFontDatabase::FixedFont));
    output_->setMinimumHeight(OutputLines * output_->fontMetrics().lineSpacing());
    output_->setAccessibleName(tr("Output of the script"));
    output_->setPlaceholderText(tr("What the script writes is shown here. Nothing is typed anywhere."));
    connect(runButton_, &QPushButton::clicked, this, &ScriptRunPanel::runNow);
    connect(cancelButton_, &QPushButton::clicked, this, &ScriptRunPanel::cancel);
    makeLayout();
    showIdle();
}

ScriptRunPanel::~ScriptRunPanel() {
    cancel();
}

void ScriptRunPanel::makeLayout() {
    auto* bar = new QHBoxLayout;
    bar->addWidget(runButton_);
    bar->addWidget(cancelButton_);
    bar->addWidget(status_, 1);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins({});
    layout->addLayout(bar);
    layout->addWidget(output_, 1);
    layout->addWidget(notes_);
}

void ScriptRunPanel::setScript(const std::shared_ptr<Snippet>& snippet, std::function<std::u16string()> text) {
    text_ = std::move(text);
    const bool isOther = snippet != snippet_;
    snippet_ = snippet;
    if (isOther) {
        cancel();
        run_.reset();
        tick_.cancel();
        shown_.reset();
    }
    if (!run_ && !shown_) showIdle();
    enableButtons();
}

// ---- From the click to the output ----

void ScriptRunPanel::runNow() {
    if (run_ || !runButton_->isEnabled()) return;
    run_ = std::make_shared<Run>();
    shown_.reset();
    output_->clear();
    notes_->hide();
    status_->setText(tr("Starting…"));
    enableButtons();
    if (!mayReadClipboard(text_())) return begin({});
    services_.readClipboard([this, weak = std::weak_ptr(run_)](const ScriptRunServices::Clipboard& clipboard) {
        if (!weak.expired()) begin(clipboard);
    });
}

void ScriptRunPanel::begin(const ScriptRunServices::Clipboard& clipboard) {
    const TextOnPasteboard reader(clipboard);
    ContentEnvironment environment = services_.environment;
    environment.pasteboard = &reader;
    environment.report = [run = run_](const std::string& sentence) { run->notes << inUsersLanguage(sentence); };
    run_->trial = ScriptTrial::prepare(snippet_, text_(), services_.groups(), environment, services_.numberLocale);
    if (!run_->trial) return giveUp(tr("The script's placeholders cannot be replaced."));
    run_->runner = services_.makeRunner();
    run_->start = services_.loop.now();
    showRunning();
    runInBackground();
}

// What runs there is kept until it has ended, also when nobody waits for it any more.
void ScriptRunPanel::runInBackground() {
    services_.inBackground([trial = run_->trial, runner = run_->runner] { trial->run(*runner); },
                           [this, weak = std::weak_ptr(run_), trial = run_->trial] {
                               if (!weak.expired()) finish();
                           });
}

void ScriptRunPanel::cancel() {
    if (!run_ || run_->isCancelled) return;
    run_->isCancelled = true;
    if (!run_->runner) return giveUp(tr("Cancelled."));
    run_->runner->stop();
    status_->setText(tr("Cancelling…"));
    tick_.cancel();
}

void ScriptRunPanel::finish() {
    const auto run = std::exchange(run_, nullptr);
    tick_.cancel();
    shown_ = run->trial;
    status_->setText(endInWords(shown_->endings().back(), services_.loop.now() - run->start));
    const QStringList notes = run->notes + notesOn(*shown_);
    notes_->setText(notes.join(QLatin1Char('\n')));
    notes_->setVisible(!notes.isEmpty());
    showOutput();
    enableButtons();
}

void ScriptRunPanel::giveUp(const QString& status) {
    const auto run = std::exchange(run_, nullptr);
    status_->setText(status);
    notes_->setText(run->notes.join(QLatin1Char('\n')));
    notes_->setVisible(!run->notes.isEmpty());
    enableButtons();
}

// ---- What is shown ----

void ScriptRunPanel::showRunning() {
    status_->setText(tr("Running for %1 of at most %2 seconds.")
                         .arg(wholeSeconds(services_.loop.now() - run_->start), wholeSeconds(services_.limits.time)));
    tick_ = services_.loop.performAfterDelay(TickInterval, [this] { showRunning(); });
}

void ScriptRunPanel::showIdle() {
    output_->clear();
    notes_->hide();
    const bool isAppleScript = snippet_ && snippet_->contentType() == ContentType::AppleScript;
    status_->setText(isAppleScript && !services_.canRunAppleScript
                         ? tr("AppleScript cannot run on this system.")
                         : tr("A script is ended after %1 seconds.").arg(wholeSeconds(services_.limits.time)));
    enableButtons();
}

// The keyboard stays with the button that can be pressed.
void ScriptRunPanel::enableButtons() {
    const bool isScript = snippet_ && snippet_->isScript();
    const bool canRun =
        isScript && (snippet_->contentType() != ContentType::AppleScript || services_.canRunAppleScript);
    QPushButton* const before = run_ ? runButton_ : cancelButton_;
    QPushButton* const now = run_ ? cancelButton_ : runButton_;
    const bool hadFocus = before->hasFocus();
    now->setEnabled(run_ || canRun);
    if (hadFocus) now->setFocus();
    before->setEnabled(false);
}

void ScriptRunPanel::showOutput() {
    if (!shown_) return;
    QTextCharFormat error;
    error.setForeground(legibleColor(TextHue::Red, palette()));
    QTextCharFormat heading = error;
    heading.setFontWeight(QFont::Bold);
    output_->clear();
    QTextCursor cursor(output_->document());
    const QString output = toQString(shown_->output().text);
    const QString errors = toQString(shown_->errors().text);
    cursor.insertText(output, {});
    if (!errors.isEmpty()) {
        if (!output.isEmpty() && !output.endsWith(QLatin1Char('\n'))) cursor.insertBlock();
        cursor.insertText(tr("Errors:"), heading);
        cursor.insertText(QLatin1Char('\n') + errors, error);
    }
    output_->moveCursor(QTextCursor::Start);
}

QString ScriptRunPanel::endInWords(const ScriptTrial::Ending& ending, double seconds) const {
    const QString time = QLocale().toString(seconds, 'f', 1);
    switch (ending.end) {
        case ScriptEnd::Finished:
            return ending.failed ? tr("The script says that it failed, after %1 seconds.").arg(time)
                                 : tr("Finished after %1 seconds.").arg(time);
        case ScriptEnd::TimeLimit:
            return tr("Ended at the time limit of %1 seconds.").arg(wholeSeconds(services_.limits.time));
        case ScriptEnd::OutputLimit:
            return tr("Ended after %1 seconds, because it wrote too much.").arg(time);
        case ScriptEnd::Stopped:
            return tr("Cancelled after %1 seconds.").arg(time);
        case ScriptEnd::NotStarted:
            return tr("The script could not be run: %1.").arg(QString::fromStdString(ending.problem));
    }
    return {};
}

QStringList ScriptRunPanel::notesOn(const ScriptTrial& trial) {
    QStringList notes;
    for (std::size_t i = 0; i + 1 < trial.endings().size(); ++i) {
        const auto& included = trial.endings()[i];
        if (included.end == ScriptEnd::TimeLimit) notes << tr("A script that it includes was ended at the time limit.");
        if (included.end == ScriptEnd::OutputLimit) notes << tr("A script that it includes wrote too much.");
        if (included.end == ScriptEnd::NotStarted) notes << tr("A script that it includes could not be run.");
    }
    const bool isSilent = trial.output().text.empty();
    const bool hasFinished = trial.endings().back().end == ScriptEnd::Finished;
    if (trial.hasFields()) notes << tr("Fields had the values that they begin with.");
    if (isSilent && trial.errors().text.empty() && hasFinished) notes << tr("The script wrote nothing.");
    if (isSilent && !trial.errors().text.empty() && hasFinished) {
        notes << tr("As there is no other output, the errors are typed when the snippet expands.");
    }
    if (!trial.output().isUtf8) notes << tr("The output is no UTF-8 text: nothing is typed when the snippet expands.");
    const qulonglong left = trial.output().left + trial.errors().left;
    if (left > 0)
        notes << tr("The output is cut here: %1 more characters are not shown.").arg(QLocale().toString(left));
    return notes;
}

// ---- The window around it ----

// One that is only out of sight for a while goes on.
void ScriptRunPanel::hideEvent(QHideEvent* event) {
    if (!event->spontaneous()) cancel();
    QWidget::hideEvent(event);
}

void ScriptRunPanel::changeEvent(QEvent* event) {
    QWidget::changeEvent(event);
    if (event->type() == QEvent::PaletteChange) showOutput();
}

}  // namespace plume

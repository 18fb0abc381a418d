#include "app/windows/WelcomeWindow.h"

#include <QCheckBox>
#include <QDialogButtonBox>
#include <QFrame>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QPlainTextEdit>
#include <QPointer>
#include <QPushButton>
#include <QScrollArea>
#include <QTextDocument>
#include <QTimer>
#include <QVBoxLayout>
#include <algorithm>
#include <chrono>

#include "app/qt/Labels.h"
#include "app/qt/Messages.h"
#include "app/qt/Sentences.h"
#include "app/qt/Text.h"
#include "app/qt/WindowPlaces.h"

namespace plume {

namespace {

constexpr int LongestPreview = 40;
// In heights of a line.
constexpr int Width = 32;
constexpr int Highest = 44;
constexpr int AroundPage = 5;
constexpr std::chrono::seconds BetweenLooks{1};
// An icon often comes a moment after the window.
constexpr int LooksBeforeTelling = 3;

// As a text field gives it back: line ends and odd spaces become one kind.
QString asInField(std::u16string_view text) {
    QTextDocument document;
    document.setPlainText(toQString(text));
    return document.toPlainText();
}

// One short line.
QString preview(const std::u16string& text) {
    const QString line = toQString(text).simplified();
    return line.size() <= LongestPreview ? line : line.left(LongestPreview).trimmed() + QStringLiteral("…");
}

}  // namespace

WelcomeWindow::WelcomeWindow(WelcomeServices services, WritableUserDefaults& settings)
    : SmallWindow(tr("Welcome to Plume")), services_(std::move(services)) {
    auto* page = new QWidget;
    auto* content = new QVBoxLayout(page);
    content->setContentsMargins({});
    addIntroduction(*content);
    if (!services_.trials.empty()) addTrials(*content);
    if (!services_.foundLibraries.empty()) addFoundLibraries(*content);
    addStart(*content);
    content->addStretch();
    area_ = new QScrollArea;
    area_->setWidget(page);
    area_->setWidgetResizable(true);
    area_->setFrameShape(QFrame::NoFrame);
    area_->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    area_->setFocusPolicy(Qt::NoFocus);

    auto* buttons = new QDialogButtonBox;
    buttons->addButton(tr("&Get Started"), QDialogButtonBox::AcceptRole)->setDefault(true);
    connect(buttons, &QDialogButtonBox::accepted, this, &QWidget::close);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(area_, 1);
    layout->addWidget(buttons);
    resize(Width * fontMetrics().height(), 0);
    makeRoom();
    rememberPlace(*this, settings, "Welcome");
    if (field_) field_->setFocus();
    if (services_.setExpandsInOwnWindows) services_.setExpandsInOwnWindows(true);
}

WelcomeWindow::~WelcomeWindow() {
    if (services_.setExpandsInOwnWindows) services_.setExpandsInOwnWindows(false);
}

void WelcomeWindow::makeRoom() {
    const int em = fontMetrics().height();
    const QLayout& content = *area_->widget()->layout();
    const int wanted = content.totalHeightForWidth(width() - 2 * em) + AroundPage * em;
    // Higher than a small screen it scrolls.
    resize(width(), std::max(height(), std::min(Highest * em, wanted)));
}

void WelcomeWindow::addIntroduction(QVBoxLayout& layout) {
    layout.addWidget(makeHeading(tr("Welcome to Plume")));
    layout.addWidget(makeTextLabel(
        tr("Plume keeps texts that you write often as snippets, each with a short abbreviation. Type the abbreviation "
           "in any program, and Plume puts the text in its place. Your snippets stay on this computer.")));
    layout.addSpacing(fontMetrics().height() / 2);
}

// ---- Trying it ----

void WelcomeWindow::addTrials(QVBoxLayout& layout) {
    layout.addWidget(makeSectionTitle(tr("Try it")));
    auto* grid = new QGridLayout;
    grid->setColumnStretch(2, 1);
    grid->setHorizontalSpacing(fontMetrics().height() / 2);
    for (const auto& trial : services_.trials) addTrial(*grid, trial);
    layout.addLayout(grid);
    field_ = new QPlainTextEdit;
    field_->setTabChangesFocus(true);
    field_->setFixedHeight(6 * fontMetrics().lineSpacing());
    auto* caption = new QLabel(tr("&Type here:"));
    caption->setBuddy(field_);
    connect(field_, &QPlainTextEdit::textChanged, this, &WelcomeWindow::tickWhatAppeared);
    allDone_ = makeTextLabel();
    allDone_->setAlignment(Qt::AlignTrailing | Qt::AlignVCenter);
    auto* above = new QHBoxLayout;
    above->addWidget(caption);
    above->addWidget(allDone_, 1);
    layout.addLayout(above);
    layout.addWidget(field_);
}

void WelcomeWindow::addTrial(QGridLayout& grid, const WelcomeServices::Trial& trial) {
    const int row = grid.rowCount();
    auto* tick = new QLabel(QStringLiteral("○"));
    tick->setAccessibleName(tr("Not tried yet"));
    auto* abbreviation = new QLabel(toQString(trial.abbreviation));
    abbreviation->setTextFormat(Qt::PlainText);
    QFont font = abbreviation->font();
    font.setBold(true);
    abbreviation->setFont(font);
    grid.addWidget(tick, row, 0, Qt::AlignTop);
    grid.addWidget(abbreviation, row, 1, Qt::AlignTop);
    //: What stands before it is an abbreviation; %1 is its text.
    const QString becomes = trial.needsDelimiter ? tr("and a space become “%1”") : tr("becomes “%1”");
    grid.addWidget(makeTextLabel(becomes.arg(preview(trial.expansion))), row, 2, Qt::AlignTop);
    trials_.push_back({asInField(trial.expansion), tick});
}

void WelcomeWindow::tickWhatAppeared() {
    const QString text = field_->toPlainText();
    for (Trial& trial : trials_) {
        if (trial.isDone || trial.expansion.isEmpty() || !text.contains(trial.expansion)) continue;
        trial.isDone = true;
        trial.tick->setText(QStringLiteral("✓"));
        trial.tick->setAccessibleName(tr("Done"));
    }
    const bool isAllDone = std::all_of(trials_.begin(), trials_.end(), [](const Trial& trial) { return trial.isDone; });
    if (isAllDone) allDone_->setText(tr("That is all there is to it."));
}

// ---- Other libraries ----

void WelcomeWindow::addFoundLibraries(QVBoxLayout& layout) {
    layout.addSpacing(fontMetrics().height() / 2);
    layout.addWidget(makeSectionTitle(tr("Bring your snippets along")));
    layout.addWidget(makeTextLabel(tr("Snippets of other programs were found. Importing leaves them as they are.")));
    auto* grid = new QGridLayout;
    grid->setColumnStretch(0, 1);
    for (const auto& library : services_.foundLibraries) addFoundLibrary(*grid, library);
    layout.addLayout(grid);
}

void WelcomeWindow::addFoundLibrary(QGridLayout& grid, const WelcomeServices::FoundLibrary& library) {
    const int row = grid.rowCount();
    const QString name = toQString(library.name);
    QLabel* title = makeTextLabel(name + QLatin1Char('\n') + breakable(QString::fromStdString(library.path.string())));
    auto* button = new QPushButton(tr("Import"));
    button->setAutoDefault(false);
    button->setAccessibleName(tr("Import %1").arg(name));
    QLabel* outcome = makeTextLabel();
    outcome->hide();
    grid.addWidget(title, row, 0);
    grid.addWidget(button, row, 1, Qt::AlignTop);
    grid.addWidget(outcome, row + 1, 0, 1, 2);
    connect(button, &QPushButton::clicked, this, [this, library, button, outcome] {
        button->setEnabled(false);
        services_.import(library, [this, button = QPointer(button), outcome](const Result<std::string>& told) {
            if (!button) return;
            outcome->setText(inUsersLanguage(told ? told.value() : told.error().message));
            outcome->show();
            // A second time only when the first one failed: everything would be there twice.
            button->setEnabled(!told);
            if (told) button->setText(tr("Imported"));
            makeRoom();
        });
    });
}

// ---- How it is started ----

void WelcomeWindow::addStart(QVBoxLayout& layout) {
    layout.addSpacing(fontMetrics().height() / 2);
    startsAtLogin_ = new QCheckBox(tr("&Start Plume when I log in"));
    startsAtLogin_->setChecked(services_.startsAtLogin());
    connect(startsAtLogin_, &QCheckBox::toggled, this, &WelcomeWindow::setStartsAtLogin);
    layout.addWidget(startsAtLogin_);
    noIcon_ = makeTextLabel(
        tr("Your desktop has no place for Plume’s icon. To reach Plume, run “plume” again, or use its hot keys."));
    noIcon_->hide();
    layout.addWidget(noIcon_);
    auto* looking = new QTimer(this);
    connect(looking, &QTimer::timeout, this, &WelcomeWindow::lookForIcon);
    looking->start(BetweenLooks);
}

void WelcomeWindow::lookForIcon() {
    looksInVain_ = services_.hasIcon() ? 0 : looksInVain_ + 1;
    const bool tells = looksInVain_ >= LooksBeforeTelling;
    if (noIcon_->isVisible() == tells) return;
    noIcon_->setVisible(tells);
    makeRoom();
}

void WelcomeWindow::setStartsAtLogin(bool starts) {
    const auto done = services_.setStartsAtLogin(starts);
    if (done) return;
    const QSignalBlocker silence(startsAtLogin_);
    startsAtLogin_->setChecked(!starts);
    tell(this, tr("This could not be changed"), inUsersLanguage(done.error().message));
}

}  // namespace plume

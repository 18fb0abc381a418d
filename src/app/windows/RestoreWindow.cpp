#include "app/windows/RestoreWindow.h"

#include <QDateTime>
#include <QEvent>
#include <QFileDialog>
#include <QHBoxLayout>
#include <QLabel>
#include <QListView>
#include <QLocale>
#include <QPushButton>
#include <QStandardItemModel>
#include <QVBoxLayout>
#include <algorithm>
#include <numeric>
#include <string>

#include "app/qt/Labels.h"
#include "app/qt/Messages.h"
#include "app/qt/Sentences.h"
#include "app/qt/WindowPlaces.h"
#include "library/FileNameTime.h"

namespace plume {

namespace {

// As in the names of backups, so that all can be put into one order; empty when it is unknown.
std::string timeOf(const LibraryBackups::Backup& backup) {
    if (auto time = LibraryBackups::timeInName(backup.path.filename().string())) return *time;
    return backup.modified ? fileNameTime(*backup.modified) : std::string();
}

std::vector<LibraryBackups::Backup> newestFirst(std::vector<LibraryBackups::Backup> backups) {
    std::stable_sort(backups.begin(), backups.end(),
                     [](const auto& a, const auto& b) { return timeOf(a) > timeOf(b); });
    return backups;
}

QString titleOf(const LibraryBackups::Backup& backup) {
    const std::string name = backup.path.filename().string();
    const auto time = LibraryBackups::timeInName(name);
    const auto local =
        QDateTime::fromString(QString::fromStdString(time.value_or("")), QStringLiteral("yyyy-MM-dd HH-mm-ss"));
    if (!local.isValid()) return QString::fromStdString(name);
    return RestoreDataWindowController::tr("%1, %2").arg(QLocale().toString(local.date(), QLocale::LongFormat),
                                                         QLocale().toString(local.time(), QStringLiteral("HH:mm:ss")));
}

std::size_t snippetCount(const SnippetGroups& groups) {
    return std::accumulate(groups.begin(), groups.end(), std::size_t{0},
                           [](std::size_t sum, const auto& group) { return sum + group->items().size(); });
}

}  // namespace

RestoreDataWindowController::RestoreDataWindowController(DataManager& manager, const Files& files,
                                                         WritableUserDefaults& settings)
    : SmallWindow(tr("Restore")),
      manager_(manager),
      files_(files),
      model_(new QStandardItemModel(this)),
      list_(new QListView),
      nothing_(makeTextLabel()),
      restoreButton_(new QPushButton(tr("&Restore Backup"))) {
    makeLayout(settings);
    fill();
    list_->setFocus();
}

void RestoreDataWindowController::makeLayout(WritableUserDefaults& settings) {
    list_->setModel(model_);
    list_->setUniformItemSizes(true);
    list_->setSpacing(1);
    list_->setEditTriggers(QAbstractItemView::NoEditTriggers);
    list_->setAccessibleName(tr("Backups, newest first"));
    auto* caption = new QLabel(tr("&Backups of your snippets:"));
    caption->setBuddy(list_);
    auto* fileButton = new QPushButton(tr("Choose &File…"));
    restoreButton_->setDefault(true);
    connect(restoreButton_, &QPushButton::clicked, this, &RestoreDataWindowController::restoreSelected);
    connect(fileButton, &QPushButton::clicked, this, &RestoreDataWindowController::chooseFile);
    connect(list_, &QListView::doubleClicked, this, &RestoreDataWindowController::restoreSelected);
    connect(list_->selectionModel(), &QItemSelectionModel::selectionChanged, this,
            &RestoreDataWindowController::selectionChanged);
    auto* buttons = new QHBoxLayout;
    buttons->addWidget(fileButton);
    buttons->addStretch();
    buttons->addWidget(restoreButton_);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(makeTextLabel(tr(
        "Your snippets can be put back to what they were when a backup was made. What you have now is saved first.")));
    layout->addSpacing(layout->spacing());
    layout->addWidget(caption);
    nothing_->setAlignment(Qt::AlignCenter);
    layout->addWidget(nothing_, 1);
    layout->addWidget(list_, 1);
    layout->addLayout(buttons);
    const int em = fontMetrics().height();
    resize(26 * em, 22 * em);
    rememberPlace(*this, settings, "Restore");
}

void RestoreDataWindowController::changeEvent(QEvent* event) {
    SmallWindow::changeEvent(event);
    if (event->type() == QEvent::ActivationChange && isActiveWindow()) fill();
}

void RestoreDataWindowController::fill() {
    const auto selected = selectedBackup();
    model_->clear();
    paths_.clear();
    int row = 0;
    for (const auto& backup : newestFirst(manager_.backups().backups())) {
        if (backup.path == selected) row = model_->rowCount();
        paths_.push_back(backup.path);
        model_->appendRow(new QStandardItem(titleOf(backup)));
    }
    list_->setCurrentIndex(model_->index(row, 0));
    nothing_->setText(tr("There is no backup in %1 yet.")
                          .arg(breakable(QString::fromStdString(manager_.backups().directory().string()))));
    nothing_->setVisible(paths_.empty());
    list_->setVisible(!paths_.empty());
    selectionChanged();
}

void RestoreDataWindowController::selectionChanged() {
    restoreButton_->setEnabled(list_->selectionModel()->hasSelection());
}

void RestoreDataWindowController::restoreSelected() {
    if (const auto path = selectedBackup()) askAndRestore(*path);
}

std::optional<Files::Path> RestoreDataWindowController::selectedBackup() const {
    const int row = list_->currentIndex().row();
    return row < 0 ? std::nullopt : std::optional(paths_[static_cast<std::size_t>(row)]);
}

void RestoreDataWindowController::chooseFile() {
    auto* panel = new QFileDialog(this, tr("Select a .plume file to restore"), {}, tr("Plume libraries (*.plume)"));
    panel->setAttribute(Qt::WA_DeleteOnClose);
    panel->setFileMode(QFileDialog::ExistingFile);
    connect(panel, &QFileDialog::fileSelected, this,
            [this](const QString& path) { askAndRestore(path.toStdString()); });
    panel->open();
}

void RestoreDataWindowController::askAndRestore(const Files::Path& path) {
    if (!checkExists(path)) return;
    const auto count = static_cast<int>(snippetCount(manager_.snippetGroups()));
    const QString what = count == 1 ? tr("Your 1 snippet is replaced by what this backup holds:")
                                    : tr("Your %n snippets are replaced by what this backup holds:", "", count);
    ask(this, tr("Do you want to restore this backup?"),
        what + QStringLiteral("\n%1\n\n").arg(titleOf({path, std::nullopt})) +
            tr("Plume writes a backup of what you have now first."),
        tr("Replace My Snippets"), [this, path] { restore(path); });
}

void RestoreDataWindowController::restore(const Files::Path& path) {
    if (!checkExists(path)) return;
    const auto before = manager_.restoreFile(path);
    if (!before) {
        tell(this, tr("Error when restoring backup"), inUsersLanguage(before.error().message));
        return;
    }
    tell(nullptr, tr("Your snippets were restored"),
         tr("What you had before is in this backup: %1").arg(QString::fromStdString(before.value().string())));
    close();
}

bool RestoreDataWindowController::checkExists(const Files::Path& path) {
    if (files_.exists(path)) return true;
    tell(this, tr("Error when restoring backup"), tr("The selected backup file does not exist."));
    return false;
}

}  // namespace plume

#include "app/windows/FirstSyncWindow.h"

#include <QCloseEvent>
#include <QDialogButtonBox>
#include <QLabel>
#include <QPushButton>
#include <QRadioButton>
#include <QVBoxLayout>
#include <algorithm>
#include <filesystem>
#include <utility>

#include "app/qt/Labels.h"
#include "library/LibrarySync.h"

namespace plume {

namespace {

constexpr int LongestName = 14;  // in heights of a line

QString lastComponent(const std::string& folder) {
    const std::filesystem::path path(folder);
    // A path that ends with a slash has no file name.
    const auto& name = path.has_filename() ? path.filename() : path.parent_path().filename();
    return QString::fromStdString(name.string());
}

}  // namespace

InitalSyncWindowController::InitalSyncWindowController(const std::string& folder, std::function<void(int)> answer)
    : SmallWindow(tr("Synchronize Snippets")), answer_(std::move(answer)) {
    setObjectName(QStringLiteral("InitalSyncWindow"));
    const auto withFolder = [name = lastComponent(folder)](QString text) {
        return text.replace(QLatin1String("%@"), name);
    };
    // The name may be longer than a line, which a choice cannot break, and may hold what would be a mnemonic.
    const QString shortName =
        fontMetrics().elidedText(lastComponent(folder), Qt::ElideMiddle, LongestName * fontMetrics().height());
    const auto choice = [&](QString text) {
        return new QRadioButton(
            text.replace(QLatin1String("%@"), shortName).replace(QLatin1Char('&'), QLatin1String("&&")));
    };
    takeFolders_ = choice(tr("Use the snippets in “%@” on this computer"));
    replaceFolders_ = choice(tr("Replace the snippets in “%@” by those of this computer"));
    takeFolders_->setChecked(true);
    makeLayout(withFolder(tr("The folder “%@” holds snippets already")));
    showWhatWillHappen();
}

void InitalSyncWindowController::makeLayout(const QString& heading) {
    auto* buttons = new QDialogButtonBox;
    acceptButton_ = buttons->addButton(QString(), QDialogButtonBox::AcceptRole);
    acceptButton_->setDefault(true);
    buttons->addButton(tr("&Cancel"), QDialogButtonBox::RejectRole);
    connect(buttons, &QDialogButtonBox::accepted, this, &QDialog::accept);
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    connect(takeFolders_, &QRadioButton::toggled, this, [this] { showWhatWillHappen(); });

    auto* layout = new QVBoxLayout(this);
    layout->setSpacing(fontMetrics().height() / 2);
    layout->addWidget(makeHeading(heading));
    layout->addWidget(makeTextLabel(tr("Which snippets do you want to keep?")));
    layout->addWidget(takeFolders_);
    layout->addWidget(replaceFolders_);
    layout->addSpacing(layout->spacing());
    layout->addWidget(
        makeTextLabel(tr("The snippets that are replaced are not lost: Plume writes a backup of them first.")));
    layout->addStretch();
    layout->addWidget(buttons);
    fitTo(34 * fontMetrics().height());
    takeFolders_->setFocus();
}

void InitalSyncWindowController::showWhatWillHappen() {
    acceptButton_->setText(takeFolders_->isChecked() ? tr("&Use Folder’s Snippets") : tr("&Replace Folder’s Snippets"));
}

void InitalSyncWindowController::accept() {
    const int row = takeFolders_->isChecked() ? 0 : 1;
    returnCode_ = row + 1;
    close();
}

void InitalSyncWindowController::closeEvent(QCloseEvent* event) {
    SmallWindow::closeEvent(event);
    if (const auto answer = std::exchange(answer_, nullptr)) answer(returnCode_);
}

}  // namespace plume

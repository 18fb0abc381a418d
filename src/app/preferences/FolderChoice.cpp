#include "app/preferences/FolderChoice.h"

#include <QComboBox>
#include <QDir>
#include <QFileDialog>
#include <QLabel>
#include <QVBoxLayout>

#include "app/preferences/SettingControls.h"
#include "app/qt/Text.h"
#include "app/qt/WheelGuard.h"

namespace plume {

namespace {

enum class Kind { Default, Folder, Other };

constexpr int KindRole = Qt::UserRole;
constexpr int PathRole = Qt::UserRole + 1;

void add(QComboBox& box, const QString& text, Kind kind, const QString& path = {}) {
    box.addItem(text, int(kind));
    box.setItemData(box.count() - 1, path, PathRole);
}

}  // namespace

FolderChoice::FolderChoice(Offers offers, QWidget* parent) : QWidget(parent), box_(new QComboBox), path_(new QLabel) {
    ignoreWheelWithoutFocus(*box_);
    if (offers == Offers::DefaultToo) add(*box_, tr("Default Directory"), Kind::Default);
    // Names of folders, the same in every language.
    for (const char* name : {"Dropbox", "Google Drive", "SkyDrive", "Box Documents"}) {
        const QString path = QDir::home().filePath(QLatin1String(name));
        if (QDir(path).exists()) add(*box_, QLatin1String(name), Kind::Folder, path);
    }
    add(*box_, tr("Other Folder…"), Kind::Other);
    path_->setTextFormat(Qt::PlainText);
    path_->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Fixed);
    path_->setForegroundRole(QPalette::PlaceholderText);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->setSpacing(2);
    layout->addWidget(box_, 0, Qt::AlignLeft);
    layout->addWidget(path_);
    setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Preferred);
    setFocusProxy(box_);
    connect(box_, &QComboBox::activated, this, &FolderChoice::take);
    showState();
}

void FolderChoice::setFolder(const std::u16string& path, bool isDefault) {
    folder_ = toQString(path);
    isDefault_ = isDefault;
    showState();
}

void FolderChoice::setName(const QString& name) {
    box_->setAccessibleName(name);
}

void FolderChoice::showState() {
    const int index = isDefault_ ? box_->findData(int(Kind::Default)) : box_->findData(folder_, PathRole);
    const bool isListed = index >= 0 && !folder_.isEmpty();
    box_->setPlaceholderText(folder_.isEmpty() ? tr("Choose a folder") : tr("Another folder"));
    box_->setCurrentIndex(isListed ? index : -1);
    path_->setToolTip(folder_);
    path_->setVisible(!folder_.isEmpty());
    box_->setAccessibleDescription(folder_);
    showPath();
}

// A long path keeps its beginning and its end.
void FolderChoice::showPath() {
    path_->setText(path_->fontMetrics().elidedText(folder_, Qt::ElideMiddle, width()));
}

void FolderChoice::resizeEvent(QResizeEvent* event) {
    QWidget::resizeEvent(event);
    showPath();
}

void FolderChoice::take(int index) {
    switch (Kind(box_->itemData(index, KindRole).toInt())) {
        case Kind::Default:
            Q_EMIT defaultChosen();
            break;
        case Kind::Folder:
            Q_EMIT chosen(fromQString(box_->itemData(index, PathRole).toString()));
            break;
        case Kind::Other:
            chooseOther();
            break;
    }
}

void FolderChoice::chooseOther() {
    auto* dialog = new QFileDialog(window(), tr("Choose a Folder"), folder_.isEmpty() ? QDir::homePath() : folder_);
    dialog->setAttribute(Qt::WA_DeleteOnClose);
    dialog->setFileMode(QFileDialog::Directory);
    dialog->setOption(QFileDialog::ShowDirsOnly);
    connect(dialog, &QFileDialog::fileSelected, this,
            [this](const QString& path) { Q_EMIT chosen(fromQString(path)); });
    // Until then what holds is shown.
    showState();
    dialog->open();
}

}  // namespace plume

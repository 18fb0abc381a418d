#include "app/windows/FileUseQuestion.h"

#include <QCoreApplication>
#include <QMessageBox>
#include <QPushButton>
#include <utility>

#include "app/qt/Messages.h"
#include "app/windows/SmallWindow.h"

namespace plume {

namespace {

using FileUse = ApplicationWindows::FileUse;

class Texts {
    Q_DECLARE_TR_FUNCTIONS(plume::FileUseQuestion)
};

}  // namespace

QWidget* askForFileUse(const std::filesystem::path& file, std::function<void(FileUse)> answer) {
    const QString title = Texts::tr("Restore / Import data from %@")
                              .replace(QLatin1String("%@"), QString::fromStdString(file.filename().string()));
    QMessageBox* box = makeMessageBox(
        nullptr, title,
        Texts::tr("Restoring will replace all current snippets with snippets from the selected file.\r\n\r\nImporting "
                  "will add file's snippets to current snippets."));
    box->setWindowTitle(title);
    QPushButton* import = box->addButton(Texts::tr("Import"), QMessageBox::AcceptRole);
    const QPushButton* restore = box->addButton(Texts::tr("Restore"), QMessageBox::DestructiveRole);
    QPushButton* cancel = box->addButton(Texts::tr("Cancel"), QMessageBox::RejectRole);
    box->setDefaultButton(import);
    box->setEscapeButton(cancel);
    QObject::connect(box, &QMessageBox::finished, box, [box, import, restore, answer = std::move(answer)] {
        const auto* chosen = box->clickedButton();
        answer(chosen == import ? FileUse::Import : chosen == restore ? FileUse::Restore : FileUse::Nothing);
    });
    bringToFront(*box);
    return box;
}

}  // namespace plume

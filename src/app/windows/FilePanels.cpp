#include "app/windows/FilePanels.h"

#include <QCoreApplication>
#include <QFileDialog>
#include <QFileInfo>
#include <QStringList>
#include <array>
#include <utility>

#include "app/qt/Messages.h"
#include "app/windows/SmallWindow.h"
#include "import/Importers.h"

namespace plume {

namespace {

class Texts {
    Q_DECLARE_TR_FUNCTIONS(plume::FilePanels)
};

using Chosen = std::function<void(const std::filesystem::path&)>;

const QStringList& exportableExtensions() {
    static const QStringList extensions{QStringLiteral("plume"), QStringLiteral("csv"), QStringLiteral("json")};
    return extensions;
}

QFileDialog* makePanel(const QString& title, const QStringList& filters) {
    auto* panel = new QFileDialog(nullptr, title);
    panel->setAttribute(Qt::WA_DeleteOnClose);
    panel->setNameFilters(filters);
    panel->setWindowModality(Qt::NonModal);
    return panel;
}

void exportTo(const QString& path, const Chosen& chosen) {
    if (exportableExtensions().contains(QFileInfo(path).suffix().toLower())) return chosen(path.toStdString());
    tell(nullptr, Texts::tr("The snippets were not exported"),
         Texts::tr("%1: snippets can be written to files that end with .plume, .csv or .json.").arg(path));
}

}  // namespace

QWidget* askForLibraryFile(Chosen chosen) {
    QStringList patterns;
    for (const std::string& extension : importableExtensions()) {
        patterns += QStringLiteral("*.") + QString::fromStdString(extension);
    }
    QFileDialog* panel = makePanel(
        Texts::tr("Import Snippets"),
        {Texts::tr("Snippets of Plume and other programs (%1)").arg(patterns.join(u' ')), Texts::tr("All files (*)")});
    panel->setFileMode(QFileDialog::ExistingFile);
    panel->setLabelText(QFileDialog::Accept, Texts::tr("Choose"));
    QObject::connect(panel, &QFileDialog::fileSelected, panel,
                     [chosen = std::move(chosen)](const QString& path) { chosen(path.toStdString()); });
    bringToFront(*panel);
    return panel;
}

QWidget* askWhereToExport(Chosen chosen) {
    const QStringList filters{Texts::tr("Plume library (*.plume)"), Texts::tr("Comma-separated values (*.csv)"),
                              Texts::tr("Readable library (*.json)")};
    QFileDialog* panel = makePanel(Texts::tr("Export Snippets"), filters);
    panel->setAcceptMode(QFileDialog::AcceptSave);
    panel->setLabelText(QFileDialog::Accept, Texts::tr("Export"));
    panel->setDefaultSuffix(exportableExtensions().front());
    panel->selectFile(Texts::tr("My Snippets"));
    QObject::connect(panel, &QFileDialog::filterSelected, panel, [panel, filters](const QString& filter) {
        panel->setDefaultSuffix(exportableExtensions().value(filters.indexOf(filter)));
    });
    QObject::connect(panel, &QFileDialog::fileSelected, panel,
                     [chosen = std::move(chosen)](const QString& path) { exportTo(path, chosen); });
    bringToFront(*panel);
    return panel;
}

}  // namespace plume

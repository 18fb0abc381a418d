#include "app/editor/LibraryExportWindow.h"

#include <algorithm>
#include <utility>

#include "app/editing/ExportedFile.h"
#include "app/qt/Messages.h"
#include "app/qt/Sentences.h"
#include "app/qt/Text.h"
#include "library/LibraryExport.h"

namespace plume {

namespace {

constexpr qsizetype LongestName = 200;  // bytes; with an ending it fits every disk

// In the order of exportableExtensions().
QStringList exportFilters() {
    return {LibraryExportWindow::tr("Plume library (*.plume)"),
            LibraryExportWindow::tr("Comma-separated values (*.csv)"),
            LibraryExportWindow::tr("Readable library (*.json)"),
            LibraryExportWindow::tr("Rich text, to read and print (*.rtf)")};
}

QString endingOf(qsizetype filter) {
    const auto& endings = exportableExtensions();
    const auto at = static_cast<std::size_t>(std::max<qsizetype>(0, filter));
    return QString::fromStdString(endings.at(std::min(at, endings.size() - 1)));
}

// A name without what no name of a file can hold.
QString fileNameOf(QString name, const QString& otherwise) {
    name.replace(QLatin1Char('/'), QLatin1Char('-')).remove(QChar::Null);
    name = name.simplified();
    while (name.startsWith(QLatin1Char('.'))) name.remove(0, 1);
    while (name.toUtf8().size() > LongestName) name.chop(1);
    return name.isEmpty() ? otherwise : name;
}

LibraryExportWindow* opened(LibraryExportWindow* window) {
    window->open();
    return window;
}

}  // namespace

LibraryExportWindow::LibraryExportWindow(QWidget* parent, const QString& title, const QString& name, Write write)
    : QFileDialog(parent, title), write_(std::move(write)) {
    setAttribute(Qt::WA_DeleteOnClose);
    setAcceptMode(QFileDialog::AcceptSave);
    setLabelText(QFileDialog::Accept, tr("Export"));
    setNameFilters(exportFilters());
    setDefaultSuffix(endingOf(0));
    // With its ending: in a name with a dot the panel would see one already.
    selectFile(name + QLatin1Char('.') + endingOf(0));
    connect(this, &QFileDialog::filterSelected, this, &LibraryExportWindow::takeEnding);
    connect(this, &QFileDialog::fileSelected, this, &LibraryExportWindow::exportTo);
}

// For names without an ending; one that is there the panel changes itself.
void LibraryExportWindow::takeEnding(const QString& filter) {
    setDefaultSuffix(endingOf(nameFilters().indexOf(filter)));
}

void LibraryExportWindow::exportTo(const QString& path) {
    const std::filesystem::path file = path.toStdString();
    const Result<void> written = write_(file);
    if (written) return Q_EMIT exported(file);
    tell(parentWidget(), tr("The snippets were not exported"), inUsersLanguage(written.error().message));
}

// ---- What is exported ----

namespace {

Result<void> writeGroups(const SnippetGroups& groups, const std::filesystem::path& path, const DataManager& manager,
                         Files& files) {
    const auto bytes = exportedFile(groups, path, manager.library().dateInstalled);
    return bytes ? files.write(path, bytes.value()) : bytes.error();
}

}  // namespace

LibraryExportWindow* exportLibrary(QWidget* parent, DataManager& manager, Files& files) {
    const auto write = [&manager, &files](const std::filesystem::path& path) -> Result<void> {
        // With the identities that belong to a library.
        const bool isArchive = extensionOf(path.filename().string()) == "plume";
        if (isArchive) return files.write(path, manager.archivedDataIncludingPreferences(false));
        return writeGroups(manager.snippetGroups(), path, manager, files);
    };
    return opened(new LibraryExportWindow(parent, LibraryExportWindow::tr("Export All Snippets"),
                                          LibraryExportWindow::tr("My Snippets"), write));
}

LibraryExportWindow* exportGroup(QWidget* parent, DataManager& manager, Files& files,
                                 const std::shared_ptr<SnippetGroup>& group) {
    const QString name = toQString(group->name().value_or(u""));
    const auto write = [&manager, &files, group](const std::filesystem::path& path) {
        return writeGroups({group}, path, manager, files);
    };
    return opened(new LibraryExportWindow(parent, LibraryExportWindow::tr("Export the Group “%1”").arg(name),
                                          fileNameOf(name, LibraryExportWindow::tr("My Snippets")), write));
}

LibraryExportWindow* exportSelection(QWidget* parent, DataManager& manager, Files& files,
                                     const LibrarySelection& selection) {
    if (selection.isEmpty()) return nullptr;
    if (selection.snippets.empty() && selection.groups.size() == 1) {
        return exportGroup(parent, manager, files, selection.groups.front());
    }
    const SnippetGroups groups = groupsOfSelection(selection, manager.snippetGroups());
    const auto write = [&manager, &files, groups](const std::filesystem::path& path) {
        return writeGroups(groups, path, manager, files);
    };
    return opened(new LibraryExportWindow(parent, LibraryExportWindow::tr("Export the Selected Snippets"),
                                          LibraryExportWindow::tr("Selected Snippets"), write));
}

}  // namespace plume

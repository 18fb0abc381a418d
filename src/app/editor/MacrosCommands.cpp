// What the menus of the editor's window do.
#include <QAction>
#include <QApplication>
#include <QClipboard>
#include <QMenu>
#include <QMenuBar>
#include <QMimeData>
#include <QPointer>
#include <algorithm>
#include <array>

#include "app/editing/CopiedRows.h"
#include "app/editing/RowsAsText.h"
#include "app/editor/ImportWindow.h"
#include "app/editor/LibraryExportWindow.h"
#include "app/editor/MacrosWindowController.h"
#include "app/editor/OutlinePane.h"
#include "app/editor/OutlineView.h"
#include "app/qt/Messages.h"
#include "app/qt/Sentences.h"
#include "app/qt/Text.h"

namespace plume {

namespace {

std::size_t placeIn(const std::vector<std::shared_ptr<Snippet>>& items, const std::shared_ptr<Snippet>& snippet) {
    return static_cast<std::size_t>(std::ranges::find(items, snippet) - items.begin());
}

LibrarySelection copiesOf(const LibrarySelection& rows) {
    LibrarySelection copies;
    for (const auto& snippet : rows.snippets) copies.snippets.push_back(snippet->copySnippet());
    for (const auto& group : rows.groups) copies.groups.push_back(group->copySnippetGroup(true));
    return copies;
}

}  // namespace

// ---- Menus ----

void MacrosWindowController::makeMenus() {
    fillFileMenu(*menuBar()->addMenu(tr("&File")));
    fillEditMenu(*menuBar()->addMenu(tr("&Edit")));
    fillArrangeMenu(*menuBar()->addMenu(tr("&Library")));
    menus_.refresh();
}

void MacrosWindowController::fillFileMenu(QMenu& menu) {
    menus_.add(menu, tr("&New Snippet"), QKeySequence::New, [this] { newSnippet(); });
    menus_.add(menu, tr("New Snippet from Clip&board"), {}, [this] { newSnippetFromClipboard(); });
    menus_.add(menu, tr("New &Group"), QKeySequence(Qt::CTRL | Qt::SHIFT | Qt::Key_N), [this] { newGroup(); });
    menu.addSeparator();
    menus_.add(menu, tr("&Import…"), {}, [this] { askForImport(); });
    fillExportMenu(*menu.addMenu(tr("&Export")));
    menu.addSeparator();
    menus_.add(menu, tr("&Preferences…"), QKeySequence(Qt::CTRL | Qt::Key_Comma), services_.showPreferences);
    menus_.add(menu, tr("&Close"), QKeySequence(Qt::CTRL | Qt::Key_W), [this] { close(); });
    menus_.add(menu, tr("&Quit Plume"), QKeySequence(Qt::CTRL | Qt::Key_Q), services_.quit);
}

void MacrosWindowController::fillEditMenu(QMenu& menu) {
    QUndoStack& stack = undo_.stack();
    QAction* undo = menus_.add(menu, {}, QKeySequence::Undo, [this] {
        commitEdits();
        undo_.stack().undo();
    });
    QAction* redo = menus_.add(menu, {}, QKeySequence::Redo, [this] {
        commitEdits();
        undo_.stack().redo();
    });
    const auto name = [this, undo, redo] {
        const QUndoStack& all = undo_.stack();
        // What is being typed can be undone, too.
        undo->setText(all.canUndo() ? tr("&Undo %1").arg(all.undoText()) : tr("&Undo"));
        redo->setText(all.canRedo() ? tr("&Redo %1").arg(all.redoText()) : tr("&Redo"));
        redo->setEnabled(all.canRedo());
    };
    connect(&stack, &QUndoStack::indexChanged, this, name);
    name();
    menu.addSeparator();
    menus_.add(menu, tr("Cu&t"), QKeySequence::Cut, [this] { cut(); });
    menus_.add(menu, tr("&Copy"), QKeySequence::Copy, [this] { copy(); });
    menus_.add(menu, tr("&Paste"), QKeySequence::Paste, [this] { paste(); });
    menus_.add(menu, tr("Select &All"), QKeySequence::SelectAll, [this] { inField("selectAll"); });
    menu.addSeparator();
    const auto isSelected = [this] { return !selection().isEmpty(); };
    menus_.add(
        menu, tr("&Duplicate"), QKeySequence(Qt::CTRL | Qt::Key_D), [this] { duplicate(); }, isSelected);
    OutlineView& view = outline_->view();
    menus_.addFor(
        view, menu, tr("De&lete"), QKeySequence::Delete, [this] { removeSelection(); }, isSelected);
    menus_.addFor(
        view, menu, tr("Rena&me"), QKeySequence(Qt::Key_F2), [&view] { view.edit(view.currentIndex()); }, isSelected);
    menu.addSeparator();
    menus_.add(menu, tr("&Find"), QKeySequence::Find, [this] { outline_->focusFilter(); });
    menu.addMenu(&outline_->options());
    for (QAction* action : menu.actions()) view.addAction(action);
    view.setContextMenuPolicy(Qt::ActionsContextMenu);
}

void MacrosWindowController::fillArrangeMenu(QMenu& menu) {
    addSortCommands(*menu.addMenu(tr("&Sort Snippets")));
    menus_.add(menu, tr("Sort &Groups"), {}, [this] {
        commitEdits();
        editor_.sortGroups();
    });
    menu.addSeparator();
    addComingWithPlume(*menu.addMenu(tr("&Add")));
    menus_.add(menu, tr("&Delete Duplicated Snippets…"), {}, [this] { deleteDuplicatedSnippets(); });
}

void MacrosWindowController::addSortCommands(QMenu& menu) {
    const std::array names{tr("&None"),
                           tr("By &Abbreviation"),
                           tr("By &Label or Content"),
                           tr("By Date &Created"),
                           tr("By Date C&hanged"),
                           tr("By Last &Use")};
    for (std::size_t i = 0; i < names.size(); ++i) {
        QAction* action = menus_.add(menu, names.at(i), {}, [this, i] { sort(static_cast<SortBy>(i)); });
        action->setCheckable(true);
        action->setChecked(static_cast<SortBy>(i) == editor_.sortBy());
        sortOrders_.addAction(action);
    }
}

void MacrosWindowController::addComingWithPlume(QMenu& menu) {
    for (const std::string& name : BuiltInGroups::groupNames()) {
        menus_.add(menu, QString::fromStdString(name), {}, [this, name] {
            commitEdits();
            showAdded(builtIn_.addBuiltInGroup(name));
        });
    }
    menu.addSeparator();
    for (const std::string& language : BuiltInGroups::dictionaryLanguages()) {
        menus_.add(menu, tr("AutoCorrect Dictionary (%1)").arg(QString::fromStdString(language)), {}, [this, language] {
            commitEdits();
            showAdded(builtIn_.addAutoCorrectDictionary(language));
        });
    }
}

void MacrosWindowController::fillExportMenu(QMenu& menu) {
    menus_.add(
        menu, tr("&Selection…"), {},
        [this] {
            commitEdits();
            exportSelection(this, services_.dataManager, services_.files, selection());
        },
        [this] { return !selection().isEmpty(); });
    menus_.add(
        menu, tr("&Group…"), {},
        [this] {
            commitEdits();
            exportGroup(this, services_.dataManager, services_.files, outline_->view().currentGroup());
        },
        [this] { return outline_->view().currentGroup() != nullptr; });
    menus_.add(menu, tr("&All Groups…"), {}, [this] {
        commitEdits();
        exportLibrary(this, services_.dataManager, services_.files);
    });
}

// ---- Files ----

void MacrosWindowController::askForImport() {
    services_.askForFile([window = QPointer<MacrosWindowController>(this)](const std::filesystem::path& path) {
        if (window) window->importFile(path);
    });
}

void MacrosWindowController::importFile(const std::filesystem::path& path) {
    commitEdits();
    ImportWindow::Services services{.files = services_.files,
                                    .settings = services_.settings,
                                    .library = [this]() -> const SnippetGroups& { return editor_.groups(); },
                                    .import = [this](const ImportedLibrary& chosen) { importChosen(chosen); },
                                    .inBackground = services_.inBackground};
    (new ImportWindow(this, std::move(services), path))->open();
}

void MacrosWindowController::importChosen(const ImportedLibrary& chosen) {
    commitEdits();
    outline_->clearFilter();
    editor_.import(chosen);
    select({.groups = chosen.groups, .snippets = {}});
}

void MacrosWindowController::showAdded(const BuiltInGroups::Added& added) {
    if (!added) {
        tell(this, tr("Nothing was added."), inUsersLanguage(added.error().message));
        return;
    }
    outline_->clearFilter();
    select({.groups = {added.value()}, .snippets = {}});
    outline_->view().expand(outline_->view().currentIndex());
}

// ---- The library ----

std::pair<std::shared_ptr<SnippetGroup>, std::size_t> MacrosWindowController::placeForSnippets() {
    const LibrarySelection selected = selection();
    if (!selected.snippets.empty()) {
        const auto group = selected.snippets.back()->parentGroup();
        if (group) return {group, placeIn(group->items(), selected.snippets.back()) + 1};
    }
    auto group = selected.groups.empty() ? outline_->view().currentGroup() : selected.groups.back();
    if (!group && !editor_.groups().empty()) group = editor_.groups().front();
    if (!group) {
        group = SnippetGroup::make();
        group->setName(fromQString(tr("My Snippets")));
        editor_.insertGroups({group}, 0);
    }
    return {group, group->items().size()};
}

std::size_t MacrosWindowController::placeForGroups() const {
    const auto& groups = editor_.groups();
    const auto current = outline_->view().currentGroup();
    const auto found = std::ranges::find(groups, current);
    return static_cast<std::size_t>(found - groups.begin()) + (found == groups.end() ? 0 : 1);
}

void MacrosWindowController::newSnippet(const std::u16string& content) {
    commitEdits();
    outline_->clearFilter();
    const auto [group, at] = placeForSnippets();
    const auto snippet = std::make_shared<Snippet>(std::u16string(), content);
    snippet->setCaseSensitivity(group->caseSensitivity());
    editor_.insertSnippets({snippet}, group, at);
    edit(snippet);
}

void MacrosWindowController::newSnippetFromClipboard() {
    services_.placeholders.readClipboard(
        [window = QPointer<MacrosWindowController>(this)](const std::optional<std::u16string>& text) {
            if (window) window->newSnippet(text.value_or(u""));
        });
}

void MacrosWindowController::newGroup() {
    commitEdits();
    outline_->clearFilter();
    const auto group = SnippetGroup::make();
    group->setName(fromQString(tr("New Group")));
    editor_.insertGroups({group}, placeForGroups());
    select({.groups = {group}, .snippets = {}});
    outline_->view().startRenaming(*group);
}

void MacrosWindowController::duplicate() {
    commitEdits();
    outline_->clearFilter();
    const LibrarySelection copies = editor_.duplicate(selection());
    select(copies);
    if (copies.snippets.size() == 1 && copies.groups.empty()) snippet_->focusAbbreviation();
}

void MacrosWindowController::removeSelection() {
    commitEdits();
    const LibrarySelection removed = selection();
    if (removed.isEmpty()) return;
    // The row below them is the next one, so that many can be deleted one by one.
    OutlineView& view = outline_->view();
    const QModelIndex below = view.indexBelow(view.currentIndex());
    LibrarySelection next;
    if (auto snippet = outline_->model().snippetAt(below))
        next.snippets.push_back(std::move(snippet));
    else if (auto group = outline_->model().groupAt(below))
        next.groups.push_back(std::move(group));
    editor_.remove(removed);
    select(next);
}

void MacrosWindowController::sort(SortBy by) {
    commitEdits();
    editor_.sort(by);
}

void MacrosWindowController::deleteDuplicatedSnippets() {
    commitEdits();
    const auto found = editor_.duplicatedSnippets();
    std::size_t count = 0;
    for (const auto& find : found) count += find.others.size();
    if (count == 0) {
        tell(this, tr("There are no duplicated snippets."),
             tr("Duplicated are snippets with the same abbreviation and the same content."));
        return;
    }
    const QString question = tr("Are you sure you want to delete all (#) duplicated snippets?");
    ask(this, QString(question).replace(QLatin1String("(#)"), QStringLiteral("(%1)").arg(count)),
        tr("One of each stays. Undo brings them back as long as this window is open."), tr("Delete"), [this] {
            // The library may have become another one meanwhile.
            select({});
            editor_.deleteDuplicatedSnippets(editor_.duplicatedSnippets());
        });
}

void MacrosWindowController::rename(const QModelIndex& row, const QString& text) {
    if (const auto snippet = outline_->model().snippetAt(row)) {
        commitEdits();
        editor_.setSnippetAbbreviation(snippet, fromQString(text));
        snippet_->refresh();
    } else if (const auto group = outline_->model().groupAt(row)) {
        editor_.setName(group, fromQString(text));
    }
}

// ---- Dragged rows ----

void MacrosWindowController::drop(const LibrarySelection& rows, const std::shared_ptr<SnippetGroup>& group,
                                  std::size_t at, bool isCopy) {
    commitEdits();
    if (isCopy) return pasteRows(copiesOf(rows), group, at);
    if (group && !rows.snippets.empty()) editor_.moveSnippets(rows.snippets, group, at);
    if (!group && !rows.groups.empty()) editor_.moveGroups(rows.groups, at);
    select(rows);
}

void MacrosWindowController::dropText(const QString& text, const std::shared_ptr<SnippetGroup>& group, std::size_t at) {
    commitEdits();
    if (group) pasteRows({.groups = {}, .snippets = rowsFromText(fromQString(text))}, group, at);
}

// ---- The clipboard ----

bool MacrosWindowController::listHasKeyboard() const {
    return outline_->view().hasFocus();
}

void MacrosWindowController::inField(const char* method) {
    if (QWidget* field = focusWidget()) QMetaObject::invokeMethod(field, method);
}

void MacrosWindowController::copyRows() {
    const LibrarySelection rows = selection();
    if (rows.isEmpty()) return;
    // The clipboard takes it over.
    auto* mime = new QMimeData;  // NOLINT(cppcoreguidelines-owning-memory)
    mime->setData(QString::fromLatin1(OutlineModel::RowsType), QByteArray::fromStdString(archiveOfRows(rows)));
    std::vector<std::shared_ptr<Snippet>> snippets = rows.snippets;
    for (const auto& group : rows.groups) snippets.insert(snippets.end(), group->items().begin(), group->items().end());
    mime->setText(toQString(textFromRows(snippets)));
    QApplication::clipboard()->setMimeData(mime);
}

void MacrosWindowController::copy() {
    listHasKeyboard() ? copyRows() : inField("copy");
}

void MacrosWindowController::cut() {
    if (!listHasKeyboard()) return inField("cut");
    copyRows();
    removeSelection();
}

void MacrosWindowController::paste() {
    if (!listHasKeyboard()) return inField("paste");
    commitEdits();
    const QMimeData* mime = QApplication::clipboard()->mimeData();
    LibrarySelection rows;
    if (mime->hasFormat(QString::fromLatin1(OutlineModel::RowsType))) {
        const QByteArray bytes = mime->data(QString::fromLatin1(OutlineModel::RowsType));
        const auto read = rowsOfArchive({bytes.constData(), static_cast<std::size_t>(bytes.size())}, editor_.groups());
        if (!read)
            return say(
                tr("What the clipboard has could not be read: %1").arg(QString::fromStdString(read.error().message)));
        rows = read.value();
    } else {
        rows.snippets = rowsFromText(fromQString(mime->text()));
    }
    if (rows.isEmpty()) return;
    outline_->clearFilter();
    if (rows.snippets.empty()) return pasteRows(rows, nullptr, placeForGroups());
    const auto [group, at] = placeForSnippets();
    pasteRows(rows, group, at);
}

// Snippets into `group` before its place, groups before that of all groups, or behind all of them.
void MacrosWindowController::pasteRows(const LibrarySelection& rows, const std::shared_ptr<SnippetGroup>& group,
                                       std::size_t at) {
    if (group && !rows.snippets.empty()) editor_.insertSnippets(rows.snippets, group, at, EditKind::Copy);
    if (!rows.groups.empty()) editor_.insertGroups(rows.groups, group ? editor_.groups().size() : at, EditKind::Copy);
    select(rows);
}

}  // namespace plume

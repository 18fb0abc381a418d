#include "app/editor/MacrosWindowController.h"

#include <QCloseEvent>
#include <QLabel>
#include <QMenuBar>
#include <QSplitter>
#include <QStackedWidget>
#include <QVBoxLayout>
#include <algorithm>
#include <iterator>
#include <unordered_set>
#include <utility>

#include "app/editor/ContentPane.h"
#include "app/editor/GroupEditor.h"
#include "app/editor/OutlinePane.h"
#include "app/editor/OutlineView.h"
#include "app/editor/PreviewPane.h"
#include "app/qt/Labels.h"
#include "app/qt/Text.h"
#include "app/qt/WindowPlaces.h"

namespace plume {

namespace {

using namespace std::chrono_literals;

// What others change in one go is shown once.
constexpr auto ReloadDelay = 100ms;

// The record of the library that has its identity, be it another object by now.
template <typename Record>
std::shared_ptr<Record> living(const Record& record, const std::vector<std::shared_ptr<Record>>& records) {
    for (const auto& each : records) {
        if (each.get() == &record || (record.uuid() && each->uuid() == record.uuid())) return each;
    }
    return nullptr;
}

std::shared_ptr<Snippet> living(const Snippet& snippet, const SnippetGroups& groups) {
    for (const auto& group : groups) {
        if (auto found = living(snippet, group->items())) return found;
    }
    return nullptr;
}

// What lies between them stands in the list before and afterwards.
template <typename Record>
void addThoseThatCameOrWent(const LibraryChange::ListStep<Record>& step, std::vector<std::shared_ptr<Record>>& rows) {
    const auto addMissing = [&rows](const auto& from, const auto& in) {
        const std::unordered_set<std::shared_ptr<Record>> known(in.begin(), in.end());
        std::ranges::copy_if(from, std::back_inserter(rows), [&](const auto& each) { return !known.contains(each); });
    };
    addMissing(step.removed, step.added);
    addMissing(step.added, step.removed);
}

}  // namespace

MacrosWindowController::MacrosWindowController(EditorServices services)
    : services_(std::move(services)),
      editor_(services_.dataManager, [this](const LibraryChange& change) { changed(change); }),
      undo_(editor_),
      builtIn_(editor_, services_.files, services_.resources),
      menus_(this),
      sortOrders_(this),
      outline_(new OutlinePane(editor_, services_.settings)),
      pages_(new QStackedWidget),
      nothing_(makeTextLabel()),
      preview_(new PreviewPane({.groups = [this]() -> const SnippetGroups& { return editor_.groups(); },
                                .readClipboard = services_.placeholders.readClipboard,
                                .setExpandsInOwnWindows = services_.setExpandsInOwnWindows})),
      notice_(makeTextLabel()),
      columns_(new QSplitter),
      group_(new GroupEditor({editor_, services_.programs, services_.inputSources})) {
    setWindowTitle(tr("Snippets"));
    setAttribute(Qt::WA_DeleteOnClose);
    makePanes();
    makeMenus();
    reloadTimer_.setSingleShot(true);
    connect(&reloadTimer_, &QTimer::timeout, this, [this] {
        outline_->reload();
        snippet_->refresh();
        group_->refresh();
        preview_->showSoon();
    });
    connect(&undo_, &LibraryUndo::changed, this, &MacrosWindowController::undone);
    connect(&undo_, &LibraryUndo::refused, this, &MacrosWindowController::forgetEdits, Qt::QueuedConnection);
    connect(&outline_->view(), &OutlineView::selectionWasChanged, this, &MacrosWindowController::selectionWasChanged);
    connect(&outline_->model(), &OutlineModel::renamed, this, &MacrosWindowController::rename);
    connect(&outline_->model(), &OutlineModel::dropped, this, &MacrosWindowController::drop);
    connect(&outline_->model(), &OutlineModel::textDropped, this, &MacrosWindowController::dropText);
    connect(preview_, &PreviewPane::chosen, this, &MacrosWindowController::reveal);
    observeLibrary();
    selectionWasChanged();
    const int em = fontMetrics().height();
    resize(70 * em, 46 * em);
    columns_->setSizes({26 * em, 44 * em});
    columns_->setStretchFactor(1, 1);
    rememberPlace(*this, services_.settings, "Macros");
    outline_->view().setFocus();
}

// What the panes still tell while they go would find nobody.
MacrosWindowController::~MacrosWindowController() {
    commitEdits();
    if (QWidget* focus = focusWidget()) focus->clearFocus();
    outline_->view().disconnect(this);
    snippet_->disconnect(this);
}

// ---- What the window is made of ----

void MacrosWindowController::makePanes() {
    ChipFormServices placeholders = services_.placeholders;
    placeholders.groups = [this]() -> const SnippetGroups& { return editor_.groups(); };
    ScriptRunServices scripts = services_.scripts;
    scripts.groups = placeholders.groups;
    scripts.readClipboard = placeholders.readClipboard;
    snippet_ = new SnippetEditor(editor_, *new ContentPane(std::move(placeholders), std::move(scripts)));
    connect(snippet_, &SnippetEditor::typed, preview_, &PreviewPane::showSoon);
    nothing_->setAlignment(Qt::AlignCenter);
    nothing_->setMargin(2 * fontMetrics().height());
    pages_->addWidget(nothing_);
    auto* page = new QSplitter(Qt::Vertical);
    page->addWidget(snippet_);
    page->addWidget(preview_);
    page->setStretchFactor(0, 3);
    page->setStretchFactor(1, 1);
    page->setChildrenCollapsible(false);
    pages_->addWidget(page);
    pages_->addWidget(group_);
    notice_->setAccessibleName(tr("Notice"));
    notice_->setMargin(fontMetrics().height() / 2);
    notice_->hide();
    auto* right = new QWidget;
    auto* layout = new QVBoxLayout(right);
    layout->setContentsMargins({});
    layout->setSpacing(0);
    layout->addWidget(notice_);
    layout->addWidget(pages_, 1);
    columns_->addWidget(outline_);
    columns_->addWidget(right);
    columns_->setChildrenCollapsible(false);
    setCentralWidget(columns_);
}

void MacrosWindowController::openAllGroups() {
    outline_->view().openAll();
}

void MacrosWindowController::closeEvent(QCloseEvent* event) {
    commitEdits();
    outline_->keepOpenGroups();
    QMainWindow::closeEvent(event);
}

void MacrosWindowController::commitEdits() {
    snippet_->commit();
    group_->finish();
}

void MacrosWindowController::say(const QString& sentence) {
    notice_->setText(sentence);
    notice_->setVisible(!sentence.isEmpty());
}

// ---- What is selected ----

LibrarySelection MacrosWindowController::selection() const {
    return outline_->view().selection();
}

void MacrosWindowController::select(const LibrarySelection& rows) {
    outline_->view().select(rows);
}

void MacrosWindowController::edit(const std::shared_ptr<Snippet>& snippet) {
    reveal(snippet);
    if (snippet_->snippet()) snippet_->focusAbbreviation();
}

void MacrosWindowController::reveal(const std::shared_ptr<Snippet>& snippet) {
    const auto found = living(*snippet, editor_.groups());
    if (!found) return say(tr("This snippet is no longer in the library."));
    if (!outline_->model().indexOf(*found).isValid()) outline_->clearFilter();
    select({.groups = {}, .snippets = {found}});
}

void MacrosWindowController::selectionWasChanged() {
    const LibrarySelection selected = selection();
    const bool isOneSnippet = selected.snippets.size() == 1 && selected.groups.empty();
    const auto snippet = isOneSnippet ? selected.snippets.front() : nullptr;
    if (snippet != snippet_->snippet()) {
        undo_.endTyping();
        say({});
        snippet_->show(snippet);
        preview_->show(snippet);
    }
    const bool isOneGroup = selected.groups.size() == 1 && selected.snippets.empty();
    group_->show(isOneGroup ? selected.groups.front() : nullptr);
    if (snippet) {
        pages_->setCurrentIndex(1);
    } else if (isOneGroup) {
        pages_->setCurrentIndex(2);
    } else {
        showNothing(selected);
    }
    menus_.refresh();
}

void MacrosWindowController::showNothing(const LibrarySelection& selected) {
    if (editor_.groups().empty()) {
        nothing_->setText(tr("There are no snippets yet. Choose New Snippet in the menu File, or press Ctrl+N."));
    } else if (selected.isEmpty()) {
        nothing_->setText(tr("Select a snippet to see and change it."));
    } else {
        nothing_->setText(tr("Several rows are selected: they can be moved, copied, duplicated and deleted."));
    }
    pages_->setCurrentIndex(0);
}

// ---- Changes ----

void MacrosWindowController::changed(const LibraryChange& change) {
    undo_.push(change);
    showRows(change);
}

void MacrosWindowController::showRows(const LibraryChange& change) {
    if (change.changesLists()) {
        outline_->reload();
    } else {
        // The marks of other rows may have changed with an abbreviation; only what is seen is drawn.
        outline_->model().updateAll();
    }
    menus_.refresh();
}

void MacrosWindowController::undone(const LibraryChange& change) {
    showRows(change);
    // One that concerns all rows says nothing about where to look.
    const bool isOrder = change.kind == EditKind::Sorting || change.kind == EditKind::SortingOfGroups;
    LibrarySelection rows;
    for (const auto& step : change.snippets) rows.snippets.push_back(step.record);
    for (const auto& step : change.groups) rows.groups.push_back(step.record);
    for (const auto& step : change.items) addThoseThatCameOrWent(step.items, rows.snippets);
    addThoseThatCameOrWent(change.groupList, rows.groups);
    if (!isOrder && !rows.isEmpty()) select(rows);
    snippet_->refresh();
    group_->refresh();
    preview_->showSoon();
}

void MacrosWindowController::forgetEdits() {
    undo_.clear();
    say(tr("Your snippets were changed elsewhere meanwhile: this can no longer be undone."));
}

void MacrosWindowController::observeLibrary() {
    DataManager& library = services_.dataManager;
    for (auto* event : {&library.willClearDataEvent, &library.willSyncDataEvent}) {
        observers_.push_back(event->addObserver(this, &MacrosWindowController::libraryWillBeReplaced));
    }
    observers_.push_back(library.didSyncDataEvent.addObserver(this, &MacrosWindowController::libraryWasReplaced));
    observers_.push_back(library.didImportDataEvent.addObserver(this, &MacrosWindowController::libraryWasReplaced));
    observers_.push_back(library.didChangeDataEvent.addObserver(this, &MacrosWindowController::libraryChanged));
}

void MacrosWindowController::libraryWillBeReplaced(LibraryEvent& /*event*/) {
    replaced_ = selection();
    openEdit_ = snippet_->takeOpenEdit();
}

// The records are others, so that nothing that was done to the former ones can be undone.
void MacrosWindowController::libraryWasReplaced(LibraryEvent& /*event*/) {
    // Groups that were only added to it are rows that have changed.
    if (!replaced_) return;
    undo_.clear();
    editor_.reloadDuplicateManager();
    outline_->reload();
    const LibrarySelection before = *std::exchange(replaced_, std::nullopt);
    if (openEdit_) {
        keepOpenEdit(*std::exchange(openEdit_, std::nullopt));
    } else {
        selectWhatLives(before);
        say(tr("Your snippets were changed elsewhere and are shown as they are now."));
    }
}

// One row is found again by its identity; many are not looked for.
void MacrosWindowController::selectWhatLives(const LibrarySelection& before) {
    LibrarySelection now;
    if (before.snippets.size() == 1) {
        if (auto snippet = living(*before.snippets.front(), editor_.groups()))
            now.snippets.push_back(std::move(snippet));
    } else if (before.groups.size() == 1) {
        if (auto group = living(*before.groups.front(), editor_.groups())) now.groups.push_back(std::move(group));
    }
    select(now);
}

void MacrosWindowController::keepOpenEdit(const SnippetEditor::OpenEdit& edit) {
    auto snippet = living(*edit.edited, editor_.groups());
    if (snippet) {
        editor_.keepEdit(snippet, *edit.before, *edit.edited);
    } else {
        snippet = edit.edited;
        editor_.insertSnippets({snippet}, placeForSnippets().first, 0, EditKind::KeptEdit);
    }
    reveal(snippet);
    say(tr("Your snippets were changed elsewhere. What you were just editing was kept."));
}

void MacrosWindowController::libraryChanged(LibraryEvent& /*event*/) {
    if (!editor_.isChanging() && !reloadTimer_.isActive()) reloadTimer_.start(ReloadDelay);
}

}  // namespace plume

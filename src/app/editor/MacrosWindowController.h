// The editor: the window in which the user sees the whole library and changes it.
//
// On the main thread; owns itself, and is gone when it is closed. Nothing has to be saved: every change is in the
// library at once, and everything can be undone as long as the window is open and the library stays the same one.
#pragma once

#include <QActionGroup>
#include <QMainWindow>
#include <QTimer>
#include <memory>
#include <optional>
#include <vector>

#include "Foundation/Subscription.h"
#include "app/editing/BuiltInGroups.h"
#include "app/editor/EditorMenus.h"
#include "app/editor/EditorServices.h"
#include "app/editor/LibraryUndo.h"
#include "app/editor/SnippetEditor.h"

class QLabel;
class QSplitter;
class QStackedWidget;

namespace plume {

class GroupEditor;
class OutlinePane;
class PreviewPane;

class MacrosWindowController final : public QMainWindow {
    Q_OBJECT
  public:
    explicit MacrosWindowController(EditorServices services);
    ~MacrosWindowController() override;

    // Shows it in the list and in the editor, with the keyboard in its abbreviation.
    void edit(const std::shared_ptr<Snippet>& snippet);
    void openAllGroups();
    // Puts what is edited into the library.
    void commitEdits();

  protected:
    void closeEvent(QCloseEvent* event) override;

  private:
    // ---- What the window is made of ----
    void makePanes();
    void makeMenus();
    void fillFileMenu(QMenu& menu);
    void fillEditMenu(QMenu& menu);
    void fillArrangeMenu(QMenu& menu);
    void addSortCommands(QMenu& menu);
    void addComingWithPlume(QMenu& menu);
    void fillExportMenu(QMenu& menu);
    void observeLibrary();

    // ---- What is selected ----
    LibrarySelection selection() const;
    void selectionWasChanged();
    void reveal(const std::shared_ptr<Snippet>& snippet);
    void showNothing(const LibrarySelection& selected);
    void select(const LibrarySelection& rows);

    // ---- Changes ----
    void changed(const LibraryChange& change);
    void undone(const LibraryChange& change);
    void forgetEdits();
    void showRows(const LibraryChange& change);
    void libraryWillBeReplaced(LibraryEvent& event);
    void libraryWasReplaced(LibraryEvent& event);
    void libraryChanged(LibraryEvent& event);
    void selectWhatLives(const LibrarySelection& before);
    void keepOpenEdit(const SnippetEditor::OpenEdit& edit);

    // ---- Commands ----
    void newSnippet(const std::u16string& content = {});
    void newSnippetFromClipboard();
    void newGroup();
    void duplicate();
    void removeSelection();
    void deleteDuplicatedSnippets();
    void sort(SortBy by);
    void rename(const QModelIndex& row, const QString& text);
    void drop(const LibrarySelection& rows, const std::shared_ptr<SnippetGroup>& group, std::size_t at, bool isCopy);
    void dropText(const QString& text, const std::shared_ptr<SnippetGroup>& group, std::size_t at);

    // ---- Files ----
    void askForImport();
    void importFile(const std::filesystem::path& path);
    void importChosen(const ImportedLibrary& chosen);
    void showAdded(const BuiltInGroups::Added& added);

    // ---- The clipboard ----
    bool listHasKeyboard() const;
    // Does it in the field that has the keyboard.
    void inField(const char* method);
    void copyRows();
    void cut();
    void copy();
    void paste();
    void pasteRows(const LibrarySelection& rows, const std::shared_ptr<SnippetGroup>& group, std::size_t at);

    // Where new snippets go: behind what is selected. Makes a group when there is none.
    std::pair<std::shared_ptr<SnippetGroup>, std::size_t> placeForSnippets();
    std::size_t placeForGroups() const;
    void say(const QString& sentence);

    const EditorServices services_;
    LibraryEditor editor_;
    LibraryUndo undo_;
    BuiltInGroups builtIn_;
    EditorMenus menus_;
    QActionGroup sortOrders_;
    OutlinePane* outline_;
    QStackedWidget* pages_;
    QLabel* nothing_;
    SnippetEditor* snippet_ = nullptr;
    PreviewPane* preview_;
    QLabel* notice_;
    QSplitter* columns_;
    GroupEditor* group_;
    // While the library is being replaced: what was selected, and what was being typed.
    std::optional<LibrarySelection> replaced_;
    std::optional<SnippetEditor::OpenEdit> openEdit_;
    QTimer reloadTimer_;
    std::vector<Subscription> observers_;
};

}  // namespace plume

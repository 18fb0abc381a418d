// Undo and redo of everything that the editor does to the library.
//
// Owned by the editor's window, on the main thread. What is typed into one field without a longer pause is undone at
// once. Changes that others make to records stay as far as they concern other fields; when the library as a whole
// becomes another one, clear() is due.
#pragma once

#include <QUndoStack>
#include <chrono>

#include "app/editing/LibraryEditor.h"

namespace plume {

class LibraryUndo final : public QObject {
    Q_OBJECT
  public:
    // The editor outlives it.
    explicit LibraryUndo(LibraryEditor& editor);

    // What has been done already.
    void push(const LibraryChange& change);
    void clear() { stack_.clear(); }
    // What is typed from now on is undone by itself.
    void endTyping() { lastChange_ = {}; }
    QUndoStack& stack() { return stack_; }

    // After each undo and redo.
    Q_SIGNAL void changed(const LibraryChange& change);
    // Others have changed the lists that it was about: clear() is due, once the stack has returned.
    Q_SIGNAL void refused();

  private:
    LibraryEditor& editor_;
    QUndoStack stack_;
    std::chrono::steady_clock::time_point lastChange_;
};

// "Delete 3 Snippets", for menus.
QString nameOf(const LibraryChange& change);

}  // namespace plume

// All that one snippet is, to be changed: abbreviation, content, kind, label, note, case.
//
// On the main thread; the editor's window owns it, the LibraryEditor outlives it. There is nothing to save: what is
// typed is in the library a fifth of a second later, and at once by commit(), which is due before anything else is done
// with the library.
#pragma once

#include <QTimer>
#include <QWidget>
#include <chrono>
#include <memory>
#include <optional>

#include "app/editing/LibraryEditor.h"

class QFormLayout;
class QLabel;
class QLineEdit;
class QPlainTextEdit;

namespace plume {

class ChoiceBox;
class ContentPane;

class SnippetEditor final : public QWidget {
    Q_OBJECT
  public:
    // What has been typed lately: the record as it was before, and as it is in the window.
    struct OpenEdit {
        std::shared_ptr<const Snippet> before;
        std::shared_ptr<Snippet> edited;
    };

    SnippetEditor(LibraryEditor& editor, ContentPane& content);

    // Null shows nothing.
    void show(const std::shared_ptr<Snippet>& snippet);
    const std::shared_ptr<Snippet>& snippet() const { return snippet_; }
    // The record was changed elsewhere, or the library around it.
    void refresh();
    void commit();
    // For a library that is to be replaced: what was typed within the last seconds, which then is shown no longer.
    // Nothing when there is none.
    std::optional<OpenEdit> takeOpenEdit();
    void focusAbbreviation();
    ContentPane& content() { return content_; }

    // A letter was typed that the library does not know yet.
    Q_SIGNAL void typed();

  protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

  private:
    void makeForm(QFormLayout& form);
    void setFields();
    void edited();
    std::shared_ptr<Snippet> shownRecord() const;
    void showConflict();
    void showDates();
    void chooseKind();
    void chooseCase();

    LibraryEditor& editor_;
    ContentPane& content_;
    std::shared_ptr<Snippet> snippet_;
    std::shared_ptr<const Snippet> beforeTyping_;  // null: nothing was typed since it is shown
    std::chrono::steady_clock::time_point lastTyped_;
    QTimer commitTimer_;
    bool isTyped_ = false;  // what the library does not know yet
    bool isSetting_ = false;
    QLineEdit* abbreviation_;
    QLabel* conflict_;
    QLineEdit* label_;
    ChoiceBox* kind_;
    ChoiceBox* case_;
    QPlainTextEdit* note_;
    QLabel* dates_;
};

}  // namespace plume

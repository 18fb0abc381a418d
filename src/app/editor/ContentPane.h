// The content of a snippet in the editor that suits its kind: formatted or plain text with placeholders as chips, or a
// script with what it prints.
//
// On the main thread; the editor's window owns it.
#pragma once

#include <QWidget>
#include <functional>

#include "Foundation/text/AttributedString.h"
#include "app/editor/ChipForm.h"
#include "library/Snippet.h"

class QAction;
class QStackedWidget;
class QToolBar;

namespace plume {

class ContentEdit;
class FormatBar;
class ScriptEdit;

class ContentPane final : public QWidget {
    Q_OBJECT
  public:
    // What can be inserted, and forms of placeholders, need of the program; everything outlives the pane.
    explicit ContentPane(ChipFormServices services);

    // Tells nothing. What is equal at the beginning and the end stays with the caret where it is.
    void setContent(const AttributedString& content, ContentType type);
    AttributedString content() const;
    void setReadOnly(bool isReadOnly);
    // What stands beneath scripts.
    void setScriptPanel(QWidget* panel);
    void showInsertMenu();
    QAction& sourceAction() { return *source_; }

    Q_SIGNAL void edited();

  private:
    void makeBar();
    void insert(const std::u16string& body);
    void changeChip(const std::u16string& body);
    bool isScript() const;

    const ChipFormServices services_;
    ContentEdit* text_;
    FormatBar* format_;
    ScriptEdit* script_;
    QStackedWidget* stack_;
    QWidget* scriptPage_;
    QAction* insert_;
    QAction* source_;
};

}  // namespace plume

// The content of a snippet in the editor that suits its kind: formatted or plain text with placeholders as chips, or a
// script with what it prints.
//
// On the main thread; the editor's window owns it.
#pragma once

#include <QPointer>
#include <QWidget>
#include <memory>

#include "Foundation/text/AttributedString.h"
#include "app/editor/ChipFormServices.h"
#include "app/editor/ScriptRunPanel.h"
#include "library/Snippet.h"

class QAction;
class QStackedWidget;

namespace plume {

class ContentEdit;
class FormatBar;
class InsertMenu;
class ScriptEdit;

class ContentPane final : public QWidget {
    Q_OBJECT
  public:
    ContentPane(ChipFormServices placeholders, ScriptRunServices scripts);

    // Tells nothing. What is equal at the beginning and the end stays, with the caret where it is.
    void show(const std::shared_ptr<Snippet>& snippet);
    AttributedString content() const;
    void showInsertMenu();
    QAction& sourceAction() { return *source_; }

    Q_SIGNAL void edited();

  private:
    void makeBar();
    QRect caretOnScreen() const;
    ChipFormServices placeholderServices() const;
    void insert(const std::u16string& body);
    void changeChip(const std::u16string& body);
    bool isScript() const;

    ChipFormServices services_;
    ContentEdit* text_;
    FormatBar* format_;
    ScriptEdit* script_;
    QStackedWidget* stack_;
    ScriptRunPanel* run_;
    QWidget* scriptPage_;
    QPointer<InsertMenu> menu_;  // the one that was opened last
    QAction* insert_;
    QAction* source_;
};

}  // namespace plume

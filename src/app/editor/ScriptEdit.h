// Where the text of a script snippet is written: line numbers, colours, brackets that are shown in pairs, lines that
// begin below each other.
//
// On the main thread. Undoing is the window's: the editor keeps no changes of its own, and leaves the keys for it
// alone. Tab writes a tab; Ctrl+Tab, or Escape and then Tab, leaves.
#pragma once

#include <QPlainTextEdit>
#include <string>
#include <vector>

#include "Foundation/text/AttributedString.h"

namespace plume {

class LineNumbers;
class ScriptHighlighter;

class ScriptEdit final : public QPlainTextEdit {
    Q_OBJECT
  public:
    // A line on the screen; its place in the editor's viewport.
    struct VisibleLine {
        int number = 0;  // from 1
        int top = 0;
        int height = 0;
    };

    ScriptEdit();

    // Tells nothing. Where only something in the middle differs, the caret and what can be seen stay.
    void setContent(const AttributedString& content);
    // What was set, to the last unit, as long as nobody has changed it.
    AttributedString content() const;
    // Otherwise the first line says which language it is.
    void setAppleScript(bool isAppleScript);
    void insertPlaceholder(const std::u16string& body);

    // How to get out of it with the keyboard.
    static QString help();
    std::vector<VisibleLine> visibleLines() const;

    // The user has changed the text.
    Q_SIGNAL void edited();

  protected:
    bool event(QEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void changeEvent(QEvent* event) override;
    QMimeData* createMimeDataFromSelection() const override;
    void insertFromMimeData(const QMimeData* source) override;

  private:
    void noteChange();
    void takeTab(bool isForward);
    void shiftLines(bool isForward);
    void breakLine();
    void showBrackets();
    void placeLineNumbers();

    LineNumbers* lineNumbers_;
    ScriptHighlighter* highlighter_;
    AttributedString original_;
    bool isChanged_ = false;  // since it was set
    bool isSetting_ = false;
    bool leavesWithTab_ = false;
    QString told_;  // the document's text when a change was noted last
};

}  // namespace plume

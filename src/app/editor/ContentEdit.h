// The field in which a content is written, plain or rich, with its placeholders as chips or as they are written.
//
// On the main thread; its window owns it. It has no undo of its own: the keys for that are left to the window. Tab
// leaves the field, Ctrl+Tab types a tab.
#pragma once

#include <QTextCursor>
#include <QTextEdit>
#include <functional>
#include <optional>
#include <string>

#include "Foundation/text/AttributedString.h"
#include "app/editor/FileObject.h"
#include "app/editor/LookEditing.h"
#include "app/editor/PlaceholderChip.h"

namespace plume {

class ContentEdit final : public QTextEdit {
    Q_OBJECT
  public:
    explicit ContentEdit(ContentEnvironment environment = {});

    // Tells nothing. What is equal at the beginning and the end stays, with the caret and the place that is shown.
    void setContent(const AttributedString& content, bool isRich);
    // Takes time linear in the content.
    AttributedString content() const;
    bool isRich() const { return isRich_; }
    // Placeholders as they are written, or as chips again. The content is the same.
    void setShowsSource(bool showsSource);

    // In place of the selection, and of a 【 that was typed just now.
    void insertPlaceholder(const std::u16string& body);
    // In place of the chip that was activated last, while it is there.
    void replaceActivatedChip(const std::u16string& body);
    void pastePlain();

    // ---- The look of rich text ----
    // Each change is one edit of the selection; without one, of what is typed next.
    TextAttributes attributesAtCaret() const;
    void changeAttributes(const AttributesChange& change);
    ParagraphStyle styleAtCaret() const { return styleAt(textCursor()); }
    void changeStyle(const StyleChange& change);
    void toggleList(const std::u16string& markerFormat);
    // In place of the selection.
    void insertRich(const AttributedString& content);

    // By the user, as the others.
    Q_SIGNAL void edited();
    // A double click on a chip, or Return or Space with nothing else selected.
    Q_SIGNAL void chipActivated(const std::u16string& body);
    // The character 【.
    Q_SIGNAL void openingTyped();
    // The attributes or the paragraph at the caret may be others now.
    Q_SIGNAL void lookChanged();

  protected:
    bool event(QEvent* event) override;
    bool viewportEvent(QEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void inputMethodEvent(QInputMethodEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    void mouseDoubleClickEvent(QMouseEvent* event) override;
    void contextMenuEvent(QContextMenuEvent* event) override;
    QMimeData* createMimeDataFromSelection() const override;
    bool canInsertFromMimeData(const QMimeData* source) const override;
    void insertFromMimeData(const QMimeData* source) override;

  private:
    // As the document shows it.
    AttributedString shown(const AttributedString& content) const;
    void showContent(const AttributedString& shown);
    void insertShown(const AttributedString& content);
    void insertBody(QTextCursor& cursor, const std::u16string& body) const;
    void insertMimeContent(const QMimeData& source, bool asRich);

    bool takesKey(QKeyEvent& event);
    void markerTyped();
    void closingTyped(QTextCursor cursor);

    // Chips, by the position of their character.
    bool isChipAt(int position) const;
    std::optional<int> selectedChip() const;
    std::optional<int> chipUnder(QPoint place) const;
    QTextCursor selecting(int from, int to) const;
    QTextCharFormat formatAt(int position) const;
    void activateChip(int position);

    PlaceholderChip chips_;
    FileObject files_;
    bool isRich_ = false;
    bool showsSource_ = false;
    bool isLoading_ = false;
    QTextCursor opening_;    // selects the 【 that was typed last
    QTextCursor activated_;  // selects the chip that was activated last
};

}  // namespace plume

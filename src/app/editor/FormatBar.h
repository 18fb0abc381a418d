// The tool bar for the look of rich text: shows what is at the caret, and changes the selection.
//
// On the main thread; its window owns it. The field outlives it. Whoever shows plain text hides it.
#pragma once

#include <QToolBar>
#include <functional>
#include <optional>

#include "Foundation/text/TextAttributes.h"

class QAction;
class QComboBox;
class QFontComboBox;
class QMenu;

namespace plume {

class ContentEdit;

class FormatBar final : public QToolBar {
    Q_OBJECT
  public:
    explicit FormatBar(ContentEdit& edit);

    // Inserts a picture with these bytes.
    void insertPicture(const QString& fileName, const QByteArray& bytes);

  private:
    using Color = std::optional<ColorAttribute> TextAttributes::*;

    void addFontControls();
    void addLookActions();
    void addParagraphActions();
    void addInsertActions();
    QAction* addToggle(const QString& name, const QString& sign, const QKeySequence& shortcut = {});
    QAction* addCommand(const QString& name, const QString& sign, const QKeySequence& shortcut = {});
    QMenu* addMenuButton(const QString& name, const QString& sign);
    void addColorMenu(const QString& name, const QString& sign, Color color);
    void addAlignments();
    void setSignFont(QAction* action, const std::function<void(QFont& font)>& change);

    void changeFont(const std::function<void(FontAttribute& font)>& change);
    void setSize(const QString& text);
    void setColor(Color color, const std::optional<ColorAttribute>& value);
    void chooseColor(Color color);
    void askForLink();
    void setLink(const QString& address);
    void choosePicture();
    void clearFormats();
    void showState();

    ContentEdit& edit_;
    QFontComboBox* family_ = nullptr;
    QComboBox* size_ = nullptr;
    QAction* bold_ = nullptr;
    QAction* italic_ = nullptr;
    QAction* underline_ = nullptr;
    QAction* strike_ = nullptr;
    QAction* bullets_ = nullptr;
    QAction* numbers_ = nullptr;
    QList<QAction*> alignments_;  // in the order of TextAlignment, without the natural one
};

}  // namespace plume

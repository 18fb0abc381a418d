// The menu of everything that can be put into a content: a line to search in, and what was found.
//
// On the main thread; its parent owns it, and it can be opened again. The line keeps the keyboard: arrows move, Return
// chooses, Escape closes. Rows can be dragged out of it.
#pragma once

#include <QFrame>
#include <string>

#include "app/editor/ChipFormServices.h"

class QLabel;
class QLineEdit;
class QListView;

namespace plume {

class InsertModel;

class InsertMenu final : public QFrame {
    Q_OBJECT
  public:
    // The parent is the widget into which is inserted; forms that ask open at it.
    InsertMenu(ChipFormServices services, QWidget* parent);

    // With its corner there on the screen, or as near as the screen allows. The library is read anew.
    void open(const QPoint& corner);

    // The menu is gone by then. Rows that ask tell when their form was accepted.
    Q_SIGNAL void chosen(const std::u16string& body);

  protected:
    bool eventFilter(QObject* watched, QEvent* event) override;
    void hideEvent(QHideEvent* event) override;

  private:
    void search();
    bool moveBy(int key);
    void selectRow(int row);
    void choose(int row);
    void ask(const std::u16string& body);

    const ChipFormServices services_;
    InsertModel* model_;
    QLineEdit* query_;
    QListView* list_;
    QLabel* nothing_;
};

}  // namespace plume

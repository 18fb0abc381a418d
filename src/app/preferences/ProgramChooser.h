// A dialog in which programs are chosen from a list, with a line that narrows it down.
//
// Main thread; goes by itself when it is closed.
#pragma once

#include <QDialog>
#include <string>
#include <vector>

class QLabel;
class QLineEdit;
class QPushButton;
class QSortFilterProxyModel;
class QStandardItemModel;
class QTreeView;

namespace plume {

class ProgramCatalog;

class ProgramChooser final : public QDialog {
    Q_OBJECT
  public:
    using Identifiers = std::vector<std::u16string>;

    // The catalog outlives it. There is nothing to choose before setPrograms().
    ProgramChooser(const QString& title, ProgramCatalog& programs, QWidget* parent);

    void setPrograms(const Identifiers& identifiers);

  Q_SIGNALS:
    // At least one; the dialog is closing.
    void chosen(const Identifiers& identifiers);

  protected:
    bool eventFilter(QObject* object, QEvent* event) override;

  private:
    void choose();
    void updateButton();

    ProgramCatalog& programs_;
    QStandardItemModel* model_;
    QSortFilterProxyModel* shown_;
    QLineEdit* filter_;
    QTreeView* view_;
    QLabel* nothing_;
    QPushButton* add_;
};

}  // namespace plume

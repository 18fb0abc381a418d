// A list of programs that a setting names by their identifiers, to be added to and removed from.
//
// Main thread. What is in it is changed by the user alone, which is told, and by setIdentifiers(), which is not.
#pragma once

#include <QWidget>
#include <string>
#include <vector>

#include "app/preferences/ProgramServices.h"

class QLabel;
class QListView;
class QPushButton;
class QStandardItemModel;

namespace plume {

class ProgramCatalog;

class ApplicationList final : public QWidget {
    Q_OBJECT
  public:
    using Identifiers = std::vector<std::u16string>;

    // Both outlive it.
    ApplicationList(const ProgramServices& services, ProgramCatalog& programs, QWidget* parent = nullptr);

    // What it means to be in the list.
    void setTitle(const QString& title);
    void setIdentifiers(const Identifiers& identifiers);
    const Identifiers& identifiers() const { return identifiers_; }

  Q_SIGNALS:
    void edited(const Identifiers& identifiers);

  protected:
    bool eventFilter(QObject* object, QEvent* event) override;

  private:
    void addAll(const Identifiers& added);
    void removeSelected();
    void tell(const QString& words);

    ProgramCatalog& programs_;
    Identifiers identifiers_;
    QStandardItemModel* model_;
    QLabel* title_;
    QListView* view_;
    QPushButton* remove_;
    QLabel* words_;
};

}  // namespace plume

// The settings window: pages at the right, their list and a search at the left.
//
// Changes hold at once; what others change is seen at once. A page is made when it is first shown or searched. Main
// thread; goes when it is closed. The program around it shows one at a time.
#pragma once

#include <QWidget>
#include <string>
#include <vector>

#include "app/preferences/PageIcons.h"
#include "app/preferences/PreferencesPage.h"
#include "app/preferences/PreferencesServices.h"
#include "app/preferences/ProgramCatalog.h"

class QFrame;
class QLabel;
class QLineEdit;
class QListWidget;
class QListWidgetItem;
class QPushButton;
class QScrollArea;
class QStackedWidget;

namespace plume {

class PreferencesWindow final : public QWidget {
    Q_OBJECT
  public:
    // What the services refer to outlives it.
    explicit PreferencesWindow(PreferencesServices services, QWidget* parent = nullptr);
    ~PreferencesWindow() override;

    // "General", "Expansion", "Search", "Typing", "Correction", "HotKeys", "Applications", "Backups", "ImportExport" or
    // "Advanced"; an empty name: the page that was seen last. Another name leaves the page as it is.
    void showPage(const std::string& name);

  protected:
    void closeEvent(QCloseEvent* event) override;
    bool eventFilter(QObject* object, QEvent* event) override;

  private:
    struct Page {
        const char* name;
        QString title;
        PageIcon icon;
        PreferencesPage* (*make)(const PreferencesPage::Around&);
        QScrollArea* area = nullptr;
        PreferencesPage* page = nullptr;  // null: not made yet
    };

    void addPages();
    QWidget* makeSide();
    QWidget* makeContent();
    void makeShortcuts();
    PreferencesPage& made(std::size_t place);
    void showAt(std::size_t place);
    void search(const QString& words);
    void listHits(const QStringList& words);
    void chooseHit(const QListWidgetItem* hit);
    void reveal(std::size_t place, const PreferencesPage::Row& row);
    void complain(const QString& reason);
    void askToRestore();
    void settingsChanged(UserDefaultsChange& change);

    const PreferencesServices services_;
    ProgramCatalog programs_;
    std::vector<Page> pages_;
    std::size_t current_ = 0;
    QLineEdit* search_ = nullptr;
    QStackedWidget* side_ = nullptr;
    QListWidget* list_ = nullptr;
    QListWidget* hits_ = nullptr;
    QLabel* noHit_ = nullptr;
    QFrame* complaint_ = nullptr;
    QLabel* complaintText_ = nullptr;
    QStackedWidget* content_ = nullptr;
    QPushButton* restore_ = nullptr;
    Subscription changed_;
};

}  // namespace plume

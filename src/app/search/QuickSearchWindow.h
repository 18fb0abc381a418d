// The window in which the user searches the library and picks a snippet: a field, what was found, and how the selected
// snippet will come out.
//
// On the main thread; whoever puts the application together owns it. The library and the settings outlive it.
#pragma once

#include <QFrame>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "app/ContentPreview.h"
#include "app/QuickSearchView.h"
#include "app/ranking/SnippetRanking.h"

class QLabel;
class QLineEdit;
class QListView;
class QMenu;
class QStackedWidget;
class QToolButton;

namespace plume {

class QuickSearchModel;
class SnippetPreview;

// What it needs of the program around it; everything is called on the main thread and outlives it.
struct QuickSearchServices {
    std::function<const SnippetGroups&()> groups;
    WritableUserDefaults& settings;
    const SnippetUses* uses = nullptr;  // null: nobody counts
    // Into the program that had the keyboard. The window is gone.
    std::function<void(const std::shared_ptr<Snippet>&)> send;
    // The window is gone.
    std::function<void(const std::shared_ptr<Snippet>&)> edit;
    // The rows that digits pick are these now.
    std::function<void(const std::vector<std::shared_ptr<Snippet>>&)> setFirstRows;
    // What the user has on the clipboard.
    std::function<void(std::function<void(const std::optional<std::u16string>&)> told)> readClipboard;
};

class QuickSearchWindow final : public QFrame, public QuickSearchView {
    Q_OBJECT
  public:
    explicit QuickSearchWindow(QuickSearchServices services);
    ~QuickSearchWindow() override;

    void setEvents(Events events) override { events_ = std::move(events); }
    void show(const QuickSearchOpening& opening) override;
    // Without telling anybody.
    void close() override;

  protected:
    bool eventFilter(QObject* watched, QEvent* event) override;
    // By the window manager.
    void closeEvent(QCloseEvent* event) override;

  private:
    void makeField();
    void makeList();
    void makeOptions();
    void makeMenu();
    void addFieldAction(QMenu& menu, std::int64_t field, const QString& text);
    void addWildcardAction(QMenu& menu);
    SearchRule rule() const;

    void readClipboard();
    void search();
    void currentChanged();
    void tellPlace();

    bool keyPressed(const QKeyEvent& key);
    bool commandPressed(const QKeyEvent& key);
    bool digitPressed(const QKeyEvent& key);
    bool moveBy(int key);
    void selectRow(int row, int direction);

    std::shared_ptr<Snippet> current() const;
    void send(const std::shared_ptr<Snippet>& snippet);
    void copy();
    void edit();
    void dismiss();
    void disappear();

    const QuickSearchServices services_;
    Events events_;
    SnippetRanking ranking_;
    std::int64_t selectorKeyModifier_ = 0;
    QuickSearchModel* model_;
    QLineEdit* query_;
    QToolButton* options_;
    QListView* list_;
    QStackedWidget* results_;
    QLabel* nothing_;
    SnippetPreview* preview_;
    QMenu* menu_ = nullptr;
    QTimer* release_;
};

}  // namespace plume

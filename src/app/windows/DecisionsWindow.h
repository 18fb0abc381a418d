// "Why Didn't It Expand?": what became lately of the abbreviations that were typed, and what can be done about it.
//
// Made when it is asked for, and deletes itself when it is closed. Belongs to the main thread. It asks anew whenever it
// comes to the front; answers may come late, also when it is gone.
#pragma once

#include <functional>
#include <vector>

#include "app/windows/SmallWindow.h"
#include "engine/MatchDecision.h"
#include "platform/UserDefaults.h"

class QLabel;
class QModelIndex;
class QPushButton;
class QStackedWidget;
class QStandardItemModel;
class QTreeView;

namespace plume {

class DecisionsWindow final : public SmallWindow {
    Q_OBJECT

  public:
    // What the window needs of the engine; called on the main thread.
    struct Services {
        // Calls `told` once, on the main thread, with the newest decision last.
        std::function<void(std::function<void(std::vector<MatchDecision>)> told)> ask;
        // What is asked for afterwards does not hold what was there before.
        std::function<void()> forget;
    };

    // The settings outlive the window.
    DecisionsWindow(Services services, WritableUserDefaults& settings);

  protected:
    void showEvent(QShowEvent* event) override;
    bool event(QEvent* event) override;

  private:
    QWidget* makeList();
    QWidget* makeExplanation();
    static QWidget* makeEmptyPage();
    QLayout* makeButtons();

    void ask();
    void forget();
    void take(std::vector<MatchDecision> decisions);
    void fillList();
    void fitColumns();
    void explain(const QModelIndex& row);

    Services services_;
    std::vector<MatchDecision> decisions_;  // the newest first, as they are listed
    QStandardItemModel* model_;
    QStackedWidget* pages_;
    QTreeView* list_;
    QLabel* explanation_;
    QPushButton* forgetButton_;
    QPushButton* refreshButton_;
};

}  // namespace plume

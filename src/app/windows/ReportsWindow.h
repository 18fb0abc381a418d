// What Plume has told lately, the newest first, each with what can be done about it; follows the log while it is open.
//
// On the main thread; owns itself, and is gone when it is closed. The log outlives it.
#pragma once

#include <cstdint>

#include "app/ReportLog.h"
#include "app/windows/SmallWindow.h"
#include "platform/UserDefaults.h"

class QLabel;
class QPushButton;
class QStandardItemModel;
class QTreeView;

namespace plume {

class ReportsWindow final : public SmallWindow {
    Q_OBJECT
  public:
    ReportsWindow(ReportLog& log, WritableUserDefaults& settings);

  private:
    void makeList();
    void makeLayout(WritableUserDefaults& settings);
    void logChanged(ReportLogEvent& event);
    void fill();
    void addRow(const LoggedReport& report);
    void copyAll();
    void runAction(std::uint64_t number);

    ReportLog& log_;
    QStandardItemModel* model_;
    QTreeView* list_;
    QLabel* nothing_;
    QPushButton* copyButton_;
    QPushButton* clearButton_;
    Subscription subscription_;
};

}  // namespace plume

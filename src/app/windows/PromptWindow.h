// Tells that the desktop lacks something that Plume needs, and looks again when the user has put it right.
//
// On the main thread; owns itself, and is gone when it is closed.
#pragma once

#include <QTimer>
#include <functional>

#include "Foundation/Result.h"
#include "app/windows/SmallWindow.h"

class QLabel;
class QPushButton;

namespace plume {

class PromptWindow final : public SmallWindow {
    Q_OBJECT
  public:
    // `closed` is called once, when the user has closed the window, or all was well and it has closed itself.
    PromptWindow(const Error& missing, std::function<Result<void>()> checkAgain, std::function<void()> closed);

  protected:
    void closeEvent(QCloseEvent* event) override;

  private:
    void check();
    void showThatAllIsWell();

    std::function<Result<void>()> checkAgain_;
    std::function<void()> closed_;
    QLabel* heading_;
    QLabel* missing_;
    QLabel* advice_;
    QPushButton* checkButton_;
    QPushButton* closeButton_;
    QTimer closeTimer_;  // once everything is there
};

}  // namespace plume

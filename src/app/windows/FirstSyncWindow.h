// Which library is to be kept when synchronisation begins and the folder holds one already.
//
// On the main thread; owns itself, and is gone when it is answered.
#pragma once

#include <functional>
#include <string>

#include "app/windows/SmallWindow.h"

class QPushButton;
class QRadioButton;

namespace plume {

class InitalSyncWindowController final : public SmallWindow {
    Q_OBJECT
  public:
    // `folder` is a name or a path. `answer` is called once, with a LibrarySync::ReturnCode; closing is cancelling.
    InitalSyncWindowController(const std::string& folder, std::function<void(int returnCode)> answer);

  protected:
    void closeEvent(QCloseEvent* event) override;

  private:
    void accept() override;
    void makeLayout(const QString& heading);
    void showWhatWillHappen();

    std::function<void(int)> answer_;
    int returnCode_ = 0;
    QRadioButton* takeFolders_;
    QRadioButton* replaceFolders_;
    QPushButton* acceptButton_;
};

}  // namespace plume

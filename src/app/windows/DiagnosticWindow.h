// Shows a report about the state of Plume, to be sent to who can help.
//
// On the main thread; owns itself, and is gone when it is closed.
#pragma once

#include "app/windows/SmallWindow.h"

class QLabel;
class QPlainTextEdit;

namespace plume {

class DiagnosticWindow final : public SmallWindow {
    Q_OBJECT
  public:
    explicit DiagnosticWindow(const QString& report);

    void setReport(const QString& report);
    // In the middle of the screen, before all others.
    void showCentred();

  private:
    void copy();
    void chooseFile();
    void saveTo(const QString& path);

    QPlainTextEdit* text_;
    QLabel* done_;  // what was done last
};

}  // namespace plume

// What the application's smaller windows have in common.
//
// On the main thread. A window is made when it is asked for, shown by bringToFront() and gone when it is closed.
#pragma once

#include <QDialog>

namespace plume {

// Closes with Escape and Ctrl+W, in one way alone: by closeEvent(), which remembers places too. Owns itself.
class SmallWindow : public QDialog {
    Q_OBJECT
  public:
    explicit SmallWindow(const QString& title);

    void reject() override { close(); }

  protected:
    // So wide, and as high as the texts need it then.
    void fitTo(int width);
    // QDialog's own would reject once more.
    void closeEvent(QCloseEvent* event) override;
};

// Shows the window, also when it is minimised or behind others. One that opens is no larger than the screen.
void bringToFront(QWidget& window);

}  // namespace plume

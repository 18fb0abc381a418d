// A frame around a control for a moment, so that the eye finds what was searched for.
//
// Main thread. It lets everything through, and goes by itself.
#pragma once

#include <QTimer>
#include <QWidget>

namespace plume {

class SettingMark final : public QWidget {
    Q_OBJECT
  public:
    // In place of one that is still there around another control of this page.
    static void show(QWidget& control, QWidget& page);

  protected:
    void paintEvent(QPaintEvent* event) override;

  private:
    explicit SettingMark(QWidget& page);

    QTimer end_;
};

}  // namespace plume

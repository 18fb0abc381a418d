// The numbers beside the lines of a script.
//
// On the main thread; belongs to the editor that it stands in, which tells it when to paint.
#pragma once

#include <QWidget>

namespace plume {

class ScriptEdit;

class LineNumbers final : public QWidget {
    Q_OBJECT
  public:
    explicit LineNumbers(ScriptEdit& edit);

    // Wide enough for the last number.
    QSize sizeHint() const override;

  protected:
    void paintEvent(QPaintEvent* event) override;
    // A click beside a line puts the caret into it.
    void mousePressEvent(QMouseEvent* event) override;

  private:
    ScriptEdit& edit_;
};

}  // namespace plume

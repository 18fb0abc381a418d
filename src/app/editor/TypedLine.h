// A line that is told when it is finished: when it is left, on Return, and half a second after the last key.
//
// Main thread.
#pragma once

#include <QLineEdit>
#include <QTimer>
#include <string>

namespace plume {

class TypedLine final : public QLineEdit {
    Q_OBJECT
  public:
    explicit TypedLine(QWidget* parent = nullptr);

    // Nothing is told of this. What is being typed stays while the text is the one that was shown before.
    void showText(const std::u16string& text);
    // Tells what has not been told yet.
    void finish();

    Q_SIGNAL void edited(const std::u16string& text);
    // After what was typed has been told; not when only a menu of its own opens.
    Q_SIGNAL void left();

  protected:
    void focusOutEvent(QFocusEvent* event) override;

  private:
    QTimer pause_;
    std::u16string held_;
};

}  // namespace plume

// What the controls of the settings window have in common.
//
// Main thread.
#pragma once

#include <QPlainTextEdit>
#include <QTimer>
#include <string>

namespace plume {

// Several lines of a text. What is typed is told a moment later, and at once when the field is left.
class LinesEdit final : public QPlainTextEdit {
    Q_OBJECT
  public:
    explicit LinesEdit(QWidget* parent = nullptr);

    // Nothing is told of this.
    void showText(const std::u16string& text);
    // Tells what has not been told yet.
    void finish();

  Q_SIGNALS:
    void edited(const std::u16string& text);

  protected:
    void focusOutEvent(QFocusEvent* event) override;

  private:
    void tell();

    QTimer pause_;
    std::u16string held_;
    bool showing_ = false;
};

}  // namespace plume

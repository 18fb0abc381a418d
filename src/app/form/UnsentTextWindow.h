// Keeps a text that could not be sent: says why, and lets the user copy it or have it tried again.
//
// On the main thread. Does not take the keyboard by itself. Ends without an event when it is destroyed; any of its
// actions may destroy it.
#pragma once

#include <QDialog>
#include <deque>
#include <functional>
#include <string>

class QLabel;
class QPushButton;

namespace plume {

class UnsentTextWindow final : public QDialog {
    Q_OBJECT
  public:
    struct Actions {
        std::function<void()> copy;
        std::function<void()> tryAgain;
        // The user has closed it: the text is not wanted any more.
        std::function<void()> drop;
    };

    // `text` is shown as far as there is room; `reason` is one sentence in English.
    UnsentTextWindow(const std::u16string& text, const std::string& reason, Actions actions);

    // Escape. Asks once whether a text of which there is no copy is to be lost.
    void reject() override;

  protected:
    void closeEvent(QCloseEvent* event) override;

  private:
    static QWidget* makeTextBox(const std::u16string& text);
    QWidget* makeButtons();
    void copy();
    void tell(const QString& remark);
    void end(std::function<void()> action);
    // Actions are performed from the event loop, in their order.
    void post(std::function<void()> action);
    Q_INVOKABLE void perform();

    Actions actions_;
    QLabel* remark_;  // what has just happened, or is asked
    QPushButton* copyButton_;
    bool isSafe_ = false;  // the text may be lost: it was copied, or the user has been asked
    bool isEnded_ = false;
    std::deque<std::function<void()>> posted_;
};

}  // namespace plume

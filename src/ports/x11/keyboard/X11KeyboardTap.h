// The keyboard tap on X11: takes the hardware keyboards from the server and gives their keys back through XTEST.
//
// Each hardware keyboard is grabbed by itself, so that its keys reach nobody, the window with the focus keeps the
// focus, and no program notices; a key that passes is pressed again on the XTEST keyboard, which stands in for the
// hardware with the window manager, with grabs and with auto-repeat. Keys are decoded here, without asking the server.
#pragma once

#include <functional>
#include <memory>
#include <string>

#include "platform/KeyboardTap.h"
#include "ports/posix/PollRunLoop.h"
#include "ports/x11/keyboard/TapConnection.h"
#include "ports/x11/keyboard/TapSession.h"
#include "ports/x11/keyboard/XkbKeyboard.h"

namespace plume {

class X11KeyboardTap final : public KeyboardTap {
  public:
    // All of them outlive the tap. Nothing happens before create().
    X11KeyboardTap(PollRunLoop& loop, TapConnection& connection, XkbKeyboard& keyboard);
    ~X11KeyboardTap() override;
    X11KeyboardTap(const X11KeyboardTap&) = delete;
    X11KeyboardTap& operator=(const X11KeyboardTap&) = delete;

    // Asked for every key, so they must be quick. In a password, and while another program holds the keyboard, keys
    // pass unheard; where the focus has moved by itself, what was typed before is no part of an abbreviation any more.
    void setFocusQuestions(FocusQuestions questions);
    // Where text is composed; null: nowhere. It outlives the tap.
    void setInputMethod(InputMethod* inputMethod) { inputMethod_ = inputMethod; }
    // What it tells is there to take.
    void inputMethodTold();
    // Keys that type text would be composed, whoever presses them.
    bool composesKeys() const { return inputMethod_ != nullptr && inputMethod_->takesText(); }
    // Told of every press that passes, also of those that pass unheard; it must be quick, too.
    void setUserTyped(UserTyped userTyped);

    Result<void> create(KeyboardTapListener& listener, bool annotatedSession) override;
    bool exists() const override;
    void enable() override;
    void remove() override;
    Result<void> check() const override;

    // From hold() to release(), at most 2 seconds, the user's keys wait, with the one that the listener is deciding
    // about if it passes; then they follow in order.
    void hold();
    void release();
    // Goes on holding for 2 seconds, unless the user clicks, or presses a key with Alt or Super.
    void keepHolding();
    // To be told of clicks.
    void userClicked();

  private:
    Result<void> begin();
    void keyboardChanged(const XkbKeyboard::Change& change);
    void lost();
    void tryAgainLater();

    PollRunLoop& loop_;
    TapConnection& connection_;
    XkbKeyboard& keyboard_;
    const std::string display_;
    FocusQuestions focus_;
    UserTyped userTyped_;
    InputMethod* inputMethod_ = nullptr;
    KeyboardTapListener* listener_ = nullptr;
    EventFlags toldFlags_;                 // the modifiers that the listener takes to be held, across sessions
    std::shared_ptr<TapSession> session_;  // while the keyboards are taken
    Timer nextTry_;
    Subscription keyboardChanged_;
};

}  // namespace plume

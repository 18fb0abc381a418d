#include "ports/x11/keyboard/X11KeyboardTap.h"

#include <utility>

namespace plume {

namespace {

constexpr double TryPeriod = 1;  // seconds

}  // namespace

X11KeyboardTap::X11KeyboardTap(PollRunLoop& loop, TapConnection& connection, XkbKeyboard& keyboard)
    : loop_(loop), connection_(connection), keyboard_(keyboard), display_(connection.connection().displayName()) {
    keyboardChanged_ = keyboard.changedEvent.addObserver(this, &X11KeyboardTap::keyboardChanged);
}

X11KeyboardTap::~X11KeyboardTap() {
    remove();
}

void X11KeyboardTap::setFocusQuestions(FocusQuestions questions) {
    focus_ = std::move(questions);
}

void X11KeyboardTap::setUserTyped(UserTyped userTyped) {
    userTyped_ = std::move(userTyped);
}

Result<void> X11KeyboardTap::create(KeyboardTapListener& listener, bool /*annotatedSession*/) {
    remove();
    listener_ = &listener;
    auto begun = begin();
    if (!begun) listener_ = nullptr;
    return begun;
}

Result<void> X11KeyboardTap::begin() {
    if (connection_.isBroken()) {
        if (auto reopened = connection_.reopen(); !reopened) return reopened;
    }
    auto session = std::make_shared<TapSession>(TapSession::Dependencies{.loop = loop_,
                                                                         .connection = connection_,
                                                                         .keyboard = keyboard_,
                                                                         .listener = *listener_,
                                                                         .focus = focus_,
                                                                         .userTyped = userTyped_,
                                                                         .lost = [this] { lost(); },
                                                                         .toldFlags = toldFlags_,
                                                                         .inputMethod = inputMethod_});
    if (auto begun = session->begin(); !begun) return begun;
    session_ = std::move(session);
    return {};
}

void X11KeyboardTap::keyboardChanged(const XkbKeyboard::Change& change) {
    if (session_) session_->keyboardChanged(change);
}

bool X11KeyboardTap::exists() const {
    return session_ != nullptr;
}

void X11KeyboardTap::lost() {
    std::exchange(session_, nullptr)->end();
    listener_->tapDisabledByTimeout();
}

void X11KeyboardTap::enable() {
    if (session_ || !listener_) return;
    nextTry_.cancel();
    if (!begin()) tryAgainLater();
}

// The server may be gone, and Plume with it before long; or another program has the keyboard just now.
void X11KeyboardTap::tryAgainLater() {
    nextTry_ = loop_.performAfterDelay(TryPeriod, [this] { enable(); });
}

void X11KeyboardTap::remove() {
    listener_ = nullptr;
    nextTry_.cancel();
    if (session_) std::exchange(session_, nullptr)->end();
}

Result<void> X11KeyboardTap::check() const {
    return TapConnection::check(display_);
}

void X11KeyboardTap::inputMethodTold() {
    if (session_) return session_->tellOutcomes();
    // Nobody listens, and what was typed is not to be kept.
    while (inputMethod_->next()) {
    }
}

void X11KeyboardTap::hold() {
    if (session_) session_->hold();
}

void X11KeyboardTap::release() {
    if (session_) session_->release();
}

void X11KeyboardTap::keepHolding() {
    if (session_) session_->keepHolding();
}

void X11KeyboardTap::userClicked() {
    if (session_) session_->userClicked();
}

}  // namespace plume

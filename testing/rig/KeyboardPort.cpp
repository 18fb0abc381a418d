#include "testing/rig/KeyboardPort.h"

#include <future>
#include <utility>

#include "testing/rig/RigError.h"

namespace plume::rig {

namespace {

template <typename Value>
Value must(Result<Value> result) {
    if (!result) throw RigError(result.error().message);
    return std::move(result).value();
}

void must(const Result<void>& result) {
    if (!result) throw RigError(result.error().message);
}

}  // namespace

KeyboardPort::KeyboardPort(const std::string& display, Options options) : options_(std::move(options)) {
    session_ = must(X11Session::open(display, loop_));
    keyboard_ = must(XkbKeyboard::open(session_->connection()));
    keyboard_->listenTo(*session_);
    connection_ = must(TapConnection::open(display, *keyboard_));
    if (options_.watchdog) {
        watchdog_ = std::make_unique<Watchdog>(loop_, display);
        must(watchdog_->start());
        watchdog_->setTapWindow(connection_->window());
        connection_->setReopenedListener([this](xcb_window_t window) { watchdog_->setTapWindow(window); });
    }
    tap_ = std::make_unique<X11KeyboardTap>(loop_, *connection_, *keyboard_);
    poster_ = std::make_unique<X11EventPoster>(loop_, *connection_, *keyboard_, *tap_);
    must(tap_->create(*this, false));
    thread_ = std::thread([this] { loop_.run(); });
}

KeyboardPort::~KeyboardPort() {
    run([this] {
        poster_.reset();
        tap_.reset();
        if (watchdog_) watchdog_->setTapWindow(XCB_WINDOW_NONE);
    });
    loop_.stop();
    thread_.join();
}

void KeyboardPort::run(const std::function<void()>& call) {
    std::promise<void> done;
    loop_.perform([&] {
        call();
        done.set_value();
    });
    done.get_future().get();
}

void KeyboardPort::type(std::u16string_view text) {
    run([&] {
        poster_->begin();
        poster_->post({.down = true, .text = text}, false);
        poster_->post({.down = false, .text = text}, false);
        poster_->end();
    });
}

void KeyboardPort::tapDisabledByTimeout() {
    if (options_.disabled) options_.disabled();
    enabling_ = loop_.performAfterDelay(0, [this] { tap_->enable(); });
}

}  // namespace plume::rig

#include "testing/rig/KeyboardPort.h"

namespace plume::rig {

KeyboardPort::KeyboardPort(const std::string& display, Options options)
    : options_(std::move(options)), thread_(display) {
    run([&] { putTogether(display); });
}

void KeyboardPort::putTogether(const std::string& display) {
    keyboard_ = valueOrThrow(XkbKeyboard::open(thread_.session().connection()));
    keyboard_->listenTo(thread_.session());
    connection_ = valueOrThrow(TapConnection::open(display, *keyboard_));
    if (options_.watchdog) {
        watchdog_ = std::make_unique<Watchdog>(loop(), display,
                                               Watchdog::Shared{.tapProgress = connection_->progress().descriptor()});
        watchdog_->setTapWindow(connection_->window());
        valueOrThrow(watchdog_->start());
        watchdog_->awaitListening();
        connection_->setReopenedListener([this](xcb_window_t window) { watchdog_->setTapWindow(window); });
    }
    tap_ = std::make_unique<X11KeyboardTap>(loop(), *connection_, *keyboard_);
    poster_ = std::make_unique<X11EventPoster>(loop(), *connection_, *keyboard_, *tap_);
    valueOrThrow(tap_->create(*this, false));
}

KeyboardPort::~KeyboardPort() {
    run([this] {
        enabling_.cancel();
        poster_.reset();
        tap_.reset();
        if (watchdog_) watchdog_->setTapWindow(XCB_WINDOW_NONE);
    });
    thread_.end();
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
    enabling_ = loop().performAfterDelay(0, [this] { tap_->enable(); });
}

}  // namespace plume::rig

#include "tests/desktop/TapThread.h"

#include "testing/rig/RigError.h"

namespace plume::rig {

namespace {

template <typename Value>
Value valueOf(Result<Value> result) {
    if (!result) throw RigError(result.error().message);
    return std::move(result).value();
}

}  // namespace

TapThread::TapThread(const std::string& display) {
    parts_.session = valueOf(X11Session::open(display, parts_.loop));
    parts_.keyboard = valueOf(XkbKeyboard::open(parts_.session->connection()));
    parts_.keyboard->listenTo(*parts_.session);
    parts_.inputSources = std::make_unique<X11InputSources>(*parts_.keyboard);
    parts_.connection = valueOf(TapConnection::open(display, *parts_.keyboard));
    parts_.tap = std::make_unique<X11KeyboardTap>(parts_.loop, *parts_.connection, *parts_.keyboard);
    parts_.mouse = std::make_unique<X11MouseTap>(*parts_.session);
    thread_ = std::thread([this] { parts_.loop.run(); });
}

TapThread::~TapThread() {
    call([](Parts& parts) {
        parts.mouse->remove();
        parts.tap->remove();
    });
    parts_.loop.stop();
    thread_.join();
}

}  // namespace plume::rig

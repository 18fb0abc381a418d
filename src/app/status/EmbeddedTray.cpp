#include "app/status/EmbeddedTray.h"

#include <xcb/xcb.h>

#include <QGuiApplication>
#include <cstdlib>
#include <memory>

namespace plume {

namespace {

template <typename Reply>
std::unique_ptr<Reply, decltype(&std::free)> owned(Reply* reply) {
    return {reply, &std::free};
}

QByteArray selectionName() {
    int screen = 0;
    char* host = nullptr;
    int display = 0;
    if (xcb_parse_display(nullptr, &host, &display, &screen) != 0) std::free(host);
    return "_NET_SYSTEM_TRAY_S" + QByteArray::number(screen);
}

}  // namespace

EmbeddedTray::EmbeddedTray(QObject* parent) : QObject(parent) {
    auto* x11 = qApp->nativeInterface<QNativeInterface::QX11Application>();
    // Platforms without a display have the interface, too, but no connection.
    connection_ = x11 == nullptr ? nullptr : x11->connection();
    if (connection_ == nullptr) return;
    selection_ = atom(selectionName());
    manager_ = atom("MANAGER");
    qApp->installNativeEventFilter(this);
    lookAgain();
}

EmbeddedTray::~EmbeddedTray() {
    if (connection_ != nullptr) qApp->removeNativeEventFilter(this);
}

std::uint32_t EmbeddedTray::atom(const QByteArray& name) const {
    const auto cookie = xcb_intern_atom(connection_, 0, static_cast<std::uint16_t>(name.size()), name.constData());
    const auto reply = owned(xcb_intern_atom_reply(connection_, cookie, nullptr));
    return reply ? reply->atom : 0;
}

bool EmbeddedTray::nativeEventFilter(const QByteArray& /*type*/, void* message, qintptr* /*result*/) {
    constexpr std::uint8_t SentByClient = 0x80;
    const auto* event = static_cast<const xcb_generic_event_t*>(message);
    bool concerns = false;
    switch (event->response_type & ~SentByClient) {
        case XCB_CLIENT_MESSAGE: {
            const auto* told = reinterpret_cast<const xcb_client_message_event_t*>(event);
            concerns = told->type == manager_ && told->data.data32[1] == selection_;
            break;
        }
        case XCB_DESTROY_NOTIFY:
            concerns = reinterpret_cast<const xcb_destroy_notify_event_t*>(event)->window == window_;
            break;
        default:
            break;
    }
    // Qt has to see the event first.
    if (concerns) QMetaObject::invokeMethod(this, &EmbeddedTray::lookAgain, Qt::QueuedConnection);
    return false;
}

void EmbeddedTray::lookAgain() {
    const auto cookie = xcb_get_selection_owner(connection_, selection_);
    const auto reply = owned(xcb_get_selection_owner_reply(connection_, cookie, nullptr));
    const std::uint32_t now = reply ? reply->owner : 0;
    if (now == window_) return;
    window_ = now;
    if (window_ != 0) {
        // The same that Qt asks for: a connection has one mask for a window.
        const std::uint32_t mask = XCB_EVENT_MASK_STRUCTURE_NOTIFY;
        xcb_change_window_attributes(connection_, window_, XCB_CW_EVENT_MASK, &mask);
        xcb_flush(connection_);
    }
    Q_EMIT changed();
}

}  // namespace plume

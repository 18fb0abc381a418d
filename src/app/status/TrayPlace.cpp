#include "app/status/TrayPlace.h"

#include <QDBusConnection>
#include <QDBusMessage>
#include <QDBusPendingCallWatcher>
#include <QDBusPendingReply>
#include <QDBusServiceWatcher>
#include <QDBusVariant>
#include <chrono>

namespace plume {

namespace {

const QString Watcher = QStringLiteral("org.kde.StatusNotifierWatcher");
const QString WatcherPath = QStringLiteral("/StatusNotifierWatcher");

// A panel that offers both has its tray first.
constexpr std::chrono::seconds Patience{2};

}  // namespace

TrayPlace::TrayPlace(QObject* parent) : QObject(parent), tray_(this) {
    patience_.setSingleShot(true);
    connect(&patience_, &QTimer::timeout, this, &TrayPlace::decide);
    connect(&tray_, &EmbeddedTray::changed, this, &TrayPlace::trayChanged);
    watchBus();
    if (tray_.window() != 0) patience_.start(Patience);
}

void TrayPlace::watchBus() {
    QDBusConnection bus = QDBusConnection::sessionBus();
    if (!bus.isConnected()) return;
    auto* owners = new QDBusServiceWatcher(Watcher, bus, QDBusServiceWatcher::WatchForOwnerChange, this);
    connect(owners, &QDBusServiceWatcher::serviceOwnerChanged, this,
            [this](const QString& /*name*/, const QString& /*before*/, const QString& now) {
                setHost(false);
                if (!now.isEmpty()) askForHost();
            });
    for (const char* signal : {"StatusNotifierHostRegistered", "StatusNotifierHostUnregistered"}) {
        bus.connect(Watcher, WatcherPath, Watcher, QLatin1String(signal), this, SLOT(askForHost()));
    }
    askForHost();
}

void TrayPlace::askForHost() {
    QDBusMessage question = QDBusMessage::createMethodCall(
        Watcher, WatcherPath, QStringLiteral("org.freedesktop.DBus.Properties"), QStringLiteral("Get"));
    question << Watcher << QStringLiteral("IsStatusNotifierHostRegistered");
    question.setAutoStartService(false);
    auto* answer = new QDBusPendingCallWatcher(QDBusConnection::sessionBus().asyncCall(question), this);
    connect(answer, &QDBusPendingCallWatcher::finished, this, [this](QDBusPendingCallWatcher* done) {
        const QDBusPendingReply<QDBusVariant> reply = *done;
        setHost(reply.isValid() && reply.value().variant().toBool());
        done->deleteLater();
    });
}

void TrayPlace::setHost(bool isThere) {
    hasHost_ = isThere;
    decide();
}

void TrayPlace::trayChanged() {
    // The old tray's icon is lost, even if there is another tray by now.
    if (kind_ == Kind::Embedded) setKind(Kind::None);
    patience_.start(Patience);
}

void TrayPlace::decide() {
    // Qt finds out with the first icon whether icons go over the bus, and never asks again.
    const bool mayUseBus = settled_ != Kind::Embedded;
    const bool mayEmbed = settled_ != Kind::Bus;
    if (hasHost_ && mayUseBus) {
        setKind(Kind::Bus);
    } else if (tray_.window() != 0 && mayEmbed && !patience_.isActive()) {
        setKind(Kind::Embedded);
    } else {
        setKind(Kind::None);
    }
}

void TrayPlace::setKind(Kind kind) {
    if (kind_ == kind) return;
    kind_ = kind;
    if (kind_ != Kind::None) settled_ = kind_;
    Q_EMIT changed();
}

}  // namespace plume

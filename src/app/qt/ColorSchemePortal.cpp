#include "app/qt/ColorSchemePortal.h"

#include <QDBusConnection>
#include <QDBusMessage>
#include <QDBusPendingCallWatcher>
#include <QDBusPendingReply>
#include <utility>

namespace plume {

namespace {

constexpr const char* Portal = "org.freedesktop.portal.Desktop";
constexpr const char* PortalPath = "/org/freedesktop/portal/desktop";
constexpr const char* Settings = "org.freedesktop.portal.Settings";
constexpr const char* Appearance = "org.freedesktop.appearance";
constexpr const char* Key = "color-scheme";
constexpr uint Dark = 1;

}  // namespace

ColorSchemePortal::ColorSchemePortal(Told told) : told_(std::move(told)) {
    QDBusConnection bus = QDBusConnection::sessionBus();
    if (!bus.isConnected()) return;
    bus.connect(Portal, PortalPath, Settings, "SettingChanged", this, SLOT(changed(QString, QString, QDBusVariant)));
    QDBusMessage question = QDBusMessage::createMethodCall(Portal, PortalPath, Settings, "Read");
    question << Appearance << Key;
    auto* answer = new QDBusPendingCallWatcher(bus.asyncCall(question), this);
    connect(answer, &QDBusPendingCallWatcher::finished, this, [this](QDBusPendingCallWatcher* done) {
        const QDBusPendingReply<QDBusVariant> reply = *done;
        if (reply.isValid()) tell(QVariant::fromValue(reply.value()));
        done->deleteLater();
    });
}

void ColorSchemePortal::changed(const QString& group, const QString& key, const QDBusVariant& value) {
    if (group == Appearance && key == Key) tell(QVariant::fromValue(value));
}

// The portal's value is a variant, which one of its two operations wraps into another.
void ColorSchemePortal::tell(QVariant value) const {
    while (value.canConvert<QDBusVariant>()) value = value.value<QDBusVariant>().variant();
    told_(value.toUInt() == Dark);
}

}  // namespace plume

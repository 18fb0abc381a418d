#include "app/session/SessionService.h"

#include <QDBusConnection>
#include <utility>

#include "app/session/SessionAdaptors.h"

namespace plume {

namespace {

constexpr const char* Name = "org.plume.Plume";
constexpr const char* Path = "/org/plume/Plume";

}  // namespace

SessionService::SessionService(Perform perform) : perform_(std::move(perform)) {
    new LauncherAdaptor(*this);
    new PlumeAdaptor(*this);
    QDBusConnection bus = QDBusConnection::sessionBus();
    if (!bus.isConnected()) return;
    registered_ = bus.registerObject(Path, this) && bus.registerService(Name);
}

SessionService::~SessionService() {
    QDBusConnection bus = QDBusConnection::sessionBus();
    if (registered_) bus.unregisterService(Name);
    if (bus.isConnected()) bus.unregisterObject(Path);
}

}  // namespace plume

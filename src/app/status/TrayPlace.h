// Where the desktop has a place for icons: in a panel that is reached over the session bus, or in a tray on the X
// display that takes windows.
//
// Told by the bus and the server, never polled. Belongs to the main thread. Without a session bus, or without X, there
// is that much less to be found.
#pragma once

#include <QObject>
#include <QTimer>

#include "app/status/EmbeddedTray.h"

class QDBusServiceWatcher;

namespace plume {

class TrayPlace final : public QObject {
    Q_OBJECT
  public:
    enum class Kind { None, Bus, Embedded };

    // Looks around: what it finds is told by changed().
    explicit TrayPlace(QObject* parent = nullptr);

    Kind kind() const { return kind_; }

  Q_SIGNALS:
    // Also when a place has gone and another one of the same kind is there: what stood in it is lost.
    void changed();

  private:
    Q_SLOT void askForHost();
    void watchBus();
    void setHost(bool isThere);
    void trayChanged();
    void decide();
    void setKind(Kind kind);

    EmbeddedTray tray_;
    QTimer patience_;
    bool hasHost_ = false;
    Kind kind_ = Kind::None;
    Kind settled_ = Kind::None;
};

}  // namespace plume

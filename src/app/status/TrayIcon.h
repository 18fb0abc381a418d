// Plume's icon in the desktop's panel, with its menu.
//
// Exists in the panel while the desktop has a place for it, see TrayPlace. A click opens the menu, a click with the
// middle button turns expansion on and off. Owned by the application's delegate; belongs to the main thread.
#pragma once

#include <QObject>
#include <QSystemTrayIcon>
#include <memory>

#include "app/StatusItem.h"
#include "app/status/StatusIcons.h"
#include "app/status/StatusMenu.h"
#include "app/status/TrayPlace.h"

namespace plume {

class TrayIcon final : public QObject, public StatusItem {
    Q_OBJECT
  public:
    explicit TrayIcon(StatusMenuServices services, IconStyle style = IconStyle::Coloured);
    ~TrayIcon() override;

    void setStatus(const Status& status) override;
    bool isVisible() const override;

  private:
    bool eventFilter(QObject* object, QEvent* event) override;
    void followPlace();
    void clicked(QSystemTrayIcon::ActivationReason reason);
    void showStatus();
    void showIcon();
    QString toolTip() const;

    const StatusMenuServices services_;
    const IconStyle style_;
    Status status_;
    StatusMenu menu_;
    // What the panel shows over the bus. Apart from the menu that Plume shows itself, for texts are written otherwise
    // there and rows come and go at other times.
    std::unique_ptr<StatusMenu> panelMenu_;
    TrayPlace place_;
    std::unique_ptr<QSystemTrayIcon> icon_;
};

}  // namespace plume

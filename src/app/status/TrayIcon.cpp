#include "app/status/TrayIcon.h"

#include <QApplication>
#include <QCursor>
#include <QEvent>
#include <QPalette>

#include "app/qt/Text.h"

namespace plume {

namespace {

bool isDark() {
    return QApplication::palette().color(QPalette::Window).lightness() < 128;
}

}  // namespace

TrayIcon::TrayIcon(StatusMenuServices services, IconStyle style)
    : services_(std::move(services)), style_(style), menu_(services_, MenuHome::Widget) {
    menu_.installEventFilter(this);
    connect(&place_, &TrayPlace::changed, this, &TrayIcon::followPlace);
}

TrayIcon::~TrayIcon() = default;

void TrayIcon::setStatus(const Status& status) {
    if (status == status_) return;
    status_ = status;
    showStatus();
}

bool TrayIcon::isVisible() const {
    if (!icon_ || !icon_->isVisible()) return false;
    // A panel on the bus draws the icon itself; a window has to lie in the tray.
    return place_.kind() == TrayPlace::Kind::Bus || !icon_->geometry().isEmpty();
}

bool TrayIcon::eventFilter(QObject* /*object*/, QEvent* event) {
    if (event->type() == QEvent::PaletteChange) showIcon();
    return false;
}

void TrayIcon::followPlace() {
    icon_.reset();
    panelMenu_.reset();
    if (place_.kind() == TrayPlace::Kind::None) return;
    if (place_.kind() == TrayPlace::Kind::Bus) panelMenu_ = std::make_unique<StatusMenu>(services_, MenuHome::Bus);
    icon_ = std::make_unique<QSystemTrayIcon>();
    connect(icon_.get(), &QSystemTrayIcon::activated, this, &TrayIcon::clicked);
    icon_->setContextMenu(panelMenu_ ? panelMenu_.get() : &menu_);
    showStatus();
    icon_->show();
}

void TrayIcon::clicked(QSystemTrayIcon::ActivationReason reason) {
    if (reason == QSystemTrayIcon::Trigger) menu_.popup(QCursor::pos());
    if (reason == QSystemTrayIcon::MiddleClick) services_.toggleEnabled();
}

void TrayIcon::showStatus() {
    menu_.setStatus(status_);
    if (panelMenu_) panelMenu_->setStatus(status_);
    showIcon();
    if (icon_) icon_->setToolTip(toolTip());
}

void TrayIcon::showIcon() {
    if (icon_) icon_->setIcon(statusIcon(status_, isDark(), style_));
}

QString TrayIcon::toolTip() const {
    if (!status_.isEnabled) return tr("Plume: off");
    if (status_.keyboardIsLost) return tr("Plume: does not hear the keyboard");
    if (status_.secureInput) return toQString(status_.secureInputStatus);
    return tr("Plume: on");
}

}  // namespace plume

#include "app/windows/SmallWindow.h"

#include <QCloseEvent>
#include <QLayout>
#include <QScreen>
#include <QShortcut>

namespace plume {

namespace {

constexpr QSize RoomForFrame(16, 48);

}  // namespace

SmallWindow::SmallWindow(const QString& title) : QDialog(nullptr, Qt::Window) {
    setAttribute(Qt::WA_DeleteOnClose);
    setWindowTitle(title);
    const auto* shortcut = new QShortcut(QKeySequence(Qt::CTRL | Qt::Key_W), this);
    connect(shortcut, &QShortcut::activated, this, &QWidget::close);
}

void SmallWindow::closeEvent(QCloseEvent* event) {
    event->accept();
}

void SmallWindow::fitTo(int width) {
    resize(width, layout()->totalHeightForWidth(width));
}

namespace {

// What was remembered on a larger screen may lie beyond the upper edge, where no title bar can be caught.
void fitToScreen(QWidget& window) {
    const QRect screen = window.screen()->availableGeometry();
    window.resize(window.size().boundedTo(screen.size() - RoomForFrame));
    if (window.testAttribute(Qt::WA_Moved) && window.y() < screen.y()) window.move(window.x(), screen.y());
}

}  // namespace

void bringToFront(QWidget& window) {
    if (!window.isVisible()) fitToScreen(window);
    window.setWindowState(window.windowState() & ~Qt::WindowMinimized);
    window.show();
    window.raise();
    window.activateWindow();
}

}  // namespace plume

// Finds what a user sees, and takes pictures of it.
#pragma once

#include <QAbstractButton>
#include <QApplication>
#include <QDir>
#include <QLabel>
#include <QPlainTextEdit>
#include <QTest>
#include <QWidget>
#include <stdexcept>
#include <string>

#include "app/qt/ColorScheme.h"

namespace plume::test {

inline QString withoutMnemonic(QString text) {
    return text.remove(QLatin1Char('&'));
}

// The visible window of this kind; null when there is none.
template <typename Window>
Window* shownWindow() {
    for (QWidget* each : QApplication::topLevelWidgets()) {
        auto* window = qobject_cast<Window*>(each);
        if (window && window->isVisible()) return window;
    }
    return nullptr;
}

// What can be seen and is called so: by its accessible name, or by what a label in front of it or it itself says.
template <typename Widget>
Widget& find(const QWidget& window, const QString& name) {
    for (Widget* each : window.findChildren<Widget*>()) {
        if (!each->isVisible()) continue;
        if (each->accessibleName() == name) return *each;
        if (const auto* button = qobject_cast<QAbstractButton*>(each);
            button && withoutMnemonic(button->text()) == name)
            return *each;
    }
    for (const QLabel* label : window.findChildren<QLabel*>()) {
        auto* buddy = qobject_cast<Widget*>(label->buddy());
        if (buddy && buddy->isVisible() && withoutMnemonic(label->text()) == name) return *buddy;
    }
    throw std::runtime_error("nothing is called " + name.toStdString());
}

inline void click(const QWidget& window, const QString& name) {
    QTest::mouseClick(&find<QAbstractButton>(window, name), Qt::LeftButton);
    QCoreApplication::processEvents();
}

// All sentences that can be seen.
inline std::string textOf(const QWidget& window) {
    std::string all;
    for (const QLabel* label : window.findChildren<QLabel*>()) {
        if (label->isVisible()) all += label->text().remove(QChar(0x200B)).toStdString() + "\n";
    }
    return all;
}

// Gives the window the keyboard, as a window manager does: shortcuts need that.
inline void activate(QWidget& window) {
    window.activateWindow();
    if (!QTest::qWaitForWindowActive(&window)) throw std::runtime_error("the window does not become active");
}

inline void processDeletions() {
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    QCoreApplication::processEvents();
}

// Light and dark, into the folder that PLUME_PICTURES names.
inline void takePicture(QWidget& window, const QString& name) {
    const QString folder = qEnvironmentVariable("PLUME_PICTURES");
    if (folder.isEmpty()) return;
    for (const bool isDark : {true, false}) {
        setColorScheme(isDark);
        QTest::qWait(20);
        window.grab().save(
            QDir(folder).filePath(name + (isDark ? QStringLiteral("-dark.png") : QStringLiteral(".png"))));
    }
}

}  // namespace plume::test

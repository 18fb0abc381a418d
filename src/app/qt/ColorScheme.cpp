#include "app/qt/ColorScheme.h"

#include <QApplication>
#include <QPalette>
#include <QStyle>

#include "app/qt/WindowStyle.h"

namespace plume {

namespace {

// Texts that step back, or cannot be used now, can still be read.
void setFaint(QPalette& palette, const QColor& help, const QColor& disabled) {
    palette.setColor(QPalette::PlaceholderText, help);
    for (const auto role : {QPalette::WindowText, QPalette::Text, QPalette::ButtonText}) {
        palette.setColor(QPalette::Disabled, role, disabled);
    }
}

QPalette lightPalette() {
    QPalette palette = QApplication::style()->standardPalette();
    setFaint(palette, QColor(0x66, 0x66, 0x66), QColor(0x85, 0x85, 0x85));
    return palette;
}

QPalette darkPalette() {
    // Outlines are darker than windows and fields are darker than both: windows are light enough for three steps.
    const QColor window(0x33, 0x36, 0x3a);
    const QColor base(0x1e, 0x20, 0x22);
    const QColor text(0xee, 0xee, 0xee);
    const QColor faint(0xa6, 0xa9, 0xad);
    const QColor accent(0x35, 0x76, 0xc0);
    QPalette palette(text, QColor(0x4a, 0x4e, 0x54), QColor(0x66, 0x6b, 0x72), QColor(0x17, 0x18, 0x1a),
                     QColor(0x3e, 0x42, 0x47), text, Qt::white, base, window);
    palette.setColor(QPalette::AlternateBase, QColor(0x26, 0x28, 0x2b));
    palette.setColor(QPalette::Highlight, accent);
    palette.setColor(QPalette::HighlightedText, Qt::white);
    palette.setColor(QPalette::Link, QColor(0x7c, 0xb2, 0xf0));
    palette.setColor(QPalette::LinkVisited, QColor(0xb3, 0x9d, 0xdb));
    palette.setColor(QPalette::ToolTipBase, QColor(0x4a, 0x4e, 0x54));
    palette.setColor(QPalette::ToolTipText, text);
    setFaint(palette, faint, faint);
    palette.setColor(QPalette::Disabled, QPalette::Base, QColor(0x2c, 0x2f, 0x32));
    // Fusion draws texts that are disabled a second time in this colour, which smears them unless it is not seen.
    palette.setColor(QPalette::Disabled, QPalette::Light, window);
    return palette;
}

}  // namespace

// The application owns its style, which the analyzer does not know.
// NOLINTBEGIN(clang-analyzer-cplusplus.NewDeleteLeaks)
void setColorScheme(bool isDark) {
    if (!qobject_cast<WindowStyle*>(QApplication::style())) QApplication::setStyle(new WindowStyle);
    QApplication::setPalette(isDark ? darkPalette() : lightPalette());
}
// NOLINTEND(clang-analyzer-cplusplus.NewDeleteLeaks)

std::unique_ptr<ColorSchemePortal> followColorScheme() {
    setColorScheme(qEnvironmentVariable("GTK_THEME").endsWith("dark", Qt::CaseInsensitive));
    return std::make_unique<ColorSchemePortal>(setColorScheme);
}

}  // namespace plume

#include "app/status/StatusIcons.h"

#include <gtest/gtest.h>

#include <QDir>
#include <QImage>
#include <QPainter>
#include <vector>

namespace plume {
namespace {

Status status(bool enabled, bool secure, bool lost = false) {
    return {.isEnabled = enabled, .secureInput = secure, .keyboardIsLost = lost};
}

const std::vector<Status> AllLooks = {status(true, false), status(false, false), status(true, true),
                                      status(true, false, true)};

TEST(StatusIcons, TheImageIsChosenByStatusAndAppearance) {
    struct Case {
        bool enabled, secure, dark;
        const char* name;
    };
    for (const Case& c :
         {Case{true, false, false, "AutoText"}, Case{true, false, true, "AutoText"},
          Case{true, true, false, "AutoTextCaution"}, Case{true, true, true, "AutoTextCautionDark"},
          Case{false, false, false, "AutoText-Disabled"}, Case{false, false, true, "AutoText-Disabled"},
          Case{false, true, false, "AutoText-Disabled"}, Case{false, true, true, "AutoText-Disabled"}}) {
        EXPECT_EQ(statusImageName(status(c.enabled, c.secure), c.dark).toStdString(), c.name);
        EXPECT_EQ(statusImageName(status(c.enabled, c.secure, true), c.dark).toStdString(), c.name);
    }
}

// Black and white, for what can be told apart without colours.
QImage shapeOf(const QIcon& icon, int size) {
    return icon.pixmap(QSize(size, size), 1).toImage().convertToFormat(QImage::Format_Alpha8);
}

TEST(StatusIcons, EveryStatusIsToldByItsShapeInEverySize) {
    for (const IconStyle style : {IconStyle::Coloured, IconStyle::Symbolic}) {
        for (const int size : {16, 22, 24, 32, 48, 64}) {
            std::vector<QImage> shapes;
            for (const Status& look : AllLooks) shapes.push_back(shapeOf(statusIcon(look, false, style), size));
            for (std::size_t i = 0; i < shapes.size(); ++i) {
                EXPECT_EQ(shapes[i].size(), QSize(size, size));
                for (std::size_t other = 0; other < i; ++other) EXPECT_NE(shapes[i], shapes[other]) << size;
            }
        }
    }
}

TEST(StatusIcons, DenseScreensGetPicturesOfTheirOwn) {
    const QPixmap dense = statusIcon(AllLooks.front(), false, IconStyle::Coloured).pixmap(QSize(22, 22), 2);
    EXPECT_EQ(dense.size(), QSize(44, 44));
    EXPECT_EQ(applicationIcon().pixmap(QSize(256, 256), 1).size(), QSize(256, 256));
}

TEST(StatusIcons, ASymbolicIconHasTheOneColourOfItsPanel) {
    for (const bool dark : {false, true}) {
        const QImage image = statusIcon(AllLooks[2], dark, IconStyle::Symbolic).pixmap(QSize(64, 64), 1).toImage();
        QList<QRgb> colours;
        for (int y = 0; y < image.height(); ++y) {
            for (int x = 0; x < image.width(); ++x) {
                const QColor c = image.pixelColor(x, y);
                if (c.alpha() == 255 && !colours.contains(c.rgb())) colours << c.rgb();
            }
        }
        ASSERT_EQ(colours.size(), 1);
        EXPECT_EQ(QColor(colours.front()).lightness() > 128, dark);
    }
}

TEST(StatusIcons, Sheet) {
    const QString folder = qEnvironmentVariable("PLUME_PICTURES");
    if (folder.isEmpty()) return;
    constexpr int SmallestFile = 0;
    QImage sheet(1160, 660, QImage::Format_RGB32);
    sheet.fill(Qt::gray);
    QPainter painter(&sheet);
    int y = 0;
    for (const IconStyle style : {IconStyle::Coloured, IconStyle::Symbolic}) {
        for (const bool dark : {false, true}) {
            painter.fillRect(0, y, sheet.width(), 130, dark ? QColor(0x2b, 0x2d, 0x30) : QColor(0xf4, 0xf4, 0xf4));
            int x = 10;
            for (const Status& look : AllLooks) {
                const QIcon icon = statusIcon(look, dark, style);
                for (const int size : {16, 22, 24, 32, 48, 64}) {
                    painter.drawPixmap(x, y + 10, icon.pixmap(size));
                    x += size + 10;
                }
                x += 16;
            }
            // What small ones look like from near.
            x = 10;
            for (const Status& look : AllLooks) {
                for (const int size : {16, 22}) {
                    const QImage small = statusIcon(look, dark, style).pixmap(size).toImage();
                    painter.drawImage(QRect(x, y + 80, size * 2, size * 2), small);
                    x += 60;
                }
            }
            y += 130;
        }
    }
    int x = 10;
    for (const int size : {16, 22, 24, 32, 48, 64, 128}) {
        painter.drawPixmap(x, y + 4, applicationIcon().pixmap(size));
        x += size + 16;
    }
    painter.end();
    EXPECT_TRUE(sheet.save(QDir(folder).filePath(QStringLiteral("status-icons.png")), nullptr, SmallestFile));
}

}  // namespace
}  // namespace plume

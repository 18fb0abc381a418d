#include "app/qt/ColorScheme.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QCheckBox>
#include <QLabel>
#include <QRadioButton>
#include <algorithm>
#include <cstdlib>

namespace plume {
namespace {

// By how much the lightest or darkest point of it differs from the window that it lies in, of 255.
int contrastOf(QWidget& widget) {
    const int window = widget.palette().color(QPalette::Window).lightness();
    const QImage image = widget.grab().toImage();
    int most = 0;
    for (int y = 0; y < image.height(); ++y) {
        for (int x = 0; x < image.width(); ++x) {
            most = std::max(most, std::abs(image.pixelColor(x, y).lightness() - window));
        }
    }
    return most;
}

class ColorScheme : public testing::Test {
  protected:
    ~ColorScheme() override { setColorScheme(false); }
};

TEST_F(ColorScheme, EmptyBoxesAreSeenInTheDark) {
    constexpr int Seen = 60;
    setColorScheme(true);
    QCheckBox box;
    EXPECT_GT(contrastOf(box), Seen);
    QRadioButton button;
    EXPECT_GT(contrastOf(button), Seen);
}

class EitherColorScheme : public ColorScheme, public testing::WithParamInterface<bool> {};

TEST_P(EitherColorScheme, TextsThatStepBackCanBeRead) {
    constexpr int Readable = 90;
    setColorScheme(GetParam());
    QLabel disabled(QStringLiteral("Disabled"));
    disabled.setEnabled(false);
    EXPECT_GT(contrastOf(disabled), Readable);
    QLabel help(QStringLiteral("Help"));
    help.setForegroundRole(QPalette::PlaceholderText);
    EXPECT_GT(contrastOf(help), Readable);
}

INSTANTIATE_TEST_SUITE_P(LightAndDark, EitherColorScheme, testing::Bool());

}  // namespace
}  // namespace plume

// The windows of forms in other languages, directions and sizes of letters: whether all has the place that it needs.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QAbstractButton>
#include <QDir>
#include <QScrollBar>
#include <QTextEdit>
#include <tuple>

#include "app/form/UnsentTextWindow.h"
#include "app/qt/ColorScheme.h"
#include "tests/app/form/FormSupport.h"
#include "tests/support/Language.h"

namespace plume {
namespace {

using test::FormOwner;
using ::testing::IsEmpty;

struct Look {
    const char* name;
    const char* language;
    int scale;  // of letters
    Qt::LayoutDirection direction;
};

class FormLooksTest : public ::testing::TestWithParam<Look> {
  protected:
    FormLooksTest() {
        QFont font = usual_;
        font.setPointSizeF(font.pointSizeF() * GetParam().scale);
        QApplication::setFont(font);
        QGuiApplication::setLayoutDirection(GetParam().direction);
    }
    ~FormLooksTest() override {
        QApplication::setFont(usual_);
        QGuiApplication::setLayoutDirection(Qt::LeftToRight);
    }
    // Light and dark, into the folder that PLUME_PICTURES names.
    static void takePicture(QWidget& window, const QString& what) {
        const QString folder = qEnvironmentVariable("PLUME_PICTURES");
        if (folder.isEmpty()) return;
        for (const bool isDark : {true, false}) {
            setColorScheme(isDark);
            QTest::qWait(20);
            window.grab().save(QDir(folder).filePath(what + QLatin1Char('-') + QLatin1String(GetParam().name) +
                                                     (isDark ? "-dark.png" : ".png")));
        }
    }

    const test::SpokenLanguage spoken{QString::fromLatin1(GetParam().language)};

  private:
    const QFont usual_ = QApplication::font();
};

bool isCut(const QWidget& widget) {
    if (const auto* label = qobject_cast<const QLabel*>(&widget)) {
        return label->wordWrap() ? label->heightForWidth(label->width()) > label->height()
                                 : label->sizeHint().width() > label->width();
    }
    const auto* button = qobject_cast<const QAbstractButton*>(&widget);
    return button && !button->text().isEmpty() && button->sizeHint().width() > button->width();
}

// Once the layouts have done what they have to do.
std::vector<std::string> cutTexts(const QWidget& window) {
    std::vector<std::string> cut;
    std::ignore = QTest::qWaitFor(
        [&] {
            cut.clear();
            for (const QWidget* each : window.findChildren<QWidget*>()) {
                if (each->isVisible() && isCut(*each)) cut.push_back(each->property("text").toString().toStdString());
            }
            return cut.empty();
        },
        500);
    return cut;
}

TEST_P(FormLooksTest, CutsNoTextAndPutsNothingOverAnother) {
    FormOwner owner(test::businessLetter());
    owner.open();
    const bool isScrolled = owner.window->findChild<QTextEdit*>()->verticalScrollBar()->maximum() > 0;
    EXPECT_EQ(isScrolled, GetParam().scale > 1) << "it opens as large as it has to be";
    owner.find<QLineEdit>("Order").setFocus();
    owner.type("12a");
    owner.find<QLineEdit>("Name").setFocus();
    owner.type("Grace Hopper");
    takePicture(*owner.window, QStringLiteral("PlainForm"));
    EXPECT_THAT(cutTexts(*owner.window), IsEmpty());

    std::vector<QWidget*> inputs;
    for (QWidget* each : owner.window->findChildren<QWidget*>()) {
        const bool isInput = qobject_cast<QLineEdit*>(each) || qobject_cast<QPlainTextEdit*>(each) ||
                             qobject_cast<QComboBox*>(each) || qobject_cast<QCheckBox*>(each);
        if (isInput) inputs.push_back(each);
    }
    const auto placeOf = [&](const QWidget* widget) {
        return QRect(widget->mapTo(owner.window.get(), QPoint(0, 0)), widget->size());
    };
    for (const QWidget* one : inputs) {
        EXPECT_LE(placeOf(one).right(), owner.window->width());
        for (const QWidget* other : inputs) {
            EXPECT_TRUE(one == other || !placeOf(one).intersects(placeOf(other)))
                << one->accessibleName().toStdString() << ", " << other->accessibleName().toStdString();
        }
    }
}

TEST_P(FormLooksTest, OfATextThatWasNotSent) {
    UnsentTextWindow window(u"Dear Ms Example,\n\nthank you for your order.",
                            "The snippet was not sent: the window that it was for is gone, or does not take the "
                            "keyboard.",
                            {[] {}, [] {}, [] {}});
    window.show();
    test::Mnemonics().addAll(window);
    for (const Qt::Key key : {Qt::Key_Escape, Qt::Key_Return}) {
        QTest::keyClick(&window, key);
        takePicture(window, key == Qt::Key_Escape ? QStringLiteral("Question") : QStringLiteral("Copied"));
        EXPECT_THAT(cutTexts(window), IsEmpty());
        const QRect text = window.findChild<QPlainTextEdit*>()->geometry();
        for (const QLabel* each : window.findChildren<QLabel*>(QString(), Qt::FindDirectChildrenOnly)) {
            EXPECT_FALSE(each->geometry().intersects(text)) << each->text().toStdString();
        }
    }
}

INSTANTIATE_TEST_SUITE_P(Looks, FormLooksTest,
                         ::testing::Values(Look{"en", "en", 1, Qt::LeftToRight}, Look{"de", "de", 1, Qt::LeftToRight},
                                           Look{"deLarge", "de", 2, Qt::LeftToRight},
                                           Look{"fr", "fr", 1, Qt::LeftToRight},
                                           Look{"frLarge", "fr", 2, Qt::LeftToRight},
                                           Look{"RightToLeft", "en", 1, Qt::RightToLeft}),
                         [](const auto& look) { return std::string(look.param.name); });

}  // namespace
}  // namespace plume

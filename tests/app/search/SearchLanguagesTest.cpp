// The search windows in other languages, with letters of usual and of double size: whether all of their texts have the
// place that they need.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QLabel>
#include <QLineEdit>
#include <QListView>
#include <QMenu>
#include <QToolButton>
#include <tuple>

#include "app/search/QuickSearchWindow.h"
#include "app/search/SuggestionWindow.h"
#include "library/KnownSettings.h"
#include "library/MemoryUserDefaults.h"
#include "tests/app/search/SearchSupport.h"
#include "tests/support/Language.h"

namespace plume {
namespace {

using test::addGroup;
using test::addSnippet;
using ::testing::IsEmpty;

// Windows that are made while it lives have letters of another size.
class LetterSize {
  public:
    explicit LetterSize(int scale) {
        QFont font = usual_;
        font.setPointSizeF(font.pointSizeF() * scale);
        QApplication::setFont(font);
    }
    ~LetterSize() { QApplication::setFont(usual_); }
    LetterSize(const LetterSize&) = delete;
    LetterSize& operator=(const LetterSize&) = delete;

  private:
    const QFont usual_ = QApplication::font();
};

bool isCut(const QWidget& widget) {
    if (const auto* label = qobject_cast<const QLabel*>(&widget)) {
        return label->wordWrap() ? label->heightForWidth(label->width()) > label->height()
                                 : label->sizeHint().width() > label->width();
    }
    if (const auto* field = qobject_cast<const QLineEdit*>(&widget)) {
        return field->fontMetrics().horizontalAdvance(field->placeholderText()) > field->width() * 9 / 10;
    }
    const bool isButton = qobject_cast<const QToolButton*>(&widget) && !qobject_cast<QLineEdit*>(widget.parent());
    return isButton && (widget.sizeHint().width() > widget.width() || widget.sizeHint().height() > widget.height());
}

// What says something and has too little room for it.
std::vector<std::string> cutTexts(const QWidget& window) {
    std::vector<std::string> cut;
    for (const QWidget* each : window.findChildren<QWidget*>()) {
        if (!each->isVisible() || !isCut(*each)) continue;
        const QString text = each->property("text").toString();
        cut.push_back(text.toStdString() + " (" + each->metaObject()->className() + ")");
    }
    return cut;
}

class SearchLanguagesTest : public ::testing::TestWithParam<std::tuple<const char*, int>> {
  protected:
    SearchLanguagesTest() {
        settings.registerDefaults(registeredSettings("/backups"));
        const auto work = addGroup(groups, say(u"Arbeit", u"Travail"), u";");
        addSnippet(*work, u"mfg", say(u"Mit freundlichen Grüßen\nAnn Beispiel", u"Bien cordialement,\nAnn Exemple"),
                   say(u"Grußformel", u"Formule de politesse"));
        addSnippet(*work, u"date", u"date --iso", u"", ContentType::ShellScript);
        addSnippet(*work, u"gmf", u"x");
    }
    std::u16string say(const char16_t* german, const char16_t* french) const {
        return language == QLatin1String("de") ? german : french;
    }
    QString pictureOf(const char* name) const {
        const QString large = std::get<1>(GetParam()) == 1 ? QString() : QStringLiteral("-large");
        return QLatin1String(name) + QLatin1Char('-') + language + large;
    }

    const QString language = QString::fromLatin1(std::get<0>(GetParam()));
    const test::SpokenLanguage spoken{language};
    const LetterSize letters{std::get<1>(GetParam())};
    SnippetGroups groups;
    MemoryUserDefaults settings;
};

TEST_P(SearchLanguagesTest, QuickSearch) {
    QuickSearchWindow window({.groups = [this]() -> const SnippetGroups& { return groups; },
                              .settings = settings,
                              .uses = nullptr,
                              .send = [](const auto& /*snippet*/) {},
                              .edit = [](const auto& /*snippet*/) {},
                              .setFirstRows = [](const auto& /*snippets*/) {},
                              .readClipboard = [](const auto& /*answer*/) {}});
    for (const char16_t* query : {u"", u"mfg", u"zzz", u"date"}) {
        window.show({.place = {}, .query = query, .selectorKeyModifier = 2});
        QCoreApplication::processEvents();
        EXPECT_THAT(cutTexts(window), IsEmpty()) << QString::fromUtf16(query).toStdString();
        test::takePicture(window, pictureOf("QuickSearch") + QString::fromUtf16(query));
    }
    const SnippetRow row = test::rowAt(*window.findChild<QListView*>()->model(), 0);
    EXPECT_EQ(row.shortcut.toStdString(), language == QLatin1String("de") ? "Strg+1" : "Ctrl+1");
    auto& field = *window.findChild<QLineEdit*>();
    EXPECT_EQ(fromQString(field.placeholderText()), say(u"Snippets suchen", u"Rechercher des extraits"));
    QMenu& menu = *window.findChild<QToolButton*>(QString(), Qt::FindDirectChildrenOnly)->menu();
    menu.popup({10, 10});
    test::Mnemonics taken;
    for (const QAction* action : menu.actions()) taken.add(action->text());
    test::takePicture(menu, pictureOf("QuickSearchMenu"));
}

TEST_P(SearchLanguagesTest, Suggestions) {
    SuggestionWindow window;
    SuggestionPage page{.number = 1, .rows = {}, .first = 0, .total = 1234, .selected = 0, .selectorKeyModifier = 2};
    for (char16_t digit = u'1'; digit <= u'9'; ++digit) {
        page.rows.push_back({u";mfg", 3, say(u"Grußformel", u"Formule de politesse"), u"Ann", digit});
    }
    window.show(page, {CaretPlace::Kind::Caret, {{60, 60}, {0, 16}}});
    QCoreApplication::processEvents();
    EXPECT_THAT(cutTexts(window), IsEmpty());
    const auto* count = window.findChild<QLabel*>();
    EXPECT_TRUE(count->isVisible());
    EXPECT_NE(count->text().indexOf(language == QLatin1String("de") ? " bis 9 von " : " à 9 sur "), -1);
    test::takePicture(window, pictureOf("Suggestions"));
}

INSTANTIATE_TEST_SUITE_P(Languages, SearchLanguagesTest,
                         ::testing::Combine(::testing::Values("de", "fr"), ::testing::Values(1, 2)),
                         [](const auto& given) {
                             return std::get<0>(given.param) +
                                    std::string(std::get<1>(given.param) == 1 ? "" : "Large");
                         });

}  // namespace
}  // namespace plume

// A form of plain controls, as users fill it in.
#include "app/form/PlainFormWindow.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QAbstractItemView>
#include <QClipboard>
#include <QGuiApplication>
#include <QInputMethodEvent>
#include <QScreen>
#include <QTextEdit>

#include "tests/app/form/FormSupport.h"

namespace plume {
namespace {

using test::FormOwner;
using test::Letter;

using ::testing::ElementsAre;
using ::testing::IsEmpty;

constexpr auto Menu = FieldType::PopupMenu;
constexpr auto Number = FieldType::Number;
constexpr auto Area = FieldType::Multiline;

std::u16string shownIn(const QLineEdit& line) {
    return fromQString(line.text());
}

TEST(PlainFormWindow, IsReadyOnceItsFirstFieldTakesKeys) {
    FormOwner owner(Letter().field(u"Fixed", FieldType::Singleline, u"f").readonly().field(u"First").field(u"Second"));
    EXPECT_FALSE(owner.window->size());
    owner.window->show(FormPlace{});
    EXPECT_THAT(owner.takeNotes(), IsEmpty()) << "no event comes from inside show()";
    owner.open();
    EXPECT_THAT(owner.takeNotes(), ElementsAre("shown"));
    EXPECT_EQ(owner.focus(), "First");
    owner.type("x");
    EXPECT_THAT(owner.takeNotes(), ElementsAre("filled 1 x"));
    EXPECT_TRUE(owner.window->size());
}

TEST(PlainFormWindow, FillsEveryKindOfField) {
    FormOwner owner(Letter()
                        .field(u"line")
                        .field(u"area", Area, u"a")
                        .field(u"menu", Menu, u"Red\nGreen")
                        .field(u"number", Number)
                        .field(u"none", Menu));
    owner.open();
    owner.type("1");
    owner.press(Qt::Key_Tab);
    owner.press(Qt::Key_End, Qt::ControlModifier);
    owner.press(Qt::Key_Return);
    owner.type("b");
    owner.press(Qt::Key_Tab);
    owner.press(Qt::Key_Down);
    owner.press(Qt::Key_Tab);
    owner.type("2");
    EXPECT_THAT(owner.takeNotes(),
                ElementsAre("shown", "filled 0 1", "filled 1 a\n", "filled 1 a\nb", "filled 2 Green", "filled 3 2"));
    EXPECT_EQ(owner.window->findChildren<QComboBox*>().size(), 1) << "an empty menu is not shown";
}

TEST(PlainFormWindow, WalksItsFieldsInTheOrderOfTheText) {
    FormOwner owner(Letter()
                        .field(u"a")
                        .text(u"\n")
                        .field(u"b", Area)
                        .field(u"c", FieldType::Singleline, u"fixed")
                        .readonly()
                        .field(u"d")
                        .optional()
                        .field(u"e", Menu, u"1\n2"));
    owner.open();
    std::vector<std::string> walked;
    for (int step = 0; step < 8; ++step) {
        walked.push_back(owner.focus());
        owner.press(Qt::Key_Tab);
    }
    EXPECT_THAT(walked, ElementsAre("a", "b", "d", "d", "e", "Insert", "Cancel", "a"));
    owner.press(Qt::Key_Tab, Qt::ShiftModifier);
    owner.press(Qt::Key_Tab, Qt::ShiftModifier);
    EXPECT_EQ(owner.focus(), "Cancel");
}

TEST(PlainFormWindow, EndsByKeysFromEveryField) {
    struct Example {
        const char* what;
        FieldType type;
        Qt::Key key;
        Qt::KeyboardModifiers modifiers;
        const char* end;
    };
    const Example examples[] = {
        {"line", FieldType::Singleline, Qt::Key_Return, {}, "accepted"},
        {"keypad", FieldType::Singleline, Qt::Key_Enter, Qt::KeypadModifier, "accepted"},
        {"number", Number, Qt::Key_Return, {}, "accepted"},
        {"menu", Menu, Qt::Key_Return, {}, "accepted"},
        {"area, with Control", Area, Qt::Key_Return, Qt::ControlModifier, "accepted"},
        {"line, with Control", FieldType::Singleline, Qt::Key_Return, Qt::ControlModifier, "accepted"},
        {"menu, with Control", Menu, Qt::Key_Enter, Qt::ControlModifier | Qt::KeypadModifier, "accepted"},
        {"line, Escape", FieldType::Singleline, Qt::Key_Escape, {}, "cancelled"},
        {"area, Escape", Area, Qt::Key_Escape, {}, "cancelled"},
        {"menu, Escape", Menu, Qt::Key_Escape, {}, "cancelled"},
    };
    for (const auto& [what, type, key, modifiers, end] : examples) {
        FormOwner owner(Letter().field(u"x", type, u"1"));
        owner.open();
        owner.takeNotes();
        // Twice, as impatient users do.
        QTest::keyClick(QApplication::focusWidget(), key, modifiers);
        if (QApplication::focusWidget()) QTest::keyClick(QApplication::focusWidget(), key, modifiers);
        QCoreApplication::processEvents();
        EXPECT_THAT(owner.takeNotes(), ElementsAre(end)) << what;
        EXPECT_FALSE(owner.window) << what;
    }
}

TEST(PlainFormWindow, PicksFromAnOpenMenuByReturn) {
    FormOwner owner(Letter().field(u"x", Menu, u"Red\nGreen"));
    owner.open();
    owner.takeNotes();
    auto& menu = owner.find<QComboBox>("x");
    for (const auto& [key, notes] : {std::pair(Qt::Key_Return, std::vector<std::string>{"filled 0 Green"}),
                                     std::pair(Qt::Key_Escape, std::vector<std::string>{})}) {
        menu.showPopup();
        menu.view()->setCurrentIndex(menu.model()->index(1, 0));
        QTest::keyClick(menu.view(), key);
        QTest::qWait(10);
        EXPECT_EQ(owner.takeNotes(), notes);
        ASSERT_TRUE(owner.window);
    }
}

TEST(PlainFormWindow, EndsByItsButtonsAndByTheWindowManager) {
    for (const int button : {0, 1, 2}) {
        FormOwner owner(Letter().field(u"x"));
        owner.open();
        owner.takeNotes();
        if (button == 2) {
            owner.window->close();
        } else {
            for (int step = 0; step <= button; ++step) owner.press(Qt::Key_Tab);
            owner.press(Qt::Key_Return);
        }
        QCoreApplication::processEvents();
        EXPECT_THAT(owner.takeNotes(), ElementsAre(button == 0 ? "accepted" : "cancelled")) << button;
    }
}

TEST(PlainFormWindow, TellsWhatWasTypedBeforeItEnds) {
    FormOwner owner(Letter().field(u"x"));
    owner.open();
    owner.takeNotes();
    QWidget* field = QApplication::focusWidget();
    QTest::keyClicks(field, QStringLiteral("abc"));
    QTest::keyClick(field, Qt::Key_Return);
    EXPECT_THAT(owner.takeNotes(), IsEmpty()) << "the form may be destroyed by an event, and is in a key";
    QCoreApplication::processEvents();
    EXPECT_THAT(owner.takeNotes(), ElementsAre("filled 0 abc", "accepted"));
}

TEST(PlainFormWindow, TellsNothingAfterItsEnd) {
    FormOwner owner(Letter().field(u"x"));
    owner.open();
    owner.takeNotes();
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_A);
    owner.window.reset();
    QCoreApplication::processEvents();
    EXPECT_THAT(owner.takeNotes(), IsEmpty());
}

TEST(PlainFormWindow, LivesOnWhenItsOwnerKeepsIt) {
    FormOwner owner(Letter().field(u"x"));
    owner.destroysAtEnd = false;
    owner.open();
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Return);
    owner.press(Qt::Key_Return);
    owner.press(Qt::Key_Escape);
    owner.press(Qt::Key_Return);
    EXPECT_THAT(owner.takeNotes(), ElementsAre("shown", "accepted", "cancelled", "accepted"));
    EXPECT_TRUE(owner.window->isVisible());
}

TEST(PlainFormWindow, TicksByTypingByTheBoxAndByItsLetter) {
    FormOwner owner(Letter()
                        .field(u"Plain")
                        .field(u"Discount", FieldType::Singleline, u"10 %")
                        .optional()
                        .field(u"Delivery", Menu, u"home\noffice")
                        .optional()
                        .script(u"weather", u"curl x", true));
    owner.open();
    owner.takeNotes();
    owner.press(Qt::Key_D, Qt::AltModifier);
    EXPECT_TRUE(owner.box("Discount").isChecked());
    owner.press(Qt::Key_E, Qt::AltModifier);
    owner.press(Qt::Key_W, Qt::AltModifier);
    owner.press(Qt::Key_D, Qt::AltModifier);
    EXPECT_EQ(owner.focus(), "Plain") << "who ticks goes on typing";
    EXPECT_THAT(owner.takeNotes(), ElementsAre("ticked 1", "ticked 2", "ticked 3", "unticked 1"));
    owner.line("Discount").setFocus();
    owner.type("5");
    EXPECT_TRUE(owner.box("Discount").isChecked());
    owner.press(Qt::Key_Tab, Qt::ShiftModifier);
    owner.press(Qt::Key_Space);
    EXPECT_FALSE(owner.box("Discount").isChecked());
    EXPECT_FALSE(owner.model.fields()[1].selected);
}

// The tick and the end in one breath.
TEST(PlainFormWindow, AcceptsWithTheTickThatCameBefore) {
    FormOwner owner(Letter().field(u"Plain").field(u"More").optional());
    owner.open();
    owner.takeNotes();
    QWidget* field = QApplication::focusWidget();
    QTest::keyClick(field, Qt::Key_M, Qt::AltModifier);
    QTest::keyClick(field, Qt::Key_Return);
    QCoreApplication::processEvents();
    EXPECT_THAT(owner.takeNotes(), ElementsAre("ticked 1", "accepted"));
}

TEST(PlainFormWindow, ShowsFieldsOfOneNameTogether) {
    FormOwner owner(Letter().field(u"Name").field(u"Name").readonly().field(u"Name", Area));
    owner.open();
    owner.type("Ada");
    EXPECT_EQ(owner.find<QLabel>("Name: Ada").text(), "Ada");
    EXPECT_EQ(owner.find<QPlainTextEdit>("Name").toPlainText(), "Ada");
}

TEST(PlainFormWindow, LeavesANumberAloneWhileItIsTyped) {
    FormOwner owner(Letter().field(u"price", Number).field(u"double", Number, u"price * 2"));
    owner.open();
    std::vector<std::u16string> shown;
    for (const char* key : {"1", ".", "0", "5", "0"}) {
        owner.type(key);
        shown.push_back(shownIn(owner.line("price")));
    }
    EXPECT_THAT(shown, ElementsAre(u"1", u"1.", u"1.0", u"1.05", u"1.050"));
    EXPECT_EQ(shownIn(owner.line("double")), u"2.1");
    owner.press(Qt::Key_Tab);
    EXPECT_EQ(shownIn(owner.line("price")), u"1.05") << "what counts, once the field is left";
}

TEST(PlainFormWindow, SaysWhatIsWrongBesideTheField) {
    FormOwner owner(Letter().text(u"It costs ").field(u"price", Number));
    owner.open();
    const QString usual = owner.line("price").accessibleDescription();
    EXPECT_EQ(usual, "It costs");
    owner.type("abc");
    const QString problem = owner.line("price").accessibleDescription();
    EXPECT_NE(problem, usual);
    const auto isShown = [&](const QLabel* label) {
        return label->isVisible() && !label->text().isEmpty() && problem.startsWith(label->text());
    };
    const auto labels = owner.window->findChildren<QLabel*>();
    const auto label = std::ranges::find_if(labels, isShown);
    ASSERT_NE(label, labels.end());
    EXPECT_GT((*label)->visibleRegion().boundingRect().width(), 20) << "there is room for it";
    owner.line("price").selectAll();
    owner.type("5");
    EXPECT_EQ(owner.line("price").accessibleDescription(), usual);
}

TEST(PlainFormWindow, MakesSpacesOfPastedLineBreaksInOneLine) {
    const QString pasted = QStringLiteral("a\r\nb\nc\u2028d\u00A0e");
    for (const auto type : {FieldType::Singleline, Number, Area}) {
        FormOwner owner(Letter().field(u"x", type));
        owner.open();
        QGuiApplication::clipboard()->setText(pasted);
        owner.press(Qt::Key_V, Qt::ControlModifier);
        owner.type("f");
        EXPECT_EQ(owner.model.fields()[0].value, type == Area ? u"a\nb\nc\nd\u00A0ef" : u"a b c d\u00A0ef");
    }
}

TEST(PlainFormWindow, KeepsWhatNobodyChanges) {
    const std::u16string lines = u"first\nsecond";
    const std::u16string large(100'000, u'x');
    FormOwner owner(Letter()
                        .field(u"a", FieldType::Singleline, lines)
                        .field(u"b", FieldType::Singleline, large)
                        .field(u"c", Menu, u"x\nx\ny"));
    owner.open();
    EXPECT_EQ(owner.find<QPlainTextEdit>("a").toPlainText(), "first\nsecond");
    EXPECT_EQ(owner.line("b").text().size(), 100'000);
    owner.find<QComboBox>("c").setFocus();
    owner.press(Qt::Key_Down);
    EXPECT_EQ(owner.find<QComboBox>("c").currentIndex(), 1) << "one of two equal lines is not the other";
    EXPECT_EQ(owner.model.fields()[0].value, lines);
}

TEST(PlainFormWindow, LeavesReturnAndEscapeToAnInputMethod) {
    for (const auto type : {FieldType::Singleline, Area}) {
        FormOwner owner(Letter().field(u"x", type));
        owner.open();
        owner.takeNotes();
        QInputMethodEvent composing(QStringLiteral("に"), {});
        QCoreApplication::sendEvent(QApplication::focusWidget(), &composing);
        owner.press(Qt::Key_Return);
        owner.press(Qt::Key_Escape);
        EXPECT_THAT(owner.takeNotes(), IsEmpty());
        ASSERT_TRUE(owner.window);
        QInputMethodEvent committed;
        committed.setCommitString(QStringLiteral("日"));
        QCoreApplication::sendEvent(QApplication::focusWidget(), &committed);
        owner.press(Qt::Key_Return, Qt::ControlModifier);
        EXPECT_THAT(owner.takeNotes(), ElementsAre("filled 0 日", "accepted"));
    }
}

TEST(PlainFormWindow, SaysWhatEveryControlIs) {
    FormOwner owner(test::businessLetter().field(u"").field(u"", Area));
    owner.open();
    for (const QWidget* each : owner.window->findChildren<QWidget*>()) {
        if (each->focusPolicy() == Qt::NoFocus || !each->isVisible() || each->isWindow()) continue;
        const bool isNamed = !each->accessibleName().isEmpty() || !each->property("text").toString().isEmpty();
        EXPECT_TRUE(isNamed) << each->metaObject()->className();
    }
    EXPECT_NO_THROW(owner.line("Field 11"));
    EXPECT_NO_THROW(owner.find<QPlainTextEdit>("Field 12"));
}

TEST(PlainFormWindow, TakesTheSizeThatItIsGivenAndStaysOnTheScreen) {
    const QRect room = QGuiApplication::primaryScreen()->availableGeometry();
    const Rectangle corner{{room.right() - 5.0, room.bottom() - 20.0}, {1, 15}};
    for (const std::optional<Size> size : {std::optional<Size>(), std::optional(Size{500, 300})}) {
        FormOwner owner(test::businessLetter());
        owner.open({{CaretPlace::Kind::Caret, corner}, size});
        EXPECT_TRUE(room.contains(owner.window->frameGeometry()));
        EXPECT_TRUE(!size || owner.window->size() == size);
    }
    FormOwner owner(test::businessLetter());
    owner.open({{}, Size{20'000, 20'000}});
    EXPECT_TRUE(room.contains(owner.window->frameGeometry()));
}

TEST(PlainFormWindow, ScrollsToTheFieldThatTakesTheKeys) {
    Letter letter;
    for (int field = 0; field < 200; ++field) {
        letter.text(u"\nLine ").field(u"f" + fromQString(QString::number(field)), field % 3 == 0 ? Number : Area);
    }
    FormOwner owner(letter);
    owner.open();
    EXPECT_LT(owner.window->height(), QGuiApplication::primaryScreen()->availableGeometry().height() * 0.7 + 1);
    for (int step = 0; step < 250; ++step) {
        const QWidget* focused = QApplication::focusWidget();
        ASSERT_EQ(focused->visibleRegion().boundingRect().size(), focused->size()) << owner.focus();
        owner.press(Qt::Key_Tab);
    }
}

// Letters of a language that runs from the right, with words of one that does not in between.
TEST(PlainFormWindow, HasFieldsWhereTextThatRunsFromTheRightLeavesRoom) {
    QGuiApplication::setLayoutDirection(Qt::RightToLeft);
    FormOwner owner(Letter()
                        .text(u"שלום ")
                        .field(u"a")
                        .sized(5, 0)
                        .text(u" וגם ")
                        .field(u"b")
                        .sized(5, 0)
                        .text(u"Plume, ")
                        .field(u"c")
                        .sized(5, 0)
                        .text(u" סוף"));
    owner.open();
    std::vector<QRect> places;
    for (const char* name : {"a", "b", "c"}) {
        const QLineEdit& line = owner.line(QString::fromLatin1(name));
        places.emplace_back(line.mapTo(owner.window.get(), QPoint(0, 0)), line.size());
    }
    const auto widthOf = [&](const char16_t* text) {
        return owner.window->fontMetrics().horizontalAdvance(QString::fromUtf16(text));
    };
    EXPECT_LT(places[0].right() + widthOf(u"שלום "), owner.window->width());
    EXPECT_NEAR(places[0].left() - places[1].right(), widthOf(u" וגם "), 10);
    EXPECT_NEAR(places[1].left() - places[2].right(), widthOf(u"Plume, "), 10);
    if (const QString folder = qEnvironmentVariable("PLUME_PICTURES"); !folder.isEmpty()) {
        owner.window->grab().save(folder + QStringLiteral("/PlainForm-Hebrew.png"));
    }
    QGuiApplication::setLayoutDirection(Qt::LeftToRight);
}

TEST(PlainFormWindow, ShowsOfALongTextWhatIsNearItsFields) {
    std::u16string lines;
    for (int line = 0; line < 20'000; ++line) lines += u"Lorem ipsum dolor sit amet, consectetur adipiscing.\n";
    const Letter letter = Letter().text(lines).field(u"x").text(std::u16string(500'000, u'y'));
    FormOwner owner(letter);
    owner.open();
    constexpr int Much = 100'000;
    for (const QTextEdit* text : owner.window->findChildren<QTextEdit*>()) {
        EXPECT_LT(text->document()->characterCount(), Much);
    }
    EXPECT_EQ(owner.focus(), "x");
}

TEST(PlainFormWindow, ShowsManyFields) {
    Letter letter;
    for (int field = 0; field < 1000; ++field) letter.text(u"\nLine ").field(u"x");
    FormOwner owner(letter);
    owner.open();
    owner.type("1");
    EXPECT_EQ(shownIn(owner.line("x", 999)), u"1");
}

}  // namespace
}  // namespace plume

#include "app/editor/ChipForm.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QAccessible>
#include <QListView>
#include <QPushButton>
#include <QSet>

#include "tests/app/editor/ChipSupport.h"

namespace plume {
namespace {

using namespace test;
using ::testing::HasSubstr;
using ::testing::Not;

class ChipFormTest : public ::testing::Test {
  protected:
    void TearDown() override { delete form; }
    void open(const std::u16string& body) {
        delete form;
        form = world.open(body);
        if (!form) throw std::runtime_error("no form");
        activate(*form);
    }
    std::string body() { return toUtf8(form->body()); }

    ChipWorld world;
    QPointer<ChipForm> form;
};

TEST_F(ChipFormTest, WhatWasNotTouchedStaysAsItIsWritten) {
    for (const char16_t* body : {
             u"date:short year:0 day:99999999999 colour:red",
             u"date:\"d MMMM\" valueType:7 weekday:9 locale:xx_YY@odd=1 optional:1",
             u"time:HH:mm minute:5 minute:6",
             u"clipboardish find:\"a\nb\" flags:99",
             u"snippet:gone uuid:nonsense readonly",
             u"field:A type:77 value:\"x\ny\" width:99999 height:-4",
             u"field type:2 value:\"a\r\nb\u2028c\u00A0d\" width:2",
             u"key:x code:70000 modifiers:9999999 count:99999 delay:1,234.5678",
             u"▲",
         }) {
        open(body);
        QTest::keyClick(form, Qt::Key_Return);
        EXPECT_EQ(world.done, body) << toUtf8(body);
    }
}

struct Use {
    const char16_t* body;
    const char* control;
    const char* value;
    const char16_t* expected;
};

class ChipControlTest : public ChipFormTest, public ::testing::WithParamInterface<Use> {};

// Exactly its own parameter: all others, and what no control knows, stay.
TEST_P(ChipControlTest, ChangesItsParameterAlone) {
    const Use& each = GetParam();
    open(each.body);
    use(*form, QString::fromUtf8(each.control), QString::fromUtf8(each.value));
    EXPECT_EQ(body(), toUtf8(each.expected));
}

constexpr Use DateUses[] = {
    {u"date:short day:1 x:y", "Style:", "Full", u"date:full day:1 x:y"},
    {u"date:yyyy locale:fr_FR", "Style:", "Short", u"date:short locale:fr_FR"},
    {u"date:short day:2", "Style:", "Own pattern", u"date:yyyy-MM-dd day:2"},
    {u"date:yyyy day:1", "Pattern", "EEEE d:M", u"date:\"EEEE d:M\" day:1"},
    {u"date:short day:1 locale:de_DE", "Day:", "next", u"date:short valueType:1 weekday:0 locale:de_DE"},
    {u"date:short valueType:1 weekday:3", "Day:", "last", u"date:short valueType:2 weekday:3"},
    {u"date:short valueType:1 weekday:3", "Day:", "From today", u"date:short"},
    {u"date:short month:2 day:3", "Years added", "-1", u"date:short year:-1 month:2 day:3"},
    {u"date:short year:1 day:3", "Months added", "14", u"date:short year:1 month:14 day:3"},
    {u"date:short year:1 month:2 day:3", "Days added", "0", u"date:short year:1 month:2"},
    {u"date:short valueType:2 weekday:3 x:y", "Weekday:", "Saturday", u"date:short valueType:2 weekday:6 x:y"},
    {u"date:short day:1", "Language:", "French (France)", u"date:short day:1 locale:fr_FR"},
    {u"date:short locale:fr_FR", "Language:", "xx_YY@a=b", u"date:short locale:xx_YY@a=b"},
    {u"date:short day:1", "Can be left out when the form is filled in", "", u"date:short day:1 optional:0"},
    {u"date:short optional:0", "Is ticked at first", "", u"date:short optional:1"},
    {u"time:short x:y", "Style:", "Medium", u"time:medium x:y"},
    {u"time:HH hour:1", "Pattern", "HH:mm", u"time:\"HH:mm\" hour:1"},
    {u"time:short minute:2", "Hours added", "-3", u"time:short hour:-3 minute:2"},
    {u"time:short hour:1", "Minutes added", "90", u"time:short hour:1 minute:90"},
    {u"time:short hour:1", "Seconds added", "7", u"time:short hour:1 second:7"},
    {u"time:short hour:1", "Language:", "German (Germany)", u"time:short hour:1 locale:de_DE"},
    {u"time:short", "Can be left out when the form is filled in", "", u"time:short optional:0"},
};
INSTANTIATE_TEST_SUITE_P(Dates, ChipControlTest, ::testing::ValuesIn(DateUses));

constexpr Use FieldUses[] = {
    {u"field:A value:v width:9 x:y", "Name:", "Last name", u"field:\"Last name\" value:v width:9 x:y"},
    {u"field:A value:v width:9", "Kind:", "several", u"field:A type:1 value:v width:9"},
    {u"field:A type:1 value:v height:3 readonly", "Kind:", "Number", u"field:A type:3 value:v"},
    {u"field:A value:v", "Kind:", "Menu", u"field:A type:2 width:0 value:v"},
    {u"field:A width:9", "Begins with:", "a b", u"field:A value:\"a b\" width:9"},
    {u"field:A type:1 value:v", "Begins with:", "one\ntwo", u"field:A type:1 value:one\ntwo"},
    {u"field:A type:3 value:1", "Begins with:", "=2*B", u"field:A type:3 value:=2*B"},
    {u"field:A type:2 value:a defaultIndex:0 x:y", "Choices, one a line:", "a\nb c",
     u"field:A type:2 width:0 value:\"a\nb c\" x:y"},
    {u"field:A type:2 value:a\nb\nc", "Chosen at first:", "c", u"field:A type:2 width:2 value:a\nb\nc defaultIndex:2"},
    {u"field:A type:1 height:3", "Width in letters:", "40", u"field:A type:1 width:40 height:3"},
    {u"field:A type:1 width:40", "Height in lines:", "7", u"field:A type:1 width:40 height:7"},
    {u"field:A type:1 width:40 height:3", "Width in letters:", "0", u"field:A type:1 height:3"},
    {u"field:A width:40", "Cannot be edited in the form", "", u"field:A readonly width:40"},
    {u"field:A readonly", "Can be left out when the form is filled in", "", u"field:A optional:0 readonly"},
    {u"field:A optional:1 readonly", "Is ticked at first", "", u"field:A optional:0 readonly"},
};
INSTANTIATE_TEST_SUITE_P(Fields, ChipControlTest, ::testing::ValuesIn(FieldUses));

constexpr Use OtherUses[] = {
    {u"clipboard flags:13 x:y", "Find:", "a b", u"clipboard find:\"a b\" flags:13 x:y"},
    {u"clipboard find:a", "Find:", "", u"clipboard flags:0"},
    {u"clipboard find:a flags:2", "Replace with:", "\"", u"clipboard find:a replacement:\"\"\"\" flags:2"},
    {u"clipboard find:a flags:9", "Is a regular expression; $1 is its first group", "", u"clipboard find:a flags:8"},
    {u"clipboard find:a flags:8", "Found:", "Whole", u"clipboard find:a flags:12"},
    {u"clipboard find:a flags:6", "Capitals and small letters differ", "", u"clipboard find:a flags:14"},
    {u"clipboard find:a", "Can be left out when the form is filled in", "", u"clipboard find:a flags:0 optional:0"},
    {u"key:↩ code:36 count:3 x:y", "Key", "Tab", u"key:⇥ code:48 count:3 x:y"},
    {u"key:↩ code:36 delay:0.5", "Key", "K", u"key:K code:40 delay:0.5"},
    {u"key:↩ code:36 modifiers:65536", "Shift", "", u"key:↩ code:36 modifiers:196608"},
    {u"key:↩ code:36 modifiers:1966080", "Ctrl", "", u"key:↩ code:36 modifiers:1703936"},
    {u"key:↩ code:36", "Alt", "", u"key:↩ code:36 modifiers:524288"},
    {u"key:↩ code:36", "Super", "", u"key:↩ code:36 modifiers:1048576"},
    {u"key:odd code:36 delay:2", "Times pressed:", "12", u"key:odd code:36 count:12 delay:2"},
    {u"key:odd code:36 count:2", "Waits before:", "1.25", u"key:odd code:36 count:2 delay:1.25"},
    {u"▶", "Times pressed:", "2", u"key:▶ code:124 count:2"},
    {u"snippet:s uuid:x", "Can be left out when the form is filled in", "", u"snippet:s uuid:x optional:0"},
};
INSTANTIATE_TEST_SUITE_P(Others, ChipControlTest, ::testing::ValuesIn(OtherUses));

TEST_F(ChipFormTest, ShowsWhatItGivesWhileOneTypes) {
    const struct {
        const char16_t* body;
        const char* control;
        const char* value;
        const char* said;
    } cases[] = {
        {u"date:short", "Days added", "1", "Gives: 3/10/26"},
        {u"date:yyyy", "Pattern", "EEEE", "Gives: Monday"},
        {u"date:yyyy", "Pattern", "bogus", "letters without a meaning"},
        {u"date:full", "Language:", "French (France)", "Gives: lundi 9 mars 2026"},
        {u"time:HH", "Minutes added", "60", "Gives: 15"},
        {u"clipboard find:a", "Replace with:", "x", "Gives: x xb bx"},
        {u"clipboard find:a flags:1", "Find:", "(", "no valid pattern"},
        {u"field:A type:2 value:a\nb", "Chosen at first:", "b", "Gives at first: b"},
        {u"field:A type:2 value:a", "Choices, one a line:", "", "is not shown"},
        {u"key:↩ code:36", "Times pressed:", "3", "Presses Return, 3 times"},
    };
    for (const auto& each : cases) {
        open(each.body);
        EXPECT_THAT(textOf(*form), Not(HasSubstr(each.said)));
        use(*form, QString::fromUtf8(each.control), QString::fromUtf8(each.value));
        EXPECT_THAT(textOf(*form), HasSubstr(each.said));
    }
}

TEST_F(ChipFormTest, WhatWouldEndThePlaceholderIsNotAccepted) {
    open(u"field:A");
    use(*form, QStringLiteral("Name:"), QStringLiteral("a】b"));
    EXPECT_THAT(textOf(*form), HasSubstr("cannot stand in one"));
    QTest::keyClick(form, Qt::Key_Return, Qt::ControlModifier);
    EXPECT_TRUE(form && form->isVisible());
    EXPECT_FALSE(world.done);
    use(*form, QStringLiteral("Name:"), QStringLiteral("a【b"));
    QTest::keyClick(form, Qt::Key_Return);
    EXPECT_EQ(world.done, u"field:a【b");
}

TEST_F(ChipFormTest, EscapeLeavesEverythingAsItWas) {
    open(u"date:short");
    use(*form, QStringLiteral("Days added"), QStringLiteral("1"));
    QTest::keyClick(form, Qt::Key_Escape);
    processDeletions();
    EXPECT_FALSE(form);
    EXPECT_FALSE(world.done);
    EXPECT_FALSE(world.open(u"|"));
    EXPECT_FALSE(world.open(u"no placeholder"));
}

// Everything that takes the keyboard is reached by Tab, and says what it is.
TEST_F(ChipFormTest, TabReachesEveryControlAndEachHasAName) {
    world.add(u"sig", u"Jo");
    for (const char16_t* body : {u"date:yyyy optional:1", u"date:short valueType:1", u"time:HH", u"clipboard",
                                 u"snippet:sig", u"field:A type:1", u"field:A type:2 value:a", u"key:↩ code:36"}) {
        SCOPED_TRACE(toUtf8(body));
        open(body);
        QSet<QWidget*> reached;
        for (int i = 0; i < 60; ++i) {
            QTest::keyClick(form->focusWidget(), Qt::Key_Tab);
            reached.insert(form->focusWidget());
        }
        QSet<QString> mnemonics;
        for (QWidget* each : form->findChildren<QWidget*>()) {
            if (!each->isVisible() || !each->isEnabled() || !(each->focusPolicy() & Qt::TabFocus)) continue;
            if (each->focusProxy() || qobject_cast<QComboBox*>(each->parent()) ||
                qobject_cast<QAbstractSpinBox*>(each->parent()))
                continue;
            EXPECT_TRUE(reached.contains(each)) << each->metaObject()->className();
            auto* interface = QAccessible::queryAccessibleInterface(each);
            EXPECT_FALSE(interface->text(QAccessible::Name).isEmpty()) << each->metaObject()->className();
        }
        for (QWidget* each : form->findChildren<QWidget*>()) {
            const QString text = each->isVisible() ? each->property("text").toString() : QString();
            const qsizetype place = text.indexOf(QLatin1Char('&'));
            if (place < 0 || qobject_cast<QLineEdit*>(each)) continue;
            const QString letter = text.mid(place + 1, 1).toLower();
            EXPECT_FALSE(mnemonics.contains(letter)) << text.toStdString();
            mnemonics.insert(letter);
        }
    }
}

TEST_F(ChipFormTest, RecordsTheNextKeyWithItsModifiers) {
    open(u"key:↩ code:36 modifiers:65536 count:2");
    click(*form, QStringLiteral("Record"));
    ASSERT_TRUE(world.keyPressed);
    world.keyPressed({KeyModifier::Shift, KeyCode::None});
    ASSERT_TRUE(world.keyPressed) << "modifiers alone are no key";
    world.keyPressed({KeyModifier::Control | KeyModifier::Shift, KeyCode::K});
    EXPECT_FALSE(world.keyPressed);
    EXPECT_EQ(body(), toUtf8(u"key:K code:40 modifiers:458752 count:2"));
    EXPECT_TRUE(find<QCheckBox>(*form, QStringLiteral("Ctrl")).isChecked());
    EXPECT_THAT(textOf(*form), HasSubstr("Presses Ctrl+Shift+K, 2 times"));

    click(*form, QStringLiteral("Record"));
    world.keyPressed({{}, KeyCode::Escape});
    EXPECT_FALSE(world.keyPressed);
    EXPECT_EQ(body(), toUtf8(u"key:K code:40 modifiers:458752 count:2"));
    click(*form, QStringLiteral("Record"));
    find<QCheckBox>(*form, QStringLiteral("Alt")).setFocus();
    EXPECT_FALSE(world.keyPressed) << "the focus is elsewhere";
    click(*form, QStringLiteral("Record"));
    form->reject();
    processDeletions();
    EXPECT_FALSE(world.keyPressed) << "the form is gone";
}

TEST_F(ChipFormTest, ASnippetIsChosenByItsIdentity) {
    world.add(u"sig", u"Jo Doe");
    const auto second = world.add(u"sig", u"The other one", u"Formal");
    const auto own = world.services.inside = world.add(u"own", u"outer");
    open(u"snippet:gone x:y");
    EXPECT_THAT(textOf(*form), HasSubstr("no snippet with this abbreviation"));
    auto& query = find<QLineEdit>(*form, QStringLiteral("Search:"));
    QTest::keyClicks(&query, QStringLiteral("own"));
    EXPECT_EQ(find<QListView>(*form, QStringLiteral("Snippets")).model()->rowCount(), 0) << "not into itself";
    EXPECT_EQ(body(), toUtf8(u"snippet:gone x:y"));
    query.clear();
    QTest::keyClicks(&query, QStringLiteral("formal"));
    QTest::keyClick(&query, Qt::Key_Down);
    EXPECT_THAT(textOf(*form), HasSubstr("Gives: The other one"));
    QTest::keyClick(&query, Qt::Key_Return);
    EXPECT_EQ(world.done, u"snippet:sig uuid:" + second->uuid()->toString() + u" x:y");

    // Shown as chosen when it is opened again; another search changes nothing.
    const std::u16string accepted = *world.done;
    open(accepted);
    EXPECT_EQ(find<QListView>(*form, QStringLiteral("Snippets")).currentIndex().row(), 1);
    QTest::keyClicks(&find<QLineEdit>(*form, QStringLiteral("Search:")), QStringLiteral("jo"));
    EXPECT_EQ(form->body(), accepted);
}

TEST_F(ChipFormTest, Pictures) {
    world.add(u"sig", u"Jo Doe", u"Signature");
    world.add(u"addr", u"1 Main Street\nSpringfield");
    const struct {
        const char16_t* body;
        const char* name;
    } cases[] = {{u"date:short day:1", "DateForm"},
                 {u"date:yyyy valueType:1 weekday:3", "DateFormWeekday"},
                 {u"time:short hour:1", "TimeForm"},
                 {u"clipboard find:a replacement:x", "ClipboardForm"},
                 {u"snippet:sig", "SnippetForm"},
                 {u"field:Name value:Jo", "FieldForm"},
                 {u"field:Name type:1 value:Jo", "FieldFormLines"},
                 {u"field:Size type:2 value:a\nb\nc", "FieldFormMenu"},
                 {u"key:↩ code:36 count:3", "KeyForm"}};
    for (const auto& each : cases) {
        open(each.body);
        // Nothing is cut: every control has the room that it asks for.
        for (const QAbstractButton* button : form->findChildren<QAbstractButton*>()) {
            if (!button->isVisible()) continue;
            EXPECT_GE(button->width(), button->minimumSizeHint().width()) << each.name;
        }
        takePicture(*form, QString::fromUtf8(each.name));
    }
}

}  // namespace
}  // namespace plume

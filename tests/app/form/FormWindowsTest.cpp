// The forms that are open, whatever draws them: what the other side is told, what is kept, and what happens where pages
// cannot be drawn.
#include "app/form/FormWindows.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QClipboard>
#include <QDialog>
#include <QGuiApplication>
#include <QPushButton>

#include "app/qt/QtRunLoop.h"
#include "library/MemoryUserDefaults.h"
#include "tests/app/form/FormSupport.h"

namespace plume {
namespace {

using test::Letter;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

class FormWindowsTest : public testing::Test {
  protected:
    // The program that draws pages: what stands for it here draws none.
    void make(const std::string& program) {
        forms_ = std::make_unique<FormWindows>(
            FormWindows::Services{.mainLoop = loop_,
                                  .settings = settings_,
                                  .program = program,
                                  .programRuns = [](std::int64_t) {},
                                  .report = [this](const std::string& sentence) { reports_.push_back(sentence); }});
    }
    void open(FormView::Id id, const Letter& letter) {
        content_ = std::make_shared<SnippetExpandedContent>(letter.content());
        content_->originalSnippet = std::make_shared<Snippet>(u"dear", u"");
        content_->originalSnippet->setLabel(u"A letter");
        forms_->prepare(id, content_,
                        {.shown = [this](std::uint32_t) { told_.emplace_back("shown"); },
                         .lost = [this] { told_.emplace_back("lost"); },
                         .accepted = [this] { told_.emplace_back("accepted"); },
                         .cancelled = [this] { told_.emplace_back("cancelled"); },
                         .stayed = [this] { told_.emplace_back("stayed"); }});
        forms_->show(id, {});
        ASSERT_TRUE(QTest::qWaitFor([this] { return !told_.empty() && told_.back() == "shown"; }));
    }
    static QDialog* windowCalled(const QString& title) {
        for (QWidget* window : QApplication::topLevelWidgets()) {
            auto* const dialog = qobject_cast<QDialog*>(window);
            if (dialog && dialog->isVisible() && dialog->windowTitle().startsWith(title)) return dialog;
        }
        return nullptr;
    }
    static QDialog* form() { return windowCalled("A letter"); }
    static void type(const QString& text) { QTest::keyClicks(form()->focusWidget(), text); }
    void press(Qt::Key key) {
        QTest::keyClick(form()->focusWidget(), key);
        QTest::qWait(0);
    }
    std::vector<std::string> takeTold() { return std::exchange(told_, {}); }
    // Of the window that keeps what was not sent.
    static void click(const char* name) {
        for (QPushButton* button : windowCalled("Text Not Inserted")->findChildren<QPushButton*>()) {
            if (button->text().remove('&') != name) continue;
            button->click();
            return QTest::qWait(1);
        }
        FAIL() << "no button is called " << name;
    }

    static inline const Letter Dear = Letter().text(u"Dear ").field(u"Name").text(u", bye ").field(u"Name");

    QtRunLoop loop_;
    MemoryUserDefaults settings_;
    std::vector<std::string> reports_;
    std::vector<std::string> told_;
    std::shared_ptr<SnippetExpandedContent> content_;
    std::unique_ptr<FormWindows> forms_;
};

TEST_F(FormWindowsTest, WithoutItsProgramFormsArePlainWindowsAndThatIsSaidOnce) {
    make("/nowhere/plume-form");
    open(1, Dear);
    type("Ada");
    press(Qt::Key_Return);
    EXPECT_THAT(takeTold(), ElementsAre("shown", "accepted"));
    EXPECT_EQ(form(), nullptr);
    EXPECT_EQ(content_->fields()[1]->value, u"Ada");
    forms_->close(1);
    open(2, Dear);
    press(Qt::Key_Escape);
    EXPECT_THAT(takeTold(), ElementsAre("shown", "cancelled"));
    EXPECT_THAT(reports_, ElementsAre(HasSubstr("not installed")));
}

TEST_F(FormWindowsTest, FormsArePlainWindowsWhereTheUserWantsThem) {
    settings_.set("PlainForms", PropertyList(true));
    make("/nowhere/plume-form");
    open(1, Dear);
    EXPECT_NE(form(), nullptr);
    EXPECT_THAT(reports_, IsEmpty());
}

TEST_F(FormWindowsTest, FormsOfAProgramThatDiesAtItsStartComeAsPlainWindows) {
    make("/bin/false");
    open(1, Dear);
    EXPECT_THAT(takeTold(), ElementsAre("lost", "lost", "shown"));
    type("Ada");
    press(Qt::Key_Return);
    EXPECT_THAT(takeTold(), ElementsAre("accepted"));
    EXPECT_THAT(reports_, ElementsAre(HasSubstr("plain window")));
    open(2, Dear);
    EXPECT_THAT(takeTold(), ElementsAre("lost", "shown"));
    open(3, Dear);
    EXPECT_THAT(takeTold(), ElementsAre("shown")) << "nobody waits for it any more";
    EXPECT_THAT(reports_, testing::SizeIs(1));
}

TEST_F(FormWindowsTest, AFormOpensAsLargeAsItWas) {
    make("/nowhere/plume-form");
    open(1, Dear);
    form()->resize(533, 377);
    QTest::qWait(0);
    press(Qt::Key_Escape);
    EXPECT_EQ(settings_.stringForKey("FieldsEditorSize dear"), u"{533, 377}");
    open(2, Dear);
    EXPECT_EQ(form()->size(), QSize(533, 377));
    forms_->close(2);
    for (const char16_t* const unreadable : {u"{0, 0}", u"{1e9, 5}", u"large", u"{-4, 7", u""}) {
        settings_.set("FieldsEditorSize dear", PropertyList(std::u16string(unreadable)));
        open(3, Dear);
        EXPECT_GT(form()->width(), 200) << toQString(unreadable).toStdString();
        EXPECT_LT(form()->width(), 2'000);
        forms_->close(3);
    }
}

TEST_F(FormWindowsTest, SeveralAreOpenAtATime) {
    make("/nowhere/plume-form");
    open(1, Dear);
    QDialog* const first = form();
    const auto firstContent = content_;
    QTest::keyClicks(first->focusWidget(), "one");
    open(2, Dear);
    forms_->close(2);
    EXPECT_EQ(form(), first);
    press(Qt::Key_Return);
    EXPECT_EQ(firstContent->fields()[0]->value, u"one");
}

TEST_F(FormWindowsTest, KeepsWhatWasNotSent) {
    make("/nowhere/plume-form");
    open(1, Dear);
    type("Ada");
    press(Qt::Key_Return);
    takeTold();
    forms_->keepUnsent(1, "The window is gone.");
    click("Copy");
    EXPECT_EQ(QGuiApplication::clipboard()->text(), "Dear Ada, bye Ada");
    EXPECT_THAT(takeTold(), IsEmpty());
    click("Try Again");
    EXPECT_THAT(takeTold(), ElementsAre("accepted"));
    EXPECT_EQ(windowCalled("Text Not Inserted"), nullptr);

    forms_->keepUnsent(1, "The window is gone.");
    click("Discard");
    EXPECT_THAT(takeTold(), ElementsAre("cancelled"));
    EXPECT_EQ(windowCalled("Text Not Inserted"), nullptr);
    forms_->keepUnsent(99, "Nobody knows this form.");
    EXPECT_EQ(windowCalled("Text Not Inserted"), nullptr);
}

}  // namespace
}  // namespace plume

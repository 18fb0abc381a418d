#include "app/preferences/ApplicationList.h"

#include <gtest/gtest.h>

#include <QInputDialog>
#include <QLabel>
#include <QListView>
#include <QMenu>
#include <QPushButton>
#include <QTreeView>
#include <memory>

#include "app/preferences/ProgramChooser.h"
#include "tests/app/preferences/PreferencesSupport.h"

namespace plume {
namespace {

using Identifiers = ApplicationList::Identifiers;

class ApplicationListTest : public testing::Test, protected test::PreferencesWorld {
  protected:
    ApplicationListTest() {
        list->setTitle("Ignored");
        QObject::connect(list.get(), &ApplicationList::edited, [this](const Identifiers& now) { edited = now; });
        test::bringUp(*list);
    }
    ~ApplicationListTest() override { test::letGo(); }

    void add(const QString& way) {
        auto* button = test::named<QPushButton>(*list, "Add a program");
        for (QAction* action : button->menu()->actions()) {
            if (action->text().remove(u'&') == way) action->trigger();
        }
    }
    QStringList shown() {
        const auto* model = list->findChild<QListView*>()->model();
        QStringList names;
        for (int row = 0; row < model->rowCount(); ++row) names.append(model->index(row, 0).data().toString());
        return names;
    }
    template <typename Dialog>
    Dialog* dialog() {
        return qobject_cast<Dialog*>(QApplication::activeModalWidget());
    }

    const ProgramServices around = programs();
    ProgramCatalog catalog{around};
    std::unique_ptr<ApplicationList> list = std::make_unique<ApplicationList>(around, catalog);
    std::optional<Identifiers> edited;
};

TEST_F(ApplicationListTest, ShowsNamesAndIdentifiersOfProgramsThatNobodyKnows) {
    list->setIdentifiers({u"KITTY", u"org.example.Gone"});
    EXPECT_EQ(shown(), (QStringList{"Kitty Terminal", "org.example.Gone"}));
    EXPECT_FALSE(edited);
}

TEST_F(ApplicationListTest, TakesRunningPrograms) {
    add("Running Program…");
    auto* chooser = dialog<ProgramChooser>();
    ASSERT_TRUE(chooser);
    auto* view = chooser->findChild<QTreeView*>();
    EXPECT_EQ(view->model()->rowCount(), 2) << "each once, and none without an identifier";
    auto* filter = chooser->findChild<QLineEdit*>();
    QTest::keyClicks(filter, "chat");
    QTest::keyClick(filter, Qt::Key_Return);
    EXPECT_EQ(edited, Identifiers{u"mychat"});
    EXPECT_EQ(shown(), QStringList{"My Chat"});
}

TEST_F(ApplicationListTest, TakesInstalledProgramsAndIdentifiersByHand) {
    add("Installed Program…");
    auto* chooser = dialog<ProgramChooser>();
    ASSERT_TRUE(chooser);
    chooser->findChild<QTreeView*>()->selectAll();
    QTest::mouseClick(test::withText<QPushButton>(*chooser, "Add Program"), Qt::LeftButton);
    EXPECT_EQ(edited, (Identifiers{u"kitty", u"org.gnome.gedit"}));
    test::letGo();
    add("Type an Identifier…");
    auto* question = dialog<QInputDialog>();
    ASSERT_TRUE(question);
    question->setTextValue("  old-terminal ");
    question->accept();
    EXPECT_EQ(edited->back(), u"old-terminal");
}

TEST_F(ApplicationListTest, TakesAProgramThatIsPointedAt) {
    list->setIdentifiers({u"kitty"});
    add("Point at a Window…");
    EXPECT_TRUE(test::withText<QLabel>(*list, "Click in a window of the program within 20 seconds."));
    pointed(std::nullopt);
    EXPECT_TRUE(test::withText<QLabel>(*list, "No window of another program was clicked."));
    pointed(test::program(u"kitty"));
    EXPECT_TRUE(test::withText<QLabel>(*list, "Kitty Terminal is in the list already."));
    EXPECT_FALSE(edited);
    list.reset();
    pointed(test::program(u"mychat"));
}

TEST_F(ApplicationListTest, RemovesByTheKeyboard) {
    list->setIdentifiers({u"a", u"b", u"c"});
    auto* view = list->findChild<QListView*>();
    view->setCurrentIndex(view->model()->index(1, 0));
    QTest::keyClick(view, Qt::Key_Delete);
    EXPECT_EQ(edited, (Identifiers{u"a", u"c"}));
    QTest::keyClick(view, Qt::Key_Delete);
    QTest::keyClick(view, Qt::Key_Delete);
    QTest::keyClick(view, Qt::Key_Delete);
    EXPECT_EQ(edited, Identifiers());
}

}  // namespace
}  // namespace plume

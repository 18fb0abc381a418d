// The windows through which snippets come into the library and go out of it.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QAbstractItemModelTester>
#include <QCheckBox>
#include <QLineEdit>
#include <QListView>
#include <QMessageBox>
#include <QPointer>
#include <QProgressBar>
#include <QPushButton>
#include <QTimer>
#include <QTreeView>

#include "app/editor/ImportModel.h"
#include "app/editor/ImportWindow.h"
#include "app/editor/LibraryExportWindow.h"
#include "import/Importers.h"
#include "ports/posix/PosixFiles.h"
#include "tests/app/editing/EditedMachine.h"
#include "tests/app/windows/WindowsSupport.h"
#include "tests/support/TemporaryFolder.h"

namespace plume {
namespace {

using namespace test;
using ::testing::ElementsAre;
using ::testing::HasSubstr;

constexpr const char* TwoGroups = R"([
  {"name": "Mail", "abbreviationPrefix": ";", "items": [
    {"abbreviation": "sig", "content": "Kind regards,\nJo Doe", "label": "Signature"},
    {"abbreviation": "me", "content": "jo.doe@example.com"}]},
  {"name": "Words", "items": [
    {"abbreviation": "btw", "content": "by the way"},
    {"abbreviation": "imo", "content": "in my opinion"},
    {"abbreviation": "btw", "content": "between"}]}])";

class ImportWindowTest : public ::testing::Test {
  protected:
    ImportWindowTest() { machine.addGroup(u"Mine", {u";sig=Bye", u"imo=in my opinion", u"old=x"}); }
    ~ImportWindowTest() override { delete window; }

    void open(const char* path, const char* bytes) {
        if (bytes) {
            EXPECT_TRUE(machine.world.files.write(path, bytes));
        }
        window = new ImportWindow(nullptr,
                                  {.files = machine.world.files,
                                   .settings = machine.machine.settings,
                                   .library = [this]() -> const SnippetGroups& { return machine.editor.groups(); },
                                   .import = [this](const ImportedLibrary& chosen) { machine.editor.import(chosen); },
                                   .inBackground = inBackground},
                                  path);
        window->show();
    }
    QTreeView& list() { return find<QTreeView>(*window, QStringLiteral("Groups and snippets in the file")); }
    // "name | content | remark" of each row.
    std::vector<std::string> rows() {
        std::vector<std::string> all;
        for (int row = 0; row < list().model()->rowCount(); ++row) addRows(list().model()->index(row, 0), all);
        return all;
    }
    QPushButton* defaultButton() {
        for (auto* button : window->findChildren<QPushButton*>()) {
            if (button->isDefault() && button->isVisible()) return button;
        }
        return nullptr;
    }
    std::string buttonText() { return withoutMnemonic(defaultButton()->text()).toStdString(); }

    EditedMachine machine;
    std::function<void(std::function<void()>, std::function<void()>)> inBackground;
    QPointer<ImportWindow> window;

  private:
    static void addRows(const QModelIndex& index, std::vector<std::string>& all) {
        QStringList columns;
        for (int column = 0; column < index.model()->columnCount(); ++column) {
            columns += index.siblingAtColumn(column).data().toString();
        }
        all.push_back(columns.join(QLatin1String(" | ")).toStdString());
        for (int row = 0; row < index.model()->rowCount(index); ++row) {
            addRows(index.model()->index(row, 0, index), all);
        }
    }
};

TEST_F(ImportWindowTest, ShowsWhatComesAndImportsWhatIsNotLeftOut) {
    open("/two.json", TwoGroups);
    const QAbstractItemModelTester tester(list().model(), QAbstractItemModelTester::FailureReportingMode::Fatal);
    EXPECT_THAT(rows(),
                ElementsAre("Mail | 2 snippets | 1 abbreviation is taken",
                            ";sig | Signature | Is taken by another one in “Mine”", ";me | jo.doe@example.com | ",
                            "Words | 3 snippets | 1 is there already, 1 abbreviation is taken", "btw | by the way | ",
                            "imo | in my opinion | Is there already, in “Mine”",
                            "btw | between | Comes twice, also in “Words”"));
    EXPECT_THAT(textOf(*window), HasSubstr("“two.json”: 5 snippets in 2 groups"));
    list().expandAll();
    takePicture(*window, QStringLiteral("Import"));
    EXPECT_EQ(buttonText(), "Import 2 Groups");
    activate(*window);
    QTest::keyClick(&list(), Qt::Key_Space);
    EXPECT_EQ(buttonText(), "Import 1 Group");
    QTest::keyClick(&list(), Qt::Key_Return);
    processDeletions();
    EXPECT_FALSE(window);
    EXPECT_THAT(machine.library(), ElementsAre("Mine: ;sig=Bye imo=in my opinion old=x",
                                               "Words: btw=by the way imo=in my opinion btw=between"));
    machine.editor.undo(machine.done.back());
    EXPECT_THAT(machine.library(), ElementsAre("Mine: ;sig=Bye imo=in my opinion old=x"));
}

TEST_F(ImportWindowTest, NothingIsImportedWhenAllIsLeftOutOrTheWindowIsClosed) {
    open("/two.json", TwoGroups);
    for (int row = 0; row < 2; ++row) {
        list().model()->setData(list().model()->index(row, 0), Qt::Unchecked, Qt::CheckStateRole);
    }
    EXPECT_EQ(buttonText(), "Import");
    EXPECT_FALSE(defaultButton()->isEnabled());
    QTest::keyClick(&list(), Qt::Key_Return);
    QTest::keyClick(&list(), Qt::Key_Escape);
    processDeletions();
    EXPECT_FALSE(window);
    EXPECT_TRUE(machine.done.empty());
}

TEST_F(ImportWindowTest, TellsWhyNothingCanBeImported) {
    const struct {
        const char* path;
        const char* bytes;
        const char* told;
    } cases[] = {
        {"/damaged.json", "[{", "Nothing can be imported from “damaged.json”\n/damaged.json"},
        {"/gone.csv", nullptr, "Nothing can be imported from “gone.csv”\n/gone.csv"},
        {"/none.json", "[]", "There are no snippets in “none.json”\n"},
    };
    for (const auto& each : cases) {
        open(each.path, each.bytes);
        EXPECT_THAT(textOf(*window), HasSubstr(each.told));
        EXPECT_EQ(defaultButton(), nullptr);
        takePicture(*window, QStringLiteral("ImportFailed"));
        click(*window, QStringLiteral("Close"));
        processDeletions();
        EXPECT_FALSE(window) << each.path;
    }
    EXPECT_TRUE(machine.done.empty());
}

TEST_F(ImportWindowTest, PlaceholdersOfACsvFileAreConvertedWhenAsked) {
    open("/macros.csv", "d,%Y\nplain,100 %\n");
    auto& converts = find<QCheckBox>(*window, QStringLiteral("Convert the placeholders of TextExpander"));
    takePicture(*window, QStringLiteral("ImportPlaceholders"));
    EXPECT_THAT(rows().at(1), HasSubstr("d | %Y | "));
    converts.click();
    EXPECT_TRUE(converts.isChecked());
    EXPECT_THAT(rows().at(1), HasSubstr("【date"));
    click(*window, QStringLiteral("Import 1 Group"));
    EXPECT_THAT(machine.library().back(), HasSubstr("d=【date"));
    processDeletions();

    open("/plain.csv", "btw,by the way\n");
    EXPECT_EQ(window->findChildren<QCheckBox*>().size(), 1);
    EXPECT_FALSE(window->findChild<QCheckBox*>()->isVisible());
}

TEST_F(ImportWindowTest, ShowsWhatCannotBeCarriedOverWhole) {
    open("/keys.ahk", ":*:btw::by the way\n::ty::thank you\n#IfWinActive ahk_class Notepad\n:?:x::y\n");
    auto& remarks = find<QListView>(*window, QStringLiteral("What cannot be carried over whole"));
    EXPECT_GT(remarks.model()->rowCount(), 0);
    takePicture(*window, QStringLiteral("ImportRemarks"));
}

TEST_F(ImportWindowTest, ClosingItWhileTheFileIsReadImportsNothing) {
    std::function<void()> work;
    std::function<void()> done;
    inBackground = [&](std::function<void()> begun, std::function<void()> ended) {
        work = std::move(begun);
        done = std::move(ended);
    };
    open("/two.json", TwoGroups);
    EXPECT_THAT(textOf(*window), HasSubstr("Reading “two.json”…"));
    EXPECT_TRUE(find<QProgressBar>(*window, QStringLiteral("Reading")).isVisible());
    EXPECT_FALSE(defaultButton()->isEnabled());
    takePicture(*window, QStringLiteral("ImportReading"));
    work();
    done();
    EXPECT_EQ(buttonText(), "Import 2 Groups");

    delete window;
    open("/two.json", TwoGroups);
    click(*window, QStringLiteral("Cancel"));
    processDeletions();
    EXPECT_FALSE(window);
    work();
    done();
    EXPECT_TRUE(machine.done.empty());
}

TEST_F(ImportWindowTest, ShowsALargeFile) {
    std::string bytes;
    for (int i = 0; i < 20'000; ++i) bytes += "a" + std::to_string(i) + ",text " + std::to_string(i) + "\n";
    open("/large.csv", bytes.c_str());
    EXPECT_EQ(list().model()->rowCount(list().model()->index(0, 0)), 20'000);
    EXPECT_THAT(textOf(*window), HasSubstr("20000 snippets in 1 group"));
}

// ---- Export ----

class LibraryExportWindowTest : public ::testing::Test {
  protected:
    LibraryExportWindowTest() {
        QCoreApplication::setAttribute(Qt::AA_DontUseNativeDialogs);
        mail = machine.addGroup(u"Mail/v1.2", {u"sig=Regards", u"me=jo@example.com"});
        words = machine.addGroup(u"Words", {u"btw=by the way"});
    }
    ~LibraryExportWindowTest() override {
        delete panel;
        while (auto* message = shownWindow<QMessageBox>()) delete message;
    }
    void started(LibraryExportWindow* window) {
        panel = window;
        panel->setDirectory(folder());
    }
    QString folder() const { return QString::fromStdString(temporary.path().string()); }
    void choose(const char* filter) {
        for (const QString& each : panel->nameFilters()) {
            if (!each.contains(QLatin1String(filter))) continue;
            panel->selectNameFilter(each);
            Q_EMIT panel->filterSelected(each);
        }
    }
    QLineEdit& name() { return *panel->findChild<QLineEdit*>(QStringLiteral("fileNameEdit")); }
    void accept() { QMetaObject::invokeMethod(panel, "accept"); }
    std::vector<std::string> groupsIn(const char* file) {
        const auto imported = importLibrary(temporary.path() / file, files);
        return imported ? described(imported.value().groups) : std::vector<std::string>{imported.error().message};
    }

    TemporaryFolder temporary;
    PosixFiles files;
    EditedMachine machine;
    std::shared_ptr<SnippetGroup> mail, words;
    QPointer<LibraryExportWindow> panel;
};

TEST_F(LibraryExportWindowTest, TheFilterChoosesTheEnding) {
    started(exportGroup(nullptr, *machine.machine.manager, files, mail));
    EXPECT_EQ(name().text(), QStringLiteral("Mail-v1.2.plume"));
    choose("*.csv");
    EXPECT_EQ(name().text(), QStringLiteral("Mail-v1.2.csv"));
    takePicture(*panel, QStringLiteral("Export"));
    accept();
    EXPECT_THAT(groupsIn("Mail-v1.2.csv"), ElementsAre("Mail-v1.2: sig=Regards me=jo@example.com"));
    processDeletions();
    EXPECT_FALSE(panel);
    started(exportGroup(nullptr, *machine.machine.manager, files, words));
    choose("*.json");
    name().setText(QStringLiteral("bare"));
    accept();
    EXPECT_THAT(groupsIn("bare.json"), ElementsAre("Words: btw=by the way"));
    processDeletions();
}

TEST_F(LibraryExportWindowTest, WritesEveryFormOfAllOfAGroupAndOfTheSelection) {
    const std::vector<std::string> all{"Mail/v1.2: sig=Regards me=jo@example.com", "Words: btw=by the way"};
    auto& manager = *machine.machine.manager;
    for (const char* ending : {"plume", "json", "rtf"}) {
        const std::string file = std::string("all.") + ending;
        started(exportLibrary(nullptr, manager, files));
        name().setText(QString::fromStdString(file));
        accept();
        processDeletions();
        if (std::string(ending) != "rtf") {
            EXPECT_EQ(groupsIn(file.c_str()), all);
        }
    }
    EXPECT_THAT(files.read(temporary.path() / "all.rtf").value(), HasSubstr("btw"));
    started(exportSelection(nullptr, manager, files, {{words}, {mail->items()[1]}}));
    name().setText(QStringLiteral("some.plume"));
    accept();
    EXPECT_THAT(groupsIn("some.plume"), ElementsAre("Mail/v1.2: me=jo@example.com", "Words: btw=by the way"));
    EXPECT_EQ(exportSelection(nullptr, manager, files, {}), nullptr);
}

TEST_F(LibraryExportWindowTest, WhatCannotBeWrittenIsToldWithTheFilesName) {
    for (const char* file : {"snippets.txt", "gone/x.csv"}) {
        started(exportLibrary(nullptr, *machine.machine.manager, files));
        panel->hide();
        Q_EMIT panel->fileSelected(folder() + QLatin1Char('/') + QLatin1String(file));
        auto* message = shownWindow<QMessageBox>();
        ASSERT_TRUE(message) << file;
        EXPECT_THAT(textOf(*message), HasSubstr("The snippets were not exported"));
        EXPECT_THAT(textOf(*message), HasSubstr(file));
        delete message;
        delete panel;
    }
}

TEST_F(LibraryExportWindowTest, AFileThatIsThereStaysUntilItsReplacementIsAgreed) {
    ASSERT_TRUE(files.write(temporary.path() / "there.json", "mine"));
    started(exportLibrary(nullptr, *machine.machine.manager, files));
    choose("*.json");
    name().setText(QStringLiteral("there"));
    QTimer::singleShot(0, panel, [] {
        for (QWidget* each : QApplication::topLevelWidgets()) {
            if (auto* question = qobject_cast<QMessageBox*>(each)) question->button(QMessageBox::No)->click();
        }
    });
    accept();
    EXPECT_EQ(files.read(temporary.path() / "there.json").value(), "mine");
    EXPECT_TRUE(panel && panel->isVisible());
}

}  // namespace
}  // namespace plume

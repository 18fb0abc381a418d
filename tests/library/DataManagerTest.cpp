// The library from the first start on: what is kept when, and what becomes of it when things go wrong.
#include "library/DataManager.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "library/LibraryExport.h"
#include "tests/library/LibraryMachine.h"

namespace plume {
namespace {

using test::Machine;
using test::SharedWorld;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::SizeIs;

constexpr const char* OneGroup = R"([{"name": "Given", "items": [{"abbreviation": "a", "content": "A"}]}])";

class DataManagerTest : public ::testing::Test {
  protected:
    SharedWorld world;
    Machine machine{world};
};

TEST_F(DataManagerTest, BeginsWithTheSampleAndWithWhatIsFoundBesides) {
    (void)world.files.write("/sample.json", OneGroup);
    (void)world.files.write("/te.json", R"([{"name": "Foreign", "items": []}])");
    machine.places.sampleLibrary = "/sample.json";
    machine.places.textExpanderSettings = "/te.json";
    machine.restart();
    machine.load();
    EXPECT_TRUE(machine.manager->emptyData());
    EXPECT_THAT(machine.library(), ElementsAre("Given: a=A", "Foreign:"));
    machine.restart();
    machine.load();
    EXPECT_FALSE(machine.manager->emptyData());
    EXPECT_THAT(machine.library(), SizeIs(2));
}

TEST_F(DataManagerTest, TakesTheEarlierLibraryInPlaceOfTheSample) {
    (void)world.files.write("/sample.json", R"([{"name": "Sample"}])");
    (void)world.files.write("/own.json", OneGroup);
    machine.places.sampleLibrary = "/sample.json";
    machine.places.ownEarlierLibrary = "/own.json";
    machine.restart();
    machine.load();
    EXPECT_THAT(machine.library(), ElementsAre("Given: a=A"));
}

TEST_F(DataManagerTest, HasEveryChangeInTheJournalWithinHalfASecondAndInTheArchiveAfterFive) {
    machine.load();
    machine.add(u"one");
    world.loop.advance(0.1);
    machine.add(u"two");
    world.loop.advance(0.35);
    machine.restart();
    machine.load();
    EXPECT_THAT(machine.library(), ElementsAre("Mine: one=text two=text"));
    EXPECT_THAT(machine.storage.load().value().journal, SizeIs(1));
    machine.add(u"three");
    world.loop.advance(5);
    EXPECT_THAT(machine.storage.load().value().journal, IsEmpty());
    machine.restart();
    machine.load();
    EXPECT_THAT(machine.library(), ElementsAre("Mine: one=text two=text three=text"));
}

TEST_F(DataManagerTest, ReplaysEveryKindOfChange) {
    machine.load();
    const auto first = machine.add(u"first");
    const auto second = machine.add(u"second");
    auto& groups = machine.manager->snippetGroups();
    const auto other = machine.manager->generateSnippetGroupSamples(u"Other", {u"x", u"X", u"y", u"Y", u"odd"});
    world.loop.advance(6);  // all this is in the archive
    const auto change = [&](const std::function<void()>& edit) {
        edit();
        machine.manager->notifyDataChanged();
        world.loop.advance(0.5);
    };
    change([&] { first->setPlainTextContent(u"changed"); });
    change([&] { second->setNote(u"a note"); });
    change([&] { groups.front()->removeItem(second); });
    change([&] { other->insertItem(second, 1); });
    change([&] { other->setAbbreviationPrefix(u";"); });
    change([&] { other->availability().applications = {{u"org.example.editor"}}; });
    change([&] { std::swap(groups[0], groups[1]); });
    change([&] { groups.push_back(SnippetGroup::make()); });
    change([&] { groups.erase(groups.begin() + 1); });
    const auto version = machine.manager->library().versionUUIDString;
    ASSERT_THAT(machine.storage.load().value().journal, SizeIs(9));
    machine.restart();
    machine.load();
    EXPECT_THAT(machine.library(), ElementsAre("Other: x=X second=text y=Y", "?:"));
    const auto& again = machine.manager->snippetGroups().front();
    EXPECT_EQ(again->abbreviationPrefix(), u";");
    EXPECT_EQ(again->items()[1]->note(), u"a note");
    EXPECT_EQ(again->items()[1]->dateModified(), second->dateModified());
    EXPECT_EQ(machine.manager->library().versionUUIDString, version);
    EXPECT_THAT(machine.reports, IsEmpty());
}

TEST_F(DataManagerTest, KeepsADamagedLibraryAsideAndOffersTheNewestBackup) {
    machine.load();
    machine.add(u"precious");
    ASSERT_TRUE(machine.manager->backups().backup());
    (void)machine.storage.save("no archive", machine.storage.load().value().generation);
    machine.restart();
    machine.load();
    EXPECT_THAT(machine.library(), IsEmpty());
    EXPECT_FALSE(machine.manager->emptyData());
    EXPECT_THAT(machine.reports, ElementsAre(HasSubstr("/damaged/Damaged Library 2026-01-31 10-00-00.plume")));
    EXPECT_EQ(world.files.read("/damaged/Damaged Library 2026-01-31 10-00-00.plume").value(), "no archive");
    ASSERT_THAT(machine.offered, SizeIs(1));
    ASSERT_TRUE(machine.manager->restoreFile(machine.offered.front().value()));
    EXPECT_THAT(machine.library(), ElementsAre("Mine: precious=text"));
}

TEST_F(DataManagerTest, ReportsOnceWhatCannotBeWrittenAndWritesItLater) {
    machine.load();
    machine.storage.disk().setFailure(Error{"the disk is full"});
    machine.add(u"one");
    world.loop.advance(200);
    EXPECT_THAT(machine.reports, ElementsAre("The library was not saved: the disk is full"));
    machine.storage.disk().setFailure(std::nullopt);
    world.loop.advance(60);
    machine.restart();
    machine.load();
    EXPECT_THAT(machine.library(), ElementsAre("Mine: one=text"));
}

TEST_F(DataManagerTest, RestoresOnlyWhatCanBeRead) {
    machine.load();
    machine.add(u"now");
    (void)world.files.write("/cut.plume", "bplist00");
    EXPECT_FALSE(machine.manager->restoreFile("/cut.plume"));
    EXPECT_FALSE(machine.manager->restoreFile("/none.plume"));
    EXPECT_THAT(machine.library(), ElementsAre("Mine: now=text"));
    EXPECT_THAT(machine.backupNames(), IsEmpty());

    (void)world.files.write("/given.json", OneGroup);
    const auto before = machine.manager->restoreFile("/given.json");
    ASSERT_TRUE(before);
    EXPECT_THAT(machine.library(), ElementsAre("Given: a=A"));
    EXPECT_THAT(machine.libraryIn(before.value()), ElementsAre("Mine: now=text"));
}

TEST_F(DataManagerTest, RestoresTheOldestBackupThoughItGoesByMakingRoom) {
    machine.load();
    machine.settings.set("BackupQuantity", std::int64_t{1});
    machine.add(u"old");
    const auto oldest = machine.manager->backups().backup();
    world.loop.advance(60);
    machine.add(u"new");
    ASSERT_TRUE(machine.manager->restoreFile(oldest.value()));
    EXPECT_FALSE(world.files.exists(oldest.value()));
    EXPECT_THAT(machine.library(), ElementsAre("Mine: old=text"));
}

TEST_F(DataManagerTest, TellsOfWholesaleChanges) {
    struct Listener {
        std::vector<std::string> heard;
        void willClear(LibraryEvent&) { heard.emplace_back("willClear"); }
        void didImport(LibraryEvent&) { heard.emplace_back("didImport"); }
    } listener;
    machine.load();
    DataManager& manager = *machine.manager;
    const auto a = manager.willClearDataEvent.addObserver(&listener, &Listener::willClear);
    const auto b = manager.didImportDataEvent.addObserver(&listener, &Listener::didImport);
    (void)world.files.write("/given.json", OneGroup);
    (void)manager.importDataFromFile("/given.json");
    (void)manager.importDataFromFile("/none.json");
    (void)manager.restoreFromFile("/given.json");
    EXPECT_THAT(listener.heard, ElementsAre("didImport", "didImport", "willClear", "didImport"));
}

TEST_F(DataManagerTest, ImportsTheSystemsListIntoItsOwnGroupAgainAndAgain) {
    machine.load();
    const auto list = [](const char* content) {
        return std::string(R"([{"name": "System's Symbol And Text Substitutions", "items": [{"content": ")") + content +
               R"("}]}])";
    };
    (void)world.files.write("/one.json", list("1"));
    (void)world.files.write("/two.json", list("2"));
    (void)machine.manager->importDataFromFile("/one.json");
    (void)machine.manager->importDataFromFile("/two.json");
    EXPECT_THAT(machine.library(), ElementsAre("System's Symbol And Text Substitutions: ?=2"));
}

TEST_F(DataManagerTest, WritesFilesByTheirEnding) {
    machine.load();
    machine.settings.set("LongTextLength", std::int64_t{50});
    machine.add(u"a", u"A, \"quoted\"")->setLabel(u"label");
    const auto group = machine.manager->snippetGroups().front();
    group->setAbbreviationPrefix(u";");
    (void)machine.manager->backupToFile("/all.CSV");
    (void)machine.manager->saveGroup(group, "/group.csv");
    (void)machine.manager->backupToFile("/all.txt");
    (void)machine.manager->backupToFile("/all.plume", true);
    (void)machine.manager->saveGroup(group, "/group.plume");
    EXPECT_EQ(world.files.read("/all.CSV").value(), ";a,\"A, \"\"quoted\"\"\"\n");
    EXPECT_EQ(world.files.read("/group.csv").value(), ";a,\"A, \"\"quoted\"\"\",label\n");
    EXPECT_FALSE(world.files.exists("/all.txt"));

    const auto all = readLibraryArchive(world.files.read("/all.plume").value(), {}).value();
    const auto one = readLibraryArchive(world.files.read("/group.plume").value(), {}).value();
    EXPECT_EQ(all.uuidString, machine.manager->library().uuidString);
    EXPECT_EQ(*PropertyList(all.preferences.value()).find<std::int64_t>("LongTextLength"), 50);
    EXPECT_FALSE(PropertyList(all.preferences.value()).find("IsEnabled"));
    EXPECT_FALSE(one.uuidString || one.versionUUIDString || one.dateCreated || one.preferences);
    EXPECT_EQ(one.dateInstalled, all.dateInstalled);
}

// ---- Two processes on one store ----

TEST_F(DataManagerTest, TakesOverWhatAnotherProcessHasWritten) {
    const auto disk = std::make_shared<SimulatedLibraryStorage::Disk>();
    Machine one(world, "one", disk);
    Machine two(world, "two", disk);
    one.load();
    one.add(u"shared");
    one.add(u"gone");
    world.loop.advance(6);
    two.load();
    EXPECT_EQ(two.library(), one.library());

    // What the other has left alone stays the very record that it was.
    one.restart();
    one.load();
    const auto group = one.manager->snippetGroups().front();
    const auto shared = group->items()[0];
    two.add(u"from two");
    two.manager->snippetGroups().front()->items()[1]->setNote(u"changed");
    two.manager->notifyDataChanged();
    world.loop.advance(0.5);
    EXPECT_THAT(one.library(), ElementsAre("Mine: shared=text gone=text from two=text"));
    EXPECT_EQ(one.manager->snippetGroups().front(), group);
    EXPECT_EQ(group->items()[0], shared);
    EXPECT_EQ(shared->parentGroup(), group);
    EXPECT_EQ(group->items()[1]->note(), u"changed");

    // Both at once: neither loses anything.
    auto& mine = *one.manager->snippetGroups().front();
    mine.items()[0]->setPlainTextContent(u"by one");
    mine.removeItem(mine.items()[1]);
    one.manager->notifyDataChanged();
    two.add(u"more");
    two.manager->snippetGroups().front()->setAbbreviationPrefix(u";");
    world.loop.advance(20);
    EXPECT_THAT(one.library(), ElementsAre("Mine: shared=by one from two=text more=text"));
    EXPECT_EQ(two.library(), one.library());
    EXPECT_EQ(one.manager->snippetGroups().front()->abbreviationPrefix(), u";");
    EXPECT_EQ(one.manager->library().versionUUIDString, two.manager->library().versionUUIDString);
    one.restart();
    one.load();
    EXPECT_EQ(two.library(), one.library());
}

}  // namespace
}  // namespace plume

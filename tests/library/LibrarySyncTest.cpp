// Two machines and the folder that they share.
#include "library/LibrarySync.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "tests/library/LibraryMachine.h"

namespace plume {
namespace {

using test::Machine;
using test::SharedWorld;
using ::testing::Contains;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::Not;
using ::testing::SizeIs;

constexpr const char* SyncFile = "/shared/Plume/Data.plume";

class LibrarySyncTest : public ::testing::Test {
  protected:
    void SetUp() override {
        (void)world.files.createFolder("/shared");
        for (Machine* machine : {&a, &b}) machine->load();
    }
    // Both have the same library, with one snippet in it.
    void meet() {
        a.add(u"common");
        a.syncWith("/shared");
        world.loop.advance(20);
        b.settings.set("SyncedVersionUUID", *b.manager->library().versionUUIDString);  // nothing of its own to keep
        b.syncWith("/shared");
        world.loop.advance(20);
        ASSERT_EQ(b.library(), a.library());
    }

    SharedWorld world;
    Machine a{world, "a"};
    Machine b{world, "b"};
};

TEST_F(LibrarySyncTest, AChangeArrivesElevenSecondsLater) {
    meet();
    a.add(u"new");
    world.loop.advance(9.9);
    EXPECT_THAT(b.library(), ElementsAre("Mine: common=text"));
    world.loop.advance(1.5);
    EXPECT_THAT(b.library(), ElementsAre("Mine: common=text new=text"));
    world.loop.advance(30);
    EXPECT_THAT(a.backupNames(), IsEmpty());
    EXPECT_THAT(b.backupNames(), IsEmpty());
    b.restart();
    b.load();
    EXPECT_THAT(b.library(), ElementsAre("Mine: common=text new=text"));
}

TEST_F(LibrarySyncTest, ADownloadKeepsWhatWasNotSent) {
    meet();
    a.add(u"from a");
    world.loop.advance(5);
    b.add(u"from b");
    world.loop.advance(8);  // a has sent, b not yet; its change has put the download off
    world.loop.advance(40);
    EXPECT_EQ(a.library(), b.library());
    std::vector<std::string> kept;
    for (Machine* machine : {&a, &b}) {
        for (const auto& backup : machine->manager->backups().backups()) {
            for (const auto& group : machine->libraryIn(backup.path)) kept.push_back(group);
        }
        for (const auto& group : machine->library()) kept.push_back(group);
    }
    EXPECT_THAT(kept, Contains(HasSubstr("from a")));
    EXPECT_THAT(kept, Contains(HasSubstr("from b")));
}

TEST_F(LibrarySyncTest, KeepsWhatCameInTheLastMomentBeforeItSends) {
    meet();
    b.add(u"of b");
    b.add(u"more");
    const std::string other = b.manager->archivedDataIncludingPreferences(false);
    b.restart();  // and never sends it itself
    a.add(u"of a");
    world.files.setBeforeReplace([&] { (void)world.files.write(SyncFile, other); });
    world.loop.advance(30);
    ASSERT_THAT(a.backupNames(), SizeIs(1));
    EXPECT_THAT(a.libraryIn("/a/Backups/" + a.backupNames()[0]), ElementsAre("Mine: common=text of b=text more=text"));
    EXPECT_THAT(a.libraryIn(SyncFile), ElementsAre("Mine: common=text of a=text"));
}

TEST_F(LibrarySyncTest, OneThatStartsLaterTakesTheLaterLibrary) {
    a.add(u"old");
    a.syncWith("/shared");
    world.loop.advance(60);
    b.add(u"later");
    b.syncWith("/shared");
    world.loop.advance(20);
    EXPECT_THAT(a.library(), ElementsAre("Mine: later=text"));
    EXPECT_THAT(b.libraryIn(b.manager->backups().backups().at(0).path), ElementsAre("Mine: old=text"));
}

TEST_F(LibrarySyncTest, AsksFirstWhenSomebodyIsThereToAnswer) {
    const struct {
        int answer;
        std::vector<std::string> library;
        bool enabled;
    } cases[] = {{LibrarySync::Cancelled, {"Mine: later=text"}, false},
                 {LibrarySync::TakeFoldersLibrary, {"Mine: old=text"}, true},
                 {LibrarySync::ReplaceFoldersLibrary, {"Mine: later=text"}, true}};
    for (const auto& one : cases) {
        SharedWorld own;
        (void)own.files.createFolder("/shared");
        Machine first(own, "first");
        first.load();
        first.add(u"old");
        first.syncWith("/shared");
        own.loop.advance(60);
        Machine second(own, "second");
        std::vector<std::string> asked;
        second.askFirst = [&](const std::string& folder) { asked.push_back(folder); };
        second.restart();
        second.load();
        second.add(u"later");
        second.settings.set("SyncEnabled", true);
        second.settings.set("SyncDirectory", std::u16string(u"/shared"));
        second.manager->sync().loadSyncPreferences(true);
        EXPECT_THAT(asked, ElementsAre("shared"));
        second.manager->sync().initalSyncSheetDidEnd(one.answer);
        EXPECT_EQ(second.library(), one.library);
        EXPECT_EQ(second.settings.boolForKey("SyncEnabled"), one.enabled);
    }
}

TEST_F(LibrarySyncTest, PutsAFileInTheFoldersPlaceIntoTheTrash) {
    (void)world.files.write("/shared/Plume", "a file");
    a.syncWith("/shared");
    EXPECT_TRUE(world.files.exists(SyncFile));
    EXPECT_THAT(world.files.trash(), SizeIs(1));
}

TEST_F(LibrarySyncTest, LeavesAnUnreadableFileAloneUntilItChanges) {
    meet();
    const std::string good = world.files.read(SyncFile).value();
    (void)world.files.write(SyncFile, good.substr(0, good.size() / 2));
    world.loop.advance(5);
    a.add(u"while it is damaged");
    world.loop.advance(120);
    EXPECT_EQ(world.files.read(SyncFile).value().size(), good.size() / 2);
    EXPECT_THAT(a.reports, ElementsAre(HasSubstr(SyncFile)));
    (void)world.files.write(SyncFile, good);
    world.loop.advance(10);
    a.add(u"afterwards");
    world.loop.advance(20);
    EXPECT_THAT(b.library(), ElementsAre("Mine: common=text while it is damaged=text afterwards=text"));
}

TEST_F(LibrarySyncTest, OutlastsAFullDisk) {
    meet();
    world.files.setFreeBytes(0);
    a.add(u"new");
    world.loop.advance(200);
    EXPECT_THAT(a.reports, ElementsAre(HasSubstr("not sent")));
    EXPECT_THAT(b.library(), Not(Contains(HasSubstr("new"))));
    world.files.setFreeBytes(std::nullopt);
    world.loop.advance(70);
    EXPECT_EQ(b.library(), a.library());
}

TEST_F(LibrarySyncTest, DoesNotTakeOverWhatItCannotKeepItsOwnBefore) {
    meet();
    a.add(u"unsent");
    world.loop.advance(1);
    b.add(u"from b");
    world.files.setUnreadable("/a/Backups", true);
    world.loop.advance(0.1);
    EXPECT_THAT(a.library(), ElementsAre("Mine: common=text unsent=text"));
}

TEST_F(LibrarySyncTest, GoesOnWhenTheFolderComesBack) {
    meet();
    world.files.vanish("/shared");
    world.loop.advance(5);
    a.add(u"without a folder");
    world.loop.advance(60);
    EXPECT_FALSE(world.files.exists("/shared"));
    EXPECT_THAT(a.reports, Contains(HasSubstr("/shared is not there")));
    (void)world.files.createFolder("/shared");
    world.loop.advance(30);
    EXPECT_THAT(b.library(), ElementsAre("Mine: common=text without a folder=text"));
}

TEST_F(LibrarySyncTest, CarriesPreferencesOnlyWhenAskedToAndNoOthers) {
    meet();
    for (Machine* machine : {&a, &b}) machine->settings.set("SyncPreferences", true);
    a.settings.set("LongTextLength", std::int64_t{42});
    a.settings.set("IsEnabled", false);
    a.add(u"new");
    world.loop.advance(20);
    EXPECT_EQ(b.settings.integerForKey("LongTextLength"), 42);
    EXPECT_TRUE(b.settings.boolForKey("IsEnabled"));
    EXPECT_EQ(b.preferencesLoaded, 1);
}

TEST_F(LibrarySyncTest, StopsWhenItIsSwitchedOff) {
    meet();
    b.settings.set("SyncEnabled", false);
    b.manager->sync().loadSyncPreferences(false);
    a.add(u"new");
    world.loop.advance(30);
    EXPECT_THAT(b.library(), ElementsAre("Mine: common=text"));
}

}  // namespace
}  // namespace plume

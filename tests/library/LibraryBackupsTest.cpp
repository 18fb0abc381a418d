// Backups by the clock, and how many of them stay.
#include "library/LibraryBackups.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "tests/library/LibraryMachine.h"

namespace plume {
namespace {

using test::Machine;
using test::SharedWorld;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::SizeIs;
using ::testing::UnorderedElementsAre;

constexpr double Day = 86400;

class LibraryBackupsTest : public ::testing::Test {
  protected:
    void SetUp() override {
        machine.load();
        machine.add(u"a");
    }
    LibraryBackups& backups() { return machine.manager->backups(); }

    SharedWorld world;
    Machine machine{world};
};

TEST_F(LibraryBackupsTest, AreMadeAsOftenAsTheSettingSays) {
    const struct {
        std::int64_t interval;
        double period;  // 0: never
    } cases[] = {{0, 0}, {1, 3600}, {2, Day}, {3, 7 * Day}, {4, 30 * Day}, {5, 0}, {-1, 0}};
    for (const auto& [interval, period] : cases) {
        SharedWorld ownWorld;
        Machine own(ownWorld);
        own.load();
        own.add(u"a");
        own.settings.set("AutoBackupInterval", interval);
        own.manager->backups().startAutoBackupTimer();  // the first look only notes the time
        ownWorld.loop.advance((period > 0 ? period : 40 * Day) - 1);
        EXPECT_THAT(own.backupNames(), IsEmpty()) << interval;
        ownWorld.loop.advance(61);
        EXPECT_THAT(own.backupNames(), SizeIs(period > 0 ? 1 : 0)) << interval;
    }
}

TEST_F(LibraryBackupsTest, OfTheClockNeverMakeRoomForEmptyOnes) {
    machine.manager->snippetGroups().clear();
    backups().startAutoBackupTimer();
    world.loop.advance(3 * Day);
    EXPECT_THAT(machine.backupNames(), IsEmpty());
}

TEST_F(LibraryBackupsTest, OfOneSecondBothStay) {
    ASSERT_TRUE(backups().backup());
    ASSERT_TRUE(backups().backup());
    EXPECT_THAT(machine.backupNames(), SizeIs(2));
}

TEST_F(LibraryBackupsTest, GoByAgeAndOnlyOwnOnesForGood) {
    machine.settings.set("BackupQuantity", std::int64_t{2});
    (void)world.files.createFolder("/one/Backups");
    (void)world.files.write("/one/Backups/mine.plume", "copied here by hand");
    (void)world.files.write("/one/Backups/notes.txt", "not a library");
    for (int i = 0; i < 3; ++i) {
        world.loop.advance(60);
        ASSERT_TRUE(backups().backup());
    }
    EXPECT_THAT(machine.backupNames(), SizeIs(2));
    ASSERT_THAT(world.files.trash(), SizeIs(1));
    EXPECT_EQ(world.files.trash().front().bytes, "copied here by hand");
    EXPECT_TRUE(world.files.exists("/one/Backups/notes.txt"));
}

TEST_F(LibraryBackupsTest, BehindOneOfUnknownAgeStay) {
    machine.settings.set("BackupQuantity", std::int64_t{0});
    for (int i = 0; i < 4; ++i) {
        ASSERT_TRUE(backups().backup());
        world.loop.advance(60);
    }
    const auto all = machine.backupNames();
    ASSERT_THAT(all, SizeIs(4));
    world.files.setModified("/one/Backups/" + all[1], std::nullopt);
    machine.settings.set("BackupQuantity", std::int64_t{1});
    backups().deleteOldBackups();
    EXPECT_THAT(machine.backupNames(), UnorderedElementsAre(all[1], all[2], all[3]));
}

TEST_F(LibraryBackupsTest, AreNamedByTheLocalTime) {
    EXPECT_EQ(LibraryBackups::timeInName("Plume Backup 2026-01-31 10-00-00.plume"), "2026-01-31 10-00-00");
    for (const char* other : {"Plume Backup 2026-01-31 10:00:00.plume", "Plume Backup .plume", "mine.plume",
                              "Plume Backup 2026-01-31 10-00-00.csv", "Plume Backup 2026-01-31 1x-00-00.plume"}) {
        EXPECT_EQ(LibraryBackups::timeInName(other), std::nullopt) << other;
    }
}

}  // namespace
}  // namespace plume

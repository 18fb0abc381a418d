#include <gmock/gmock.h>

#include <thread>

#include "tests/contract/ContractStorage.h"

namespace plume {

using testing::ElementsAre;
using testing::IsEmpty;

TEST_P(LibraryStorageContract, BeginsEmpty) {
    const auto stored = mine_.load().value();
    EXPECT_EQ(stored.archive, std::nullopt);
    EXPECT_THAT(stored.journal, IsEmpty());
}

TEST_P(LibraryStorageContract, KeepsEntriesInOrderUntilTheyAreSaved) {
    const std::string bytes("\0\xFF entry", 8);
    const Generation first = written(mine_.append(bytes, mine_.load().value().generation));
    const Generation second = written(mine_.append("second", first));
    const Generation third = written(mine_.append("third", second));
    EXPECT_LT(first, second);
    EXPECT_THAT(other_.load().value().journal, ElementsAre(bytes, "second", "third"));
    EXPECT_EQ(other_.load().value().generation, third);

    // Based on what was there before the third entry, which stays.
    const Generation saved = written(mine_.save("archive", second));
    EXPECT_GT(saved, third);
    const auto stored = other_.load().value();
    EXPECT_EQ(stored.archive, "archive");
    EXPECT_THAT(stored.journal, ElementsAre("third"));
    EXPECT_EQ(stored.generation, saved);
    EXPECT_NE(written(mine_.append("fourth", third)), Refused) << "what this process wrote itself outdates nothing";
}

TEST_P(LibraryStorageContract, RefusesWhatBuildsOnAnOlderState) {
    const Generation start = mine_.load().value().generation;
    const Generation mine = written(mine_.append("mine", start));
    EXPECT_EQ(written(other_.append("other", start)), Refused);
    EXPECT_EQ(written(other_.save("other", start)), Refused);
    const Generation others = written(other_.append("other", mine));
    EXPECT_EQ(written(mine_.save("mine", mine)), Refused);
    EXPECT_EQ(written(mine_.append("mine", mine)), Refused);
    EXPECT_THAT(mine_.load().value().journal, ElementsAre("mine", "other"));
    const Generation saved = written(mine_.save("both", others));
    EXPECT_EQ(written(mine_.save("older", start)), Refused) << "entries that are in the archive would be lost";
    EXPECT_EQ(written(mine_.append("later", saved + 1)), Refused) << "a state that never was";
    EXPECT_EQ(mine_.load().value().archive, "both");
}

TEST_P(LibraryStorageContract, TellsOnlyTheOthers) {
    int mine = 0;
    int others = 0;
    const Subscription first = mine_.addObserver([&] { ++mine; });
    Subscription second = other_.addObserver([&] { ++others; });
    const Generation written1 = written(mine_.append("1", mine_.load().value().generation));
    EXPECT_TRUE(bench_->runUntil([&] { return others == 1; }));
    const Generation written2 = written(mine_.save("2", written1));
    EXPECT_TRUE(bench_->runUntil([&] { return others == 2; }));
    EXPECT_EQ(mine, 0);
    second.end();
    (void)written(other_.append("3", written2));
    EXPECT_TRUE(bench_->runUntil([&] { return mine > 0; }));
    EXPECT_EQ(others, 2);
}

TEST_P(LibraryStorageContract, SavesOnAThreadOfItsOwnWhileEntriesAreAppended) {
    Generation latest = mine_.load().value().generation;
    for (int round = 0; round < 10; ++round) {
        Generation saved = 0;
        std::thread saving([&, basedOn = latest] { saved = written(mine_.save(std::to_string(round), basedOn)); });
        for (int entry = 0; entry < 5; ++entry) {
            const Generation appended = written(mine_.append(std::to_string(entry), latest));
            EXPECT_NE(appended, Refused);
            latest = appended;
        }
        saving.join();
        EXPECT_NE(saved, Refused);
        latest = std::max(latest, saved);
        EXPECT_THAT(other_.load().value().journal, ElementsAre("0", "1", "2", "3", "4"));
    }
}

}  // namespace plume

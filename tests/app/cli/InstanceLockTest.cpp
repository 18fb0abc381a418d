#include "app/cli/InstanceLock.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/stat.h>

#include <filesystem>
#include <optional>

#include "tests/app/cli/ProgramRun.h"

namespace plume {
namespace {

using ::testing::HasSubstr;

class Lock : public ::testing::Test {
    ProgramHome home_;  // with a runtime folder of its own
};

TEST_F(Lock, IsOneForAllScreensOfADisplay) {
    const std::string path = InstanceLock::pathFor(":7").value();
    for (const char* same : {":7.0", ":7.1", "unix:7", "unix:7.0"})
        EXPECT_EQ(InstanceLock::pathFor(same).value(), path);
    for (const char* other : {":8", ":77", "host:7", "host.example:7"}) {
        EXPECT_NE(InstanceLock::pathFor(other).value(), path);
    }
    EXPECT_NE(InstanceLock::pathFor("host.a:7").value(), InstanceLock::pathFor("host.b:7").value());
    // A display's name leads to no other folder.
    EXPECT_EQ(std::filesystem::path(InstanceLock::pathFor("../x:7").value()).parent_path(),
              std::filesystem::path(path).parent_path());
}

TEST_F(Lock, IsHeldByOneUntilItsEnd) {
    EXPECT_FALSE(InstanceLock::isTaken(":7"));
    {
        const auto first = InstanceLock::take(":7");
        ASSERT_TRUE(first) << first.error().message;
        const auto second = InstanceLock::take(":7.0");
        ASSERT_FALSE(second);
        EXPECT_THAT(second.error().message, HasSubstr("process " + std::to_string(getpid())));
        EXPECT_TRUE(InstanceLock::take(":8"));
        EXPECT_TRUE(InstanceLock::isTaken(":7"));
        EXPECT_FALSE(InstanceLock::isTaken(":8"));
    }
    EXPECT_FALSE(InstanceLock::isTaken(":7"));
    EXPECT_TRUE(InstanceLock::take(":7"));
}

TEST_F(Lock, TrustsNoFolderThatOthersCanEnter) {
    const std::string before = InstanceLock::pathFor(":7").value();
    const std::filesystem::path folder = std::filesystem::path(before).parent_path();
    ASSERT_EQ(chmod(folder.c_str(), 0777), 0);
    const auto path = InstanceLock::pathFor(":7");
    EXPECT_TRUE(!path || std::filesystem::path(path.value()).parent_path() != folder);
}

}  // namespace
}  // namespace plume

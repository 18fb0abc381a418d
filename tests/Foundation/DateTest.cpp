#include "Foundation/Date.h"

#include <gtest/gtest.h>

namespace plume {
namespace {

using namespace std::chrono_literals;

TEST(DateTest, TheSystemsClockIsTheSource) {
    const auto before = std::chrono::system_clock::now();
    const Date date = currentDate();
    const auto after = std::chrono::system_clock::now();
    EXPECT_GE(date, before - 1us);
    EXPECT_LE(date, after);
}

TEST(DateTest, SourcesNestAndEndWithTheirScope) {
    Date virtualNow{1000s};
    {
        const ScopedDateSource outer([&virtualNow] { return virtualNow; });
        EXPECT_EQ(currentDate(), Date{1000s});
        {
            const ScopedDateSource inner([] { return Date{5us}; });
            EXPECT_EQ(currentDate(), Date{5us});
        }
        virtualNow += 1us;
        EXPECT_EQ(currentDate(), Date{1000s + 1us});
    }
    EXPECT_GT(currentDate(), Date{std::chrono::days{365}});
}

}  // namespace
}  // namespace plume

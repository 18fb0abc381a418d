#include "Foundation/Date.h"

#include <gtest/gtest.h>

namespace plume {
namespace {

using namespace std::chrono_literals;

TEST(DateTest, SourcesNestAndEndWithTheirScope) {
    Date virtualNow{1000s};
    const auto before = std::chrono::system_clock::now();
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
    const Date now = currentDate();
    EXPECT_GE(now, before - 1us);
    EXPECT_LE(now, std::chrono::system_clock::now());
}

}  // namespace
}  // namespace plume

#include "app/editing/ZDDuplicateManager.h"

#include <gtest/gtest.h>

namespace plume {
namespace {

TEST(ZDDuplicateManagerTest, CountsEachTextByItself) {
    ZDDuplicateManager counts;
    EXPECT_FALSE(counts.add(u"sig"));
    EXPECT_FALSE(counts.isDuplicated(u"sig"));
    EXPECT_TRUE(counts.add(u"sig"));
    EXPECT_TRUE(counts.add(u"sig"));
    EXPECT_TRUE(counts.isDuplicated(u"sig"));
    EXPECT_FALSE(counts.isDuplicated(u"Sig"));
    EXPECT_TRUE(counts.remove(u"sig"));
    EXPECT_TRUE(counts.isDuplicated(u"sig"));
    EXPECT_TRUE(counts.remove(u"sig"));
    EXPECT_FALSE(counts.isDuplicated(u"sig"));
    EXPECT_FALSE(counts.remove(u"sig"));
    EXPECT_FALSE(counts.remove(u"sig"));
    EXPECT_FALSE(counts.add(u"sig"));
    counts.add(u"sig");
    counts.clear();
    EXPECT_FALSE(counts.isDuplicated(u"sig"));
}

TEST(ZDDuplicateManagerTest, CountsNothingForNoText) {
    ZDDuplicateManager counts;
    for (const std::optional<std::u16string>& none : {std::optional<std::u16string>(), {u""}}) {
        EXPECT_FALSE(counts.add(none));
        EXPECT_FALSE(counts.add(none));
        EXPECT_FALSE(counts.isDuplicated(none));
        EXPECT_FALSE(counts.remove(none));
    }
}

}  // namespace
}  // namespace plume

#include "Foundation/Uuid.h"

#include <gtest/gtest.h>

#include <set>

namespace plume {
namespace {

TEST(UuidTest, ReadsEitherCaseAndWritesUpperCase) {
    const auto upper = Uuid::parse(u"01234567-89AB-4DEF-8123-456789ABCDEF");
    ASSERT_TRUE(upper);
    EXPECT_EQ(upper->toString(), u"01234567-89AB-4DEF-8123-456789ABCDEF");
    EXPECT_EQ(Uuid::parse(u"01234567-89ab-4def-8123-456789abcdef"), upper);
}

TEST(UuidTest, RefusesOtherForms) {
    for (const std::u16string_view text :
         {u"", u"01234567-89AB-4DEF-8123-456789ABCDE", u"01234567-89AB-4DEF-8123-456789ABCDEF0",
          u"0123456789AB4DEF8123456789ABCDEF", u"0123456-789AB-4DEF-8123-456789ABCDEF",
          u"01234567-89AB-4DEF-8123-456789ABCDEG", u"01234567-89AB-4DEF-8123+456789ABCDEF",
          u"{1234567-89AB-4DEF-8123-456789ABCDE}", u"01234567-89AB-4DEF-8123-\uFF1156789ABCDEF"}) {
        EXPECT_EQ(Uuid::parse(text), std::nullopt);
    }
}

TEST(UuidTest, RandomOnesDifferAndSayThatTheyAreRandom) {
    std::set<Uuid> seen;
    for (int i = 0; i < 200; ++i) {
        const Uuid uuid = Uuid::random();
        const std::u16string text = uuid.toString();
        EXPECT_EQ(text[14], u'4');
        EXPECT_NE(std::u16string_view(u"89AB").find(text[19]), std::u16string_view::npos);
        EXPECT_EQ(Uuid::parse(text), uuid);
        seen.insert(uuid);
    }
    EXPECT_EQ(seen.size(), 200U);
}

}  // namespace
}  // namespace plume

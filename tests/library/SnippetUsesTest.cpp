#include "library/SnippetUses.h"

#include <gtest/gtest.h>

#include <chrono>
#include <cmath>
#include <limits>

#include "Foundation/Strings.h"
#include "library/LibraryPreferences.h"
#include "library/MemoryUserDefaults.h"

namespace plume {

namespace {

const Date Noted{std::chrono::hours(24 * 20000)};

Date daysLater(int days) {
    return Noted + std::chrono::hours(24 * days);
}

class SnippetUsesTest : public testing::Test {
  protected:
    SnippetUsesTest() { settings.set(SnippetUses::SwitchKey, true); }
    const PropertyList::Dictionary* kept() {
        value_ = settings.objectForKey(SnippetUses::Key);
        return value_ ? value_->as<PropertyList::Dictionary>() : nullptr;
    }

    MemoryUserDefaults settings;
    const Uuid one = Uuid::random();
    const Uuid other = Uuid::random();

  private:
    std::optional<PropertyList> value_;
};

}  // namespace

TEST_F(SnippetUsesTest, CountsFadeByHalfInTwoWeeks) {
    SnippetUses uses(settings);
    EXPECT_EQ(uses.weight(one, Noted), 0);
    uses.note(one, Noted);
    EXPECT_DOUBLE_EQ(uses.count(one, daysLater(14)), 0.5);
    uses.note(one, daysLater(14));
    EXPECT_DOUBLE_EQ(uses.count(one, daysLater(14)), 1.5);
    EXPECT_DOUBLE_EQ(uses.count(one, Noted), 1.5) << "a clock that was set back makes nothing grow";
    uses.note(other, daysLater(14));
    EXPECT_DOUBLE_EQ(uses.weight(one, daysLater(14)), 1);
    EXPECT_DOUBLE_EQ(uses.weight(other, daysLater(14)), 1 / std::log2(2.5));
    for (int i = 0; i < 3; ++i) uses.note(other, daysLater(28));
    EXPECT_DOUBLE_EQ(uses.weight(other, daysLater(28)), 1) << "the most used is another now";
}

TEST_F(SnippetUsesTest, AreThereAgainAfterARestart) {
    SnippetUses before(settings);
    before.note(one, Noted);
    before.note(one, Noted + std::chrono::milliseconds(1500));
    EXPECT_EQ(kept(), nullptr) << "nothing is written before it is asked for";
    ASSERT_TRUE(before.write().ok());
    const SnippetUses after(settings);
    EXPECT_NEAR(after.count(one, daysLater(1)), before.count(one, daysLater(1)), 1e-4);
    EXPECT_DOUBLE_EQ(after.weight(one, daysLater(1)), 1);
}

TEST_F(SnippetUsesTest, AreNotNotedWhileSwitchedOff) {
    SnippetUses uses(settings);
    uses.note(one, Noted);
    const std::uint64_t before = uses.revision();
    settings.set(SnippetUses::SwitchKey, false);
    EXPECT_NE(uses.revision(), before);
    EXPECT_EQ(uses.weight(one, Noted), 0);
    uses.note(one, Noted);
    uses.note(other, Noted);
    settings.set(SnippetUses::SwitchKey, true);
    EXPECT_EQ(uses.count(one, Noted), 1);
    EXPECT_EQ(uses.count(other, Noted), 0);
}

TEST_F(SnippetUsesTest, AreForgottenWhereTheyAreKeptToo) {
    SnippetUses uses(settings);
    uses.note(one, Noted);
    ASSERT_TRUE(uses.write().ok());
    ASSERT_NE(kept(), nullptr);
    ASSERT_TRUE(uses.forget().ok());
    EXPECT_EQ(kept(), nullptr);
    EXPECT_EQ(uses.weight(one, Noted), 0);
    ASSERT_TRUE(uses.write().ok());
    EXPECT_EQ(kept(), nullptr);
}

TEST_F(SnippetUsesTest, OfSnippetsThatAreGoneAreDropped) {
    const auto group = SnippetGroup::make();
    group->addItem(std::make_shared<Snippet>(u"a", u"b"));
    const Uuid living = *group->items().front()->uuid();
    SnippetUses uses(settings);
    for (int i = 0; i < 3; ++i) uses.note(one, Noted);
    uses.note(living, Noted);
    uses.dropAllBut({group});
    ASSERT_TRUE(uses.write().ok());
    ASSERT_NE(kept(), nullptr);
    EXPECT_EQ(kept()->size(), 1U);
    EXPECT_EQ(uses.weight(living, Noted), 1) << "the most used of those that are left";
}

TEST_F(SnippetUsesTest, KeepOnlyTheMostUsed) {
    SnippetUses uses(settings);
    std::vector<Uuid> all;
    for (std::size_t i = 0; i < SnippetUses::MostKept + 10; ++i) {
        all.push_back(Uuid::random());
        uses.note(all.back(), Noted + std::chrono::seconds(i));
    }
    uses.note(all.front(), Noted);
    ASSERT_TRUE(uses.write().ok());
    ASSERT_NE(kept(), nullptr);
    EXPECT_EQ(kept()->size(), SnippetUses::MostKept);
    EXPECT_GT(uses.count(all.front(), Noted), 0);
    EXPECT_EQ(uses.count(all[1], Noted), 0);
    EXPECT_GT(uses.count(all.back(), Noted), 0);
}

TEST_F(SnippetUsesTest, TakeDamageForNothing) {
    using Array = PropertyList::Array;
    const std::string key = toUtf8(one.toString());
    const std::string sound = toUtf8(other.toString());
    const Array use{2.0, std::int64_t{1'700'000'000}};
    const PropertyList damaged[] = {
        true,
        Array{},
        Array{2.0},
        Array{2.0, 3.0},
        Array{std::int64_t{2}, std::int64_t{5}},
        Array{-1.0, std::int64_t{5}},
        Array{std::nan(""), std::int64_t{5}},
        Array{std::numeric_limits<double>::infinity(), std::int64_t{5}},
        Array{1.0, std::numeric_limits<std::int64_t>::max()},
        Array{1.0, std::int64_t{-1}},
        Array{1.0, std::int64_t{5}, true},
    };
    for (const PropertyList& value : damaged) {
        settings.set(SnippetUses::Key, PropertyList::Dictionary{{key, value}, {sound, use}, {"no identifier", use}});
        const SnippetUses uses(settings);
        EXPECT_EQ(uses.weight(one, Noted), 0);
        EXPECT_EQ(uses.weight(other, Noted), 1);
    }
    settings.set(SnippetUses::Key, std::u16string(u"nothing of the kind"));
    EXPECT_EQ(SnippetUses(settings).weight(other, Noted), 0);
}

TEST_F(SnippetUsesTest, DoNotTravelWithTheLibrary) {
    SnippetUses uses(settings);
    uses.note(one, Noted);
    ASSERT_TRUE(uses.write().ok());
    const auto travelling = preferencesOfLibrary(settings);
    EXPECT_FALSE(travelling.contains(SnippetUses::Key));
    EXPECT_FALSE(travelling.contains(SnippetUses::SwitchKey));
}

}  // namespace plume

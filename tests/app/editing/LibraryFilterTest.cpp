#include "app/editing/LibraryFilter.h"

#include <gtest/gtest.h>

#include "library/KnownSettings.h"
#include "library/MemoryUserDefaults.h"
#include "tests/library/LibrarySupport.h"

namespace plume {
namespace {

using test::snippet;

class LibraryFilterTest : public testing::Test {
  protected:
    LibraryFilterTest() {
        settings.registerDefaults(registeredSettings("/Backups"));
        for (const auto& [name, items] : std::vector<std::pair<std::u16string, std::vector<std::shared_ptr<Snippet>>>>{
                 {u"Mail", {snippet(u"abc", u"one"), snippet(u"abcd", u"two")}}, {u"Work", {snippet(u"x", u"abc")}}}) {
            groups.push_back(SnippetGroup::make());
            groups.back()->setName(name);
            groups.back()->addItems(items);
        }
    }
    std::size_t found(const std::u16string& text) {
        filter.onFilterChanged(text, groups);
        return filter.total(groups);
    }

    MemoryUserDefaults settings;
    SnippetGroups groups;
    LibraryFilter filter{settings};
};

TEST_F(LibraryFilterTest, FollowsItsOptions) {
    EXPECT_EQ(found(u""), 3U);
    EXPECT_FALSE(filter.filtering());
    EXPECT_EQ(found(u"ABC"), 3U);
    EXPECT_EQ(filter.filteredGroups(), groups);
    EXPECT_EQ(found(u"a*c"), 0U);
    filter.flipWildcardSearchOption();
    EXPECT_EQ(found(u"a*c"), 2U);
    filter.onSearchByChanged(SnippetSearch::Content);
    EXPECT_FALSE(filter.searchesBy(SnippetSearch::Content));
    EXPECT_EQ(found(u"a*c"), 1U);
    EXPECT_EQ(filter.filteredGroups(), SnippetGroups{groups[0]});
    EXPECT_EQ(filter.filteredGroupsMacros().at(groups[0]).size(), 1U);
    filter.flipWildcardSearchOption();
    filter.onSearchByChanged(SnippetSearch::Content);
    EXPECT_EQ(found(u"abc"), 3U);
    EXPECT_EQ(found(u""), 3U);
    EXPECT_TRUE(filter.filteredGroups().empty());
}

TEST(StatusStringTest, CountsWhatIsSelected) {
    EXPECT_EQ(statusString(0, 12), u"12 snippets");
    EXPECT_EQ(statusString(3, 12), u"3 of 12 snippets selected");
}

}  // namespace
}  // namespace plume

#include "app/editing/RowSearch.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Foundation/Strings.h"

namespace plume {
namespace {

using ::testing::ElementsAre;

TEST(RowSearchTest, TheBestFitComesFirstAndTheRestInOrder) {
    RowSearch search;
    search.add(u"Update", u"news");                    // 0
    search.add(u"Date, short", u"day today");          // 1
    search.add(u"Tomorrow", u"a date");                // 2
    search.add(u"date", u"");                          // 3
    search.add(u"Clipboard", u"paste");                // 4
    search.add(u";Straße", u"Address of the office");  // 5
    const struct {
        const char16_t* query;
        std::vector<std::size_t> rows;
    } cases[] = {
        {u"date", {3, 1, 2, 0}}, {u"DATE", {3, 1, 2, 0}}, {u"date short", {1}},      {u"short date", {1}},
        {u"  today  day ", {1}}, {u"oard", {4}},          {u"straße", {5}},          {u";st off", {5}},
        {u"date nowhere", {}},   {u"date,", {1}},         {u"", {0, 1, 2, 3, 4, 5}}, {u"  ", {0, 1, 2, 3, 4, 5}},
    };
    for (const auto& each : cases) EXPECT_EQ(search.find(each.query), each.rows) << toUtf8(each.query);
}

TEST(RowSearchTest, WhatWasThereBeforeIsForgotten) {
    RowSearch search;
    search.add(u"one", u"");
    search.clear();
    search.add(u"two", u"");
    EXPECT_THAT(search.find(u""), ElementsAre(0));
    EXPECT_THAT(search.find(u"one"), ElementsAre());
}

}  // namespace
}  // namespace plume

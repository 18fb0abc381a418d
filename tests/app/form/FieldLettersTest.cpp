#include "app/form/FieldLetters.h"

#include <gtest/gtest.h>

namespace plume {
namespace {

TEST(FieldLetters, AreUniqueAndOfTheName) {
    struct Example {
        std::vector<QString> names;
        std::vector<QString> texts;
    };
    const Example examples[] = {
        {{"Discount", "Delivery", "Date"}, {"&Discount", "D&elivery", "D&ate"}},
        {{"a", "A", "a", "b"}, {"&a", "A (&1)", "a (&2)", "&b"}},
        {{"R&D", "R"}, {"&R&&D", "R (&1)"}},
        {{"&", "", "7 days"}, {"&& (&1)", " (&2)", "7 &days"}},
        {{"Ähre", "Привет", "名前"}, {"&Ähre", "&Привет", "名前 (&1)"}},
    };
    for (const auto& [names, texts] : examples) EXPECT_EQ(withLetters(names), texts) << names[0].toStdString();
}

TEST(FieldLetters, EndWhereThereIsNoKeyLeft) {
    const std::vector<QString> texts = withLetters(std::vector<QString>(12, "x"));
    EXPECT_EQ(texts[9], "x (&9)");
    EXPECT_EQ(texts[10], "x");
}

}  // namespace
}  // namespace plume

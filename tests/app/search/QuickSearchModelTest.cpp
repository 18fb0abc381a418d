#include "app/search/QuickSearchModel.h"

#include <gtest/gtest.h>

#include <QAbstractItemModelTester>
#include <random>

#include "tests/app/search/SearchSupport.h"

namespace plume {
namespace {

using test::rowAt;

class QuickSearchModelTest : public testing::Test {
  protected:
    RankedSnippet result(bool isLoose) {
        const auto snippet = test::addSnippet(*group, u"abbreviation", u"content");
        return {snippet, group, isLoose};
    }
    std::vector<RankedSnippet> results(std::size_t tight, std::size_t loose) {
        std::vector<RankedSnippet> made;
        for (std::size_t i = 0; i < tight + loose; ++i) made.push_back(result(i >= tight));
        return made;
    }

    SnippetGroups groups;
    std::shared_ptr<SnippetGroup> group = test::addGroup(groups, u"Mail\nwork", u";");
    QuickSearchModel model;
    const QAbstractItemModelTester tester{&model, QAbstractItemModelTester::FailureReportingMode::Fatal};
};

TEST_F(QuickSearchModelTest, HasARowForEachResultAndADividerAboveWhatIsSimilar) {
    std::mt19937 random(20260131);  // NOLINT(cert-msc32-c,cert-msc51-cpp)
    constexpr int Rounds = 60;
    for (int round = 0; round < Rounds; ++round) {
        const std::size_t tight = random() % 13;
        const std::size_t loose = random() % 2 * (random() % 13);
        const auto given = results(tight, loose);
        model.setResults(given, u"abb", {});
        if (random() % 3 == 0) model.setSelectorKeyModifier(static_cast<std::int64_t>(random() % 7) - 1);
        std::vector<std::shared_ptr<Snippet>> expected;
        for (std::size_t i = 0; i < given.size(); ++i) {
            if (i == tight) expected.push_back(nullptr);
            expected.push_back(given[i].snippet);
        }
        ASSERT_EQ(model.rowCount(), static_cast<int>(expected.size()));
        for (int row = -1; row <= model.rowCount(); ++row) {
            const bool isInside = row >= 0 && row < model.rowCount();
            const auto snippet = isInside ? expected[static_cast<std::size_t>(row)] : nullptr;
            EXPECT_EQ(model.snippetAt(row), snippet) << row;
            if (!isInside) continue;
            EXPECT_EQ(rowAt(model, row).isDivider, !snippet);
            EXPECT_EQ(model.flags(model.index(row, 0)).testFlag(Qt::ItemIsSelectable), snippet != nullptr);
        }
        EXPECT_EQ(model.snippetAtIndex(given.size()), nullptr);
        const auto first = model.firstSnippets(10);
        EXPECT_EQ(first.size(), std::min<std::size_t>(10, given.size()));
        for (std::size_t i = 0; i < first.size(); ++i) EXPECT_EQ(first[i], given[i].snippet);
    }
}

TEST_F(QuickSearchModelTest, DigitsPassOverTheDivider) {
    model.setSelectorKeyModifier(3);
    model.setResults(results(2, 10), u"x", {});
    EXPECT_EQ(rowAt(model, 1).shortcut, QStringLiteral("Alt+2"));
    EXPECT_EQ(rowAt(model, 2).shortcut, QString());
    EXPECT_EQ(rowAt(model, 3).shortcut, QStringLiteral("Alt+3"));
    EXPECT_EQ(rowAt(model, 10).shortcut, QStringLiteral("Alt+0"));
    EXPECT_EQ(rowAt(model, 11).shortcut, QString());
}

TEST_F(QuickSearchModelTest, MarksWhatWasSearchedForWhereItWasSearched) {
    const auto snippet = test::addSnippet(*group, u"sig", u"\n  Sigrid\tsays sig\nmore", u"Signature");
    const auto marks = [&](std::int64_t fields) {
        model.setResults({{snippet, group, false}}, u"sig", {.searchBy = fields, .isWildcard = false});
        const SnippetRow row = rowAt(model, 0);
        return std::vector{row.abbreviation.marks, row.label.marks, row.content.marks};
    };
    EXPECT_EQ(marks(7), (std::vector<QList<Range>>{{{1, 3}}, {{0, 3}}, {{0, 3}, {12, 3}}}));
    EXPECT_EQ(marks(SearchRule::Label), (std::vector<QList<Range>>{{}, {{0, 3}}, {}}));
    const SnippetRow row = rowAt(model, 0);
    EXPECT_EQ(row.abbreviation.text, QStringLiteral(";sig"));
    EXPECT_EQ(row.content.text, QStringLiteral("Sigrid says sig\u2009…"));
    EXPECT_EQ(row.group, QStringLiteral("Mail work"));
    EXPECT_EQ(model.index(0, 0).data(Qt::AccessibleTextRole).toString(),
              QStringLiteral(";sig, Signature, Sigrid says sig\u2009…, Mail work, 1"));
}

}  // namespace
}  // namespace plume

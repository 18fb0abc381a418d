// What people look for in libraries as they have them, and what they expect to stand first.
#include <gtest/gtest.h>

#include <fstream>
#include <map>
#include <sstream>
#include <string>

#include "app/ranking/SnippetRanking.h"
#include "import/Importers.h"
#include "ports/posix/PosixFiles.h"

namespace plume {

namespace {

constexpr double LeastRight = 0.95;

const std::map<std::string, std::string> Libraries{{"sample", "data/sample-library.json"},
                                                   {"support", "tests/app/ranking/data/support.yml"},
                                                   {"practice", "tests/app/ranking/data/practice.csv"}};

std::string firstFound(const std::string& library, const std::string& query) {
    static std::map<std::string, SnippetRanking> rankings;
    const bool isNew = !rankings.contains(library);
    SnippetRanking& ranking = rankings[library];
    if (isNew) {
        const auto imported = importLibrary(std::filesystem::absolute(Libraries.at(library)), PosixFiles());
        EXPECT_TRUE(imported.ok()) << library;
        ranking.setLibrary(imported.value().groups);
    }
    const auto rows = ranking.search(fromUtf8(query), {});
    return rows.empty() ? "nothing" : toUtf8(rows.front().snippet->abbreviationWithPrefix().value_or(u""));
}

}  // namespace

TEST(SnippetRankingTest, PutsFirstWhatAPersonExpects) {
    std::ifstream table("tests/app/ranking/search.expected_first");
    std::size_t asked = 0;
    std::size_t right = 0;
    std::string misses;
    for (std::string line; std::getline(table, line);) {
        if (line.starts_with('#')) continue;
        std::istringstream parts(line);
        std::string library;
        std::string query;
        std::string expected;
        std::getline(parts, library, '\t');
        std::getline(parts, query, '\t');
        std::getline(parts, expected);
        const std::string first = firstFound(library, query);
        ++asked;
        if (first == expected) ++right;
        if (first != expected) misses += "  " + library + ", " + query + ": " + first + " before " + expected + "\n";
    }
    ASSERT_GE(asked, 60U);
    if (!misses.empty()) std::printf("%zu of %zu, without:\n%s", right, asked, misses.c_str());
    EXPECT_GE(static_cast<double>(right), LeastRight * static_cast<double>(asked)) << misses;
}

}  // namespace plume

// Plays every story under tests/scenarios.
#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

#include "scenario/ScenarioPlayer.h"

namespace plume {

namespace {

const std::filesystem::path Folder = "tests/scenarios";

std::vector<std::string> scenarioNames() {
    std::vector<std::string> names;
    for (const auto& entry : std::filesystem::directory_iterator(Folder)) {
        if (entry.path().extension() == ".json") names.push_back(entry.path().stem().string());
    }
    std::sort(names.begin(), names.end());
    return names;
}

// gtest's names have no "-".
std::string testName(const testing::TestParamInfo<std::string>& info) {
    std::string name = info.param;
    std::replace(name.begin(), name.end(), '-', '_');
    return name;
}

class ScenarioTest : public testing::TestWithParam<std::string> {};

}  // namespace

TEST_P(ScenarioTest, EndsAsTold) {
    const std::filesystem::path path = Folder / (GetParam() + ".json");
    std::ifstream file(path, std::ios::binary);
    const std::string text{std::istreambuf_iterator<char>(file), {}};

    const Result<Scenario> scenario = readScenario(text, path.string());
    ASSERT_TRUE(scenario.ok()) << scenario.error().message;
    EXPECT_FALSE(scenario.value().about.empty()) << "a scenario says what it shows";
    EXPECT_FALSE(scenario.value().expect.empty()) << "a scenario that expects nothing shows nothing";

    const ScenarioReport report = simulate(text, path.string());
    EXPECT_EQ(report.problems, "");
    EXPECT_EQ(report.exitStatus, 0);
}

INSTANTIATE_TEST_SUITE_P(Scenarios, ScenarioTest, testing::ValuesIn(scenarioNames()), testName);

TEST(Scenarios, AreThere) {
    EXPECT_GE(scenarioNames().size(), 80u);
}

}  // namespace plume

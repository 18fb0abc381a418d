// Plays every case of every file under tests/scenarios.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <ostream>
#include <string>
#include <vector>

#include "scenario/ScenarioPlayer.h"

namespace plume {

namespace {

std::vector<std::filesystem::path> scenarioFiles() {
    std::vector<std::filesystem::path> files;
    for (const auto& entry : std::filesystem::directory_iterator("tests/scenarios")) {
        if (entry.path().extension() == ".json") files.push_back(entry.path());
    }
    std::sort(files.begin(), files.end());
    return files;
}

Result<std::vector<Scenario>> scenariosIn(const std::filesystem::path& path) {
    std::ifstream file(path, std::ios::binary);
    const std::string text{std::istreambuf_iterator<char>(file), {}};
    return readScenarios(text, path.string());
}

// Of the files that can be read.
std::vector<Scenario> allScenarios() {
    std::vector<Scenario> all;
    for (const std::filesystem::path& file : scenarioFiles()) {
        const auto scenarios = scenariosIn(file);
        if (scenarios) all.insert(all.end(), scenarios.value().begin(), scenarios.value().end());
    }
    return all;
}

// "undo.json" and its case "too-late" are undo_too_late: gtest's names have no "-".
std::string testName(const testing::TestParamInfo<Scenario>& info) {
    std::string name = std::filesystem::path(info.param.fileName).stem().string();
    if (!info.param.name.empty()) name += "_" + info.param.name;
    std::replace(name.begin(), name.end(), '-', '_');
    return name;
}

class ScenarioTest : public testing::TestWithParam<Scenario> {};

}  // namespace

void PrintTo(const Scenario& scenario, std::ostream* stream) {
    *stream << scenario.title() << ": " << scenario.about;
}

TEST_P(ScenarioTest, EndsAsTold) {
    const Scenario& scenario = GetParam();
    EXPECT_FALSE(scenario.about.empty()) << "a scenario says what it shows";
    EXPECT_FALSE(scenario.expect.empty()) << "a scenario that expects nothing shows nothing";
    const Result<ScenarioOutcome> outcome = playScenario(scenario);
    ASSERT_TRUE(outcome.ok()) << outcome.error().message;
    EXPECT_THAT(differences(scenario.expect, outcome.value()), testing::IsEmpty());
}

INSTANTIATE_TEST_SUITE_P(Scenarios, ScenarioTest, testing::ValuesIn(allScenarios()), testName);

TEST(ScenarioFiles, CanAllBeRead) {
    EXPECT_FALSE(scenarioFiles().empty());
    for (const std::filesystem::path& file : scenarioFiles()) {
        const auto scenarios = scenariosIn(file);
        EXPECT_TRUE(scenarios.ok()) << scenarios.error().message;
    }
}

}  // namespace plume

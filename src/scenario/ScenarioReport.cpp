#include "scenario/ScenarioReport.h"

#include <algorithm>
#include <nlohmann/json.hpp>
#include <utility>
#include <vector>

#include "scenario/ScenarioPlayer.h"

namespace plume {

namespace {

constexpr int Different = 1;
constexpr int Unplayable = 2;

class Report {
  public:
    void add(const Scenario& scenario) {
        Result<ScenarioOutcome> played = playScenario(scenario);
        if (!played) return addProblem(played.error().message, Unplayable);
        for (const std::string& difference : differences(scenario.expect, played.value())) {
            addProblem(scenario.title() + ": " + difference, Different);
        }
        nlohmann::ordered_json& outcome = played.value().outcome;
        if (scenario.name.empty()) {
            output_ = std::move(outcome);
        } else {
            output_[scenario.name] = std::move(outcome);
        }
    }

    void addProblem(const std::string& problem, int exitStatus) {
        report_.problems.append(problem).append("\n");
        report_.exitStatus = std::max(report_.exitStatus, exitStatus);
    }

    ScenarioReport take() {
        if (!output_.is_null()) report_.output = output_.dump(2) + "\n";
        return std::move(report_);
    }

  private:
    nlohmann::ordered_json output_;
    ScenarioReport report_;
};

}  // namespace

ScenarioReport simulate(std::string_view text, const std::string& fileName,
                        const std::optional<std::string>& onlyCase) {
    Report report;
    const Result<std::vector<Scenario>> scenarios = readScenarios(text, fileName);
    if (!scenarios) {
        report.addProblem(scenarios.error().message, Unplayable);
        return report.take();
    }
    bool found = false;
    for (const Scenario& scenario : scenarios.value()) {
        if (onlyCase && *onlyCase != scenario.name) continue;
        found = true;
        report.add(scenario);
    }
    if (!found) report.addProblem(fileName + ": no case has the name \"" + onlyCase.value_or("") + "\"", Unplayable);
    return report.take();
}

}  // namespace plume

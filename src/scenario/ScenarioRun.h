// One run of a scenario: a simulated desktop of its own, set as the scenario says, with the whole program on it.
//
// On one thread. Only scripts run on others, and the clock waits for them.
#pragma once

#include <mutex>
#include <string>
#include <vector>

#include "Foundation/Date.h"
#include "app/Composition.h"
#include "ports/posix/PosixProcessLauncher.h"
#include "ports/simulated/SimulatedDesktop.h"
#include "scenario/Scenario.h"
#include "scenario/ScenarioLoop.h"
#include "scenario/ScenarioWindows.h"

namespace plume {

class ScenarioRun {
  public:
    // The scenario is not owned and outlives the run.
    explicit ScenarioRun(const Scenario& scenario);
    ~ScenarioRun();
    ScenarioRun(const ScenarioRun&) = delete;
    ScenarioRun& operator=(const ScenarioRun&) = delete;

    SimulatedDesktop& desktop() { return desktop_; }
    ScenarioLoop& loop() { return loop_; }
    Composition& program() { return *program_; }
    const ScenarioList& list() const { return list_; }
    ScenarioList& list() { return list_; }
    ScenarioForms& forms() { return forms_; }
    // What the user was told, in order.
    std::vector<std::string> errors() const;
    // Every program that was in front at some time, in order of their first time there.
    const std::vector<SimulatedApplication*>& applications() const { return applications_; }

    void activate(const std::u16string& application);

  private:
    Composition::Ports ports();
    Composition::Environment environment();
    void report(const std::string& message);
    std::uint64_t visibleChanges() const;

    const Scenario& scenario_;
    SimulatedDesktop desktop_;
    ScenarioLoop loop_;
    const ScopedDateSource date_;
    PosixProcessLauncher launcher_;
    ContextInputSettings applicationSettings_;
    std::vector<SimulatedApplication*> applications_;
    ScenarioList list_;
    ScenarioForms forms_;
    mutable std::mutex mutex_;
    std::vector<std::string> errors_;  // guarded by mutex_
    std::unique_ptr<Composition> program_;
};

}  // namespace plume

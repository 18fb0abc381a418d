#include "scenario/ScenarioRun.h"

#include <algorithm>
#include <chrono>
#include <utility>

namespace plume {

namespace {

// The date moves on with the scenario's clock.
std::function<Date()> movingDate(const Scenario& scenario, SimulatedRunLoop& loop) {
    const Date start = scenario.now.value_or(currentDate());
    return [start, &loop] {
        return start + std::chrono::duration_cast<std::chrono::microseconds>(std::chrono::duration<double>(loop.now()));
    };
}

}  // namespace

ScenarioRun::ScenarioRun(const Scenario& scenario)
    : scenario_(scenario),
      loop_(desktop_.runLoop(), scenario.scriptTime,
            {[this] { return visibleChanges(); },
             [this] {
                 if (program_) program_->engine().sender().waitForScripts();
             }}),
      date_(movingDate(scenario, desktop_.runLoop())) {
    for (const auto& [identifier, setting] : scenario_.applicationSettings) {
        applicationSettings_.set(identifier, setting);
    }
    desktop_.inputSources().setIdentifier(scenario_.inputSource);
    desktop_.keyboard().inputMethod().setWords(scenario_.inputMethod);
    if (!scenario_.inputMethod.empty()) desktop_.poster().setCanType([](std::u16string_view) { return false; });
    desktop_.keyboard().setCanHold(scenario_.keepsKeysBack);
    if (!scenario_.tellsItsText) desktop_.accessibility().setFrontApplicationSource({});
    if (scenario_.clipboard) desktop_.pasteboard().copyFromProgram(*scenario_.clipboard);
    activate(scenario_.application);
    desktop_.front()->setText(scenario_.text);

    program_ = std::make_unique<Composition>(ports(), environment());
    for (const auto& [identifier, setting] : scenario_.applicationSettings) {
        program_->inputService().setCustomApplicationSetting(identifier, setting);
    }
    program_->setSnippetGroups(scenario_.library);
    program_->loadPreferences();
    program_->start();
    // What the program has asked for by now are its timers that repeat for good.
    loop_.markPendingAsRepeating();
}

ScenarioRun::~ScenarioRun() = default;

Composition::Ports ScenarioRun::ports() {
    return {desktop_.keyboardTap(),
            desktop_.mouseTap(),
            desktop_.poster(),
            desktop_.pasteboard(),
            desktop_.processManager(),
            desktop_.inputSources(),
            desktop_.accessibility(),
            desktop_.secureInput(),
            desktop_.systemHotKeys(),
            desktop_.sounds(),
            desktop_.notices(),
            launcher_,
            loop_,
            loop_};
}

Composition::Environment ScenarioRun::environment() {
    return {*scenario_.settings,
            [this](const std::string& message) { report(message); },
            [](const std::string&) {},
            scenario_.timeZone,
            scenario_.locale,
            scenarioFieldsEditors(forms_, scenario_.locale),
            [this] { return makeScenarioList(list_); },
            [] { return makeScenarioSearch(); },
            {},
            nullptr,
            {},
            {}};
}

void ScenarioRun::activate(const std::u16string& application) {
    SimulatedApplication& activated = desktop_.activate(application);
    bool isKnown = false;
    activated.setUsesControlKey(applicationSettings_.resolve(application, isKnown)->has(InputFlag::UseControlKey));
    if (std::find(applications_.begin(), applications_.end(), &activated) == applications_.end()) {
        applications_.push_back(&activated);
    }
}

void ScenarioRun::report(const std::string& message) {
    const std::lock_guard lock(mutex_);
    errors_.push_back(message);
}

std::vector<std::string> ScenarioRun::errors() const {
    const std::lock_guard lock(mutex_);
    return errors_;
}

std::uint64_t ScenarioRun::visibleChanges() const {
    auto& desktop = const_cast<SimulatedDesktop&>(desktop_);
    auto changes = static_cast<std::uint64_t>(desktop.pasteboard().changeCount());
    changes += desktop.sounds().played().size() + desktop.poster().clicks().size();
    for (const SimulatedApplication* application : applications_) changes += application->events().size();
    return changes;
}

}  // namespace plume

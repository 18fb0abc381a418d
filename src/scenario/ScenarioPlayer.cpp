#include "scenario/ScenarioPlayer.h"

#include <unicode/utf16.h>

#include <algorithm>
#include <utility>

#include "scenario/ScenarioRun.h"

namespace plume {

namespace {

constexpr double TimeBetweenKeys = 0.05;  // seconds
constexpr double LongestRun = 60;         // seconds

class Player {
  public:
    explicit Player(ScenarioRun& run) : run_(run), desktop_(run.desktop()) {}

    Result<void> play(const std::vector<ScenarioStep>& steps) {
        for (const ScenarioStep& step : steps) {
            const bool waits = std::holds_alternative<WaitStep>(step.action);
            if (!waits && !waited_) run_.loop().runUntilIdle(LongestRun);
            if (!waits && waited_) lastPress_.reset();
            const Result<void> done = std::visit([this](const auto& action) { return perform(action); }, step.action);
            if (!done) return Error{step.place + ": " + done.error().message};
            waited_ = waits;
        }
        if (!waited_) run_.loop().runUntilIdle(LongestRun);
        return {};
    }

  private:
    // A person needs a moment from one key to the next.
    void beforeKey() {
        if (lastPress_) run_.loop().advanceTo(std::max(desktop_.runLoop().now(), *lastPress_ + TimeBetweenKeys));
        lastPress_ = desktop_.runLoop().now();
    }

    Result<void> perform(const TypeStep& step) {
        const std::u16string& text = step.text;
        for (std::size_t i = 0; i < text.size();) {
            std::size_t end = i;
            U16_FWD_1(text, end, text.size());
            beforeKey();
            desktop_.typeCharacter(std::u16string_view(text).substr(i, end - i));
            i = end;
        }
        return {};
    }
    Result<void> perform(const KeyStep& step) {
        for (std::int64_t i = 0; i < step.count; ++i) {
            beforeKey();
            desktop_.pressAndRelease(step.keyCode, step.modifiers);
        }
        return {};
    }
    Result<void> perform(const PressStep& step) {
        beforeKey();
        desktop_.keyboard().press(step.keyCode);
        return {};
    }
    Result<void> perform(const ReleaseStep& step) {
        desktop_.keyboard().release(step.keyCode);
        return {};
    }
    Result<void> perform(const HotKeyStep& step) {
        beforeKey();
        const auto [modifiers, keyCode] = step.hotKey;
        desktop_.pressCombination(modifiers, keyCode == KeyCode::None ? std::nullopt : std::optional(keyCode));
        return {};
    }
    Result<void> perform(const WaitStep& step) {
        run_.loop().advance(step.seconds);
        return {};
    }
    Result<void> perform(const ClickStep& /*step*/) {
        desktop_.click();
        return {};
    }
    Result<void> perform(const ActivateStep& step) {
        run_.activate(step.application);
        return {};
    }
    Result<void> perform(const SelectStep& step) {
        SimulatedApplication* front = desktop_.front();
        if (!front || step.range.location > front->field().text().size() ||
            step.range.length > front->field().text().size() - step.range.location) {
            return Error{"the text in front is too short for this selection"};
        }
        front->select(step.range);
        return {};
    }
    Result<void> perform(const ChooseStep& step) {
        ScenarioList& list = run_.list();
        if (!list.visible) return Error{"no list is shown to choose from"};
        if (step.index >= list.entries.size()) {
            return Error{"the list has " + std::to_string(list.entries.size()) + " entries, counted from 0"};
        }
        list.selected = step.index;
        list.clicked();
        return {};
    }
    Result<void> perform(const FormStep& step) {
        if (run_.forms().open.empty()) return Error{"no form is open"};
        FormModel& model = *run_.forms().open.back().model;
        for (const auto& [name, value] : step.values) {
            Result<void> filled = fill(model, name, value);
            if (!filled) return filled;
        }
        for (const auto& [name, tick] : step.ticks) {
            Result<void> ticked = setTick(model, name, tick);
            if (!ticked) return ticked;
        }
        const auto close = run_.forms().open.back().close;
        close(step.accept);
        return {};
    }

    // The fields of this name, or the one with "#" and this index.
    static std::vector<std::size_t> fieldsNamed(const FormModel& model, const std::u16string& name) {
        std::vector<std::size_t> found;
        for (std::size_t i = 0; i < model.fields().size(); ++i) {
            const auto& fieldName = model.fields()[i].variable->name;
            if (fieldName == name || name == u"#" + fromUtf8(std::to_string(i))) found.push_back(i);
        }
        return found;
    }

    static Result<void> fill(FormModel& model, const std::u16string& name, const std::u16string& value) {
        const std::vector<std::size_t> fields = fieldsNamed(model, name);
        Result<void> refused = Error{"the form has no field \"" + toUtf8(name) + "\""};
        bool filled = false;
        for (const std::size_t index : fields) {
            const Result<void> done = model.fill(index, value);
            filled = filled || done.ok();
            if (!done) refused = Error{"the field \"" + toUtf8(name) + "\" cannot be filled: " + done.error().message};
        }
        return filled ? Result<void>() : refused;
    }

    static Result<void> setTick(FormModel& model, const std::u16string& name, bool tick) {
        bool found = false;
        for (const std::size_t index : fieldsNamed(model, name)) {
            if (!model.fields()[index].variable->isOptional) continue;
            model.setSelected(index, tick);
            found = true;
        }
        if (found) return {};
        return Error{"the form has no optional field \"" + toUtf8(name) + "\""};
    }

    ScenarioRun& run_;
    SimulatedDesktop& desktop_;
    std::optional<double> lastPress_;
    bool waited_ = false;
};

}  // namespace

Result<ScenarioOutcome> playScenario(const Scenario& scenario) {
    ScenarioRun run(scenario);
    const Result<void> played = Player(run).play(scenario.steps);
    if (!played) return Error{scenario.title() + ": at " + played.error().message};
    return outcomeOf(run);
}

}  // namespace plume

// The windows of a scenario: records of what they show, and what a user can do with them.
//
// On the scenario's thread.
#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "app/FormModel.h"
#include "engine/FieldsEditor.h"
#include "engine/QuickSearchController.h"
#include "engine/SuggestionController.h"

namespace plume {

// The list at the caret, while it is visible.
struct ScenarioList {
    bool visible = false;
    std::size_t selected = 0;
    std::vector<std::u16string> entries;  // abbreviations with their prefixes
    std::function<void()> clicked;
};

// The forms that are shown, the last one on top. Each removes itself when it closes.
struct ScenarioForms {
    struct Open {
        const FieldsEditor* editor = nullptr;
        FormModel* model = nullptr;
        std::function<void(bool accept)> close;
    };
    std::vector<Open> open;
};

// The windows write what they show into the records, which outlive them.
std::unique_ptr<SuggestionController> makeScenarioList(ScenarioList& list);
std::unique_ptr<QuickSearchController> makeScenarioSearch();
FieldsEditor::Factory scenarioFieldsEditors(ScenarioForms& forms, std::string locale);

}  // namespace plume

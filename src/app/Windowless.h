// What stands for windows where there are none: lists that never show, and a form that says it is missing.
#pragma once

#include <functional>
#include <memory>
#include <string>

#include "engine/FieldsEditor.h"
#include "engine/QuickSearchController.h"
#include "engine/SuggestionController.h"
#include "engine/SuggestionSource.h"

namespace plume {

std::unique_ptr<SuggestionController> makeWindowlessSuggestionController();
std::unique_ptr<QuickSearchController> makeWindowlessQuickSearchController();

// Offers nothing.
class NoSuggestions final : public SuggestionSource {
  public:
    void appendSuggestions(std::u16string_view /*letters*/, const EngineState::Groups& /*groups*/,
                           SuggestionList& /*list*/) const override {}
};

// Makes forms that tell the user, in place of showing, that the snippet needs a form, and close.
FieldsEditor::Factory windowlessFieldsEditors(std::function<void(const std::string&)> report);

}  // namespace plume

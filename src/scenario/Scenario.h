// One scenario: what is there, what the user does, and what must be seen afterwards.
#pragma once

#include <cstdint>
#include <map>
#include <memory>
#include <nlohmann/json.hpp>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <variant>
#include <vector>

#include "Foundation/Date.h"
#include "Foundation/Result.h"
#include "Foundation/Strings.h"
#include "input/GeneralHotKey.h"
#include "input/delivery/ContextInputSetting.h"
#include "library/SnippetGroup.h"
#include "platform/UserDefaults.h"

namespace plume {

struct TypeStep {
    std::u16string text;
};
struct KeyStep {
    KeyCode keyCode = KeyCode::None;
    KeyModifiers modifiers;
    std::int64_t count = 1;
};
struct PressStep {
    KeyCode keyCode = KeyCode::None;
};
struct ReleaseStep {
    KeyCode keyCode = KeyCode::None;
};
struct HotKeyStep {
    GeneralHotKey hotKey;
};
struct WaitStep {
    double seconds = 0;
};
struct ClickStep {};
struct ActivateStep {
    std::u16string application;
};
struct FormStep {
    // By name, or "#" and an index.
    std::vector<std::pair<std::u16string, std::u16string>> values;
    std::vector<std::pair<std::u16string, bool>> ticks;
    bool accept = true;
};
struct SelectStep {
    Range range;
};
struct ChooseStep {
    std::size_t index = 0;
};

struct ScenarioStep {
    using Action = std::variant<TypeStep, KeyStep, PressStep, ReleaseStep, HotKeyStep, WaitStep, ClickStep,
                                ActivateStep, FormStep, SelectStep, ChooseStep>;
    Action action;
    std::string place;  // where it stands in the file, for messages
};

struct Scenario {
    // For messages: the file, and which of its cases.
    std::string title() const { return name.empty() ? fileName : fileName + ": " + name; }

    std::string fileName;
    std::string name;  // of the case; empty for a file that is one scenario
    std::string about;
    std::vector<std::shared_ptr<SnippetGroup>> library;
    std::shared_ptr<const UserDefaults> settings;
    std::u16string application = u"org.example.editor";
    std::u16string inputSource = u"org.example.keylayout.US";
    std::map<std::u16string, std::u16string> inputMethod;  // words by the letters that are composed to them
    std::map<std::u16string, std::shared_ptr<const ContextInputSetting>> applicationSettings;
    std::optional<Date> now;     // nothing: the real time
    bool keepsKeysBack = false;  // the keyboard can, while Plume sends
    bool tellsItsText = true;    // applications do, to accessibility
    double scriptTime = 0;       // seconds that a script takes on the scenario's clock
    std::string timeZone;        // empty: the system's
    std::string locale;          // empty: the user's
    std::optional<std::u16string> clipboard;
    std::u16string text;
    std::vector<ScenarioStep> steps;
    nlohmann::ordered_json expect = nlohmann::ordered_json::object();
};

// The scenarios of a file: one without a name, or one for each of its cases, with names that differ. The error names
// the file, the place in it and what was expected.
Result<std::vector<Scenario>> readScenarios(std::string_view text, const std::string& fileName);

}  // namespace plume

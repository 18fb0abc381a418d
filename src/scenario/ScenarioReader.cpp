#include <optional>
#include <set>

#include "Foundation/json/JsonNode.h"
#include "library/LibraryFile.h"
#include "library/SettingsFile.h"
#include "scenario/Scenario.h"
#include "scenario/ScenarioSettingReader.h"
#include "scenario/ScenarioStepReader.h"

namespace plume {

namespace {

constexpr double LongestScript = 10;  // seconds

// The keys of a scenario: its own, and those of the file for what it leaves out.
class ScenarioKeys {
  public:
    explicit ScenarioKeys(JsonObject own) : own_(std::move(own)) {}
    ScenarioKeys(JsonObject own, JsonObject file) : own_(std::move(own)), file_(std::move(file)) {}

    const JsonObject& own() const { return own_; }

    template <typename Read>
    void whenSet(std::string_view key, Read read) const {
        (file_ && !own_.has(key) ? *file_ : own_).whenSet(key, read);
    }

  private:
    JsonObject own_;
    std::optional<JsonObject> file_;
};

void readExpectation(const JsonNode& node, Scenario& scenario) {
    const JsonObject object = node.object({"text", "caret", "clipboard", "letters", "application", "sounds",
                                           "suggestions", "form", "errors", "events", "counts"});
    for (const char* key : {"text", "letters", "application"}) {
        if (const auto n = object.find(key)) n->string();
    }
    for (const char* key : {"sounds", "errors"}) {
        if (const auto n = object.find(key)) n->strings();
    }
    if (const auto n = object.find("caret")) n->integer(0);
    if (const auto n = object.find("events")) n->elements();
    object.whenSet("clipboard", [](const JsonNode& n) { n.string(); });
    object.whenSet("suggestions", [](const JsonNode& n) { n.strings(); });
    object.whenSet("form", [](const JsonNode& n) { n.elements(); });
    if (const auto n = object.find("counts")) {
        n->object({"events", "backspaces", "pastes", "leftArrows", "chunks"});
        for (const auto& [name, count] : n->members()) count.integer(0);
    }
    scenario.expect = node.value();
}

void readCircumstances(const ScenarioKeys& keys, Scenario& scenario) {
    keys.whenSet("application", [&](const JsonNode& n) { scenario.application = n.string(); });
    keys.whenSet("inputSource", [&](const JsonNode& n) { scenario.inputSource = n.string(); });
    keys.whenSet("applicationSettings", [&](const JsonNode& n) {
        for (const auto& [name, setting] : n.members()) {
            scenario.applicationSettings[fromUtf8(name)] = readApplicationSetting(setting);
        }
    });
    keys.whenSet("timeZone", [&](const JsonNode& n) { scenario.timeZone = readTimeZone(n); });
    keys.whenSet("locale", [&](const JsonNode& n) { scenario.locale = toUtf8(n.string()); });
    keys.whenSet("now", [&](const JsonNode& n) { scenario.now = readNow(n, scenario.timeZone); });
    keys.whenSet("inputMethod", [&](const JsonNode& n) {
        for (const auto& [letters, word] : n.members()) scenario.inputMethod[fromUtf8(letters)] = word.string();
    });
    keys.whenSet("keepsKeysBack", [&](const JsonNode& n) { scenario.keepsKeysBack = n.boolean(); });
    keys.whenSet("tellsItsText", [&](const JsonNode& n) { scenario.tellsItsText = n.boolean(); });
    keys.whenSet("scriptTime", [&](const JsonNode& n) { scenario.scriptTime = n.number(0, LongestScript); });
    keys.whenSet("clipboard", [&](const JsonNode& n) { scenario.clipboard = n.string(); });
    keys.whenSet("text", [&](const JsonNode& n) { scenario.text = n.string(); });
}

Scenario readScenario(const ScenarioKeys& keys, const std::string& fileName) {
    Scenario scenario;
    scenario.fileName = fileName;
    scenario.settings = SettingsFile::registeredDefaults();
    keys.own().whenSet("about", [&](const JsonNode& n) { scenario.about = toUtf8(n.string()); });
    keys.whenSet("library", [&](const JsonNode& n) { scenario.library = LibraryFile::readFrom(n); });
    keys.whenSet("settings", [&](const JsonNode& n) { scenario.settings = SettingsFile::readFrom(n); });
    readCircumstances(keys, scenario);
    keys.own().whenSet("steps", [&](const JsonNode& n) {
        for (const JsonNode& step : n.elements()) {
            scenario.steps.push_back(readScenarioStep(step, *scenario.settings));
        }
    });
    keys.own().whenSet("expect", [&](const JsonNode& n) { readExpectation(n, scenario); });
    return scenario;
}

std::string readName(const JsonObject& object, std::set<std::string>& taken) {
    const std::optional<JsonNode> node = object.find("name");
    if (!node) object.node().fail("expected a \"name\" for the case");
    std::string name = toUtf8(node->string());
    if (name.empty()) node->fail("expected a name");
    if (!taken.insert(name).second) node->fail("expected a name that no case before it has");
    return name;
}

std::vector<Scenario> readCases(const JsonNode& cases, const JsonObject& file, const std::string& fileName) {
    for (const char* key : {"steps", "expect"}) {
        file.whenSet(key, [](const JsonNode& n) { n.fail("expected inside the cases, not beside them"); });
    }
    std::vector<Scenario> scenarios;
    std::set<std::string> names;
    for (const JsonNode& node : cases.elements()) {
        const JsonObject object =
            node.object({"name", "about", "library", "settings", "application", "inputSource", "inputMethod",
                         "applicationSettings", "now", "timeZone", "locale", "scriptTime", "keepsKeysBack",
                         "tellsItsText", "clipboard", "text", "steps", "expect"});
        const std::string name = readName(object, names);
        scenarios.push_back(readScenario(ScenarioKeys(object, file), fileName));
        scenarios.back().name = name;
    }
    if (scenarios.empty()) cases.fail("expected at least one case");
    return scenarios;
}

std::vector<Scenario> readFrom(const JsonNode& node, const std::string& fileName) {
    const JsonObject file =
        node.object({"about", "library", "settings", "application", "inputSource", "inputMethod", "applicationSettings",
                     "now", "timeZone", "locale", "scriptTime", "keepsKeysBack", "tellsItsText", "clipboard", "text",
                     "steps", "expect", "cases"});
    const std::optional<JsonNode> cases = file.find("cases");
    if (cases && !cases->isNull()) return readCases(*cases, file, fileName);
    return {readScenario(ScenarioKeys(file), fileName)};
}

}  // namespace

Result<std::vector<Scenario>> readScenarios(std::string_view text, const std::string& fileName) {
    return readingJson([&] { return readFrom(JsonNode::parse(text, fileName), fileName); });
}

}  // namespace plume

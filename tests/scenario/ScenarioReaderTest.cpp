#include <gtest/gtest.h>

#include <nlohmann/json.hpp>
#include <string>

#include "scenario/ScenarioReport.h"

namespace plume {

namespace {

struct Fault {
    std::string text;
    std::string message;  // a part of it
};

ScenarioReport simulated(const std::string& text) {
    return simulate(text, "s.json");
}

}  // namespace

TEST(ScenarioFaults, AreNamedWithTheirPlace) {
    const Fault faults[] = {
        {"", "no JSON"},
        {"[]", "at $: expected an object"},
        {R"({"steps": []} x)", "no JSON"},
        {R"({"about": "a", "about": "b"})", "the key \"about\" twice"},
        {std::string(100, '['), "nested too deeply"},
        {"{\"text\": \"\xFF\"}", "no JSON"},
        {R"({"txet": ""})", "at $.txet: unknown key; expected one of about, library"},
        {R"({"text": 1})", "at $.text: expected a string"},
        {R"({"library": [{"items": [{}, {"contentType": 5}]}]})",
         "at $.library[0].items[1].contentType: expected a whole number from 0 to 4"},
        {R"({"library": [{"expandAfter": 1.5}]})", "at $.library[0].expandAfter: expected a whole number"},
        {R"({"library": [{"availability": {"availability": 3}}]})", "availability.availability: expected"},
        {R"({"library": [{"items": [{"uuid": "x"}]}]})", "items[0].uuid: expected a UUID"},
        {R"({"library": [{"items": [{"rtf": "{\\rtf1 x}"}]}]})", "items[0].rtf: only contentType 1"},
        {R"({"library": [{"items": [{"contentType": 1, "rtf": "x"}]}]})", "items[0].rtf: expected RTF"},
        {R"({"settings": {"Nonsense": 1}})", "at $.settings.Nonsense: unknown setting"},
        {R"({"settings": {"UseClipboard": 1}})", "at $.settings.UseClipboard: expected true or false"},
        {R"({"settings": {"UseClipboardIn": 3}})", "UseClipboardIn: expected a whole number from 0 to 2"},
        {R"({"settings": {"RestoreClipboardDelay": -1}})", "RestoreClipboardDelay: expected a number from 0"},
        {R"({"settings": {"UndoHotKey": 73014444032}})", "UndoHotKey: expected a packed hot key"},
        {R"({"settings": {"UseClipboardApplications": ["a", 1]}})",
         "$.settings.UseClipboardApplications[1]: expected a string"},
        {R"({"applicationSettings": {"org.x": {"flags": ["usesClipboard"]}}})",
         "$.applicationSettings[\"org.x\"].flags[0]: expected one of"},
        {R"({"now": "2026-02-30T10:00:00"})", "at $.now: expected a moment"},
        {R"({"now": "2026-01-31 10:00"})", "at $.now: expected a moment"},
        {R"({"timeZone": "Mars/Olympus"})", "at $.timeZone: expected the name of a time zone"},
        {R"({"steps": [{"type": "a", "wait": 1}]})", "at $.steps[0]: expected an object that says one thing"},
        {R"({"steps": [{"key": 51, "modifiers": ["alt"]}]})", "at $.steps[0].modifiers[0]: expected one of"},
        {R"({"steps": [{"key": 128}]})", "at $.steps[0].key: expected"},
        {R"({"steps": [{"key": 1, "type": "a"}]})", "at $.steps[0].type: unknown key"},
        {R"({"steps": [{"hotKey": "UndoHotKey"}]})", "at $.steps[0].hotKey: expected a hot key that the settings"},
        {R"({"steps": [{"hotKey": "Undo"}]})", "at $.steps[0].hotKey: expected the name of a hot-key setting"},
        {R"({"steps": [{"wait": -1}]})", "at $.steps[0].wait: expected a number"},
        {R"({"steps": [{"click": false}]})", "at $.steps[0].click: expected true"},
        {R"({"steps": [{"type": "a"}, {"form": {}}]})", "at $.steps[1]: no form is open"},
        {R"({"steps": [{"choose": 0}]})", "at $.steps[0]: no list is shown"},
        {R"({"steps": [{"select": {"start": 1}}]})", "at $.steps[0]: the text in front is too short"},
        {R"({"library": [{"items": [{"abbreviation": "q", "content": "【field:A】"}]}],
                 "steps": [{"type": "q"}, {"form": {"B": ""}}]})",
         "at $.steps[1]: the form has no field \"B\""},
        {R"({"expect": {"txt": ""}})", "at $.expect.txt: unknown key"},
        {R"({"expect": {"counts": {"keys": 1}}})", "at $.expect.counts.keys: unknown key"},
        {R"({"name": "a"})", "at $.name: unknown key"},
        {R"({"cases": []})", "at $.cases: expected at least one case"},
        {R"({"cases": {}})", "at $.cases: expected a list"},
        {R"({"cases": [{"name": "a"}], "steps": []})", "at $.steps: expected inside the cases"},
        {R"({"cases": [{"name": "a"}], "expect": {}})", "at $.expect: expected inside the cases"},
        {R"({"cases": [{"about": "a"}]})", "at $.cases[0]: expected a \"name\""},
        {R"({"cases": [{"name": ""}]})", "at $.cases[0].name: expected a name"},
        {R"({"cases": [{"name": "a"}, {"name": "a"}]})", "at $.cases[1].name: expected a name that no case"},
        {R"({"cases": [{"name": "a", "cases": []}]})", "at $.cases[0].cases: unknown key"},
        {R"({"cases": [{"name": "a"}, {"name": "b", "steps": [{"wait": -1}]}]})", "at $.cases[1].steps[0].wait"},
        {R"({"text": 1, "cases": [{"name": "a"}]})", "at $.text: expected a string"},
    };
    for (const Fault& fault : faults) {
        const ScenarioReport report = simulated(fault.text);
        EXPECT_EQ(report.exitStatus, 2) << fault.text;
        EXPECT_EQ(report.output, "") << "something was played";
        EXPECT_TRUE(report.problems.starts_with("s.json: ")) << report.problems;
        EXPECT_NE(report.problems.find(fault.message), std::string::npos) << report.problems;
    }
}

TEST(ScenarioPlayer, ShowsBothSidesOfADifference) {
    const ScenarioReport report =
        simulated(R"({"steps": [{"type": "ab"}], "expect": {"text": "abc", "caret": 2, "counts": {"events": 1}}})");
    EXPECT_EQ(report.exitStatus, 1);
    EXPECT_EQ(report.problems,
              "s.json: text: expected \"abc\", got \"ab\"\ns.json: counts.events: expected 1, got 0\n");
    EXPECT_NE(report.output.find("\"text\": \"ab\""), std::string::npos);
}

TEST(ScenarioPlayer, ComparesListsAsAWhole) {
    EXPECT_EQ(simulated(R"({"expect": {"events": [{"key": 0}]}})").exitStatus, 1);
    EXPECT_EQ(simulated(R"({"steps": [{"press": 0}], "expect": {"events": [{"key": 0}]}})").exitStatus, 0);
    EXPECT_EQ(simulated(R"({"steps": [{"press": 0}], "expect": {"events": [{"key": 1}]}})").exitStatus, 1);
    EXPECT_EQ(simulated(R"({"steps": [{"press": 0}], "expect": {"events": []}})").exitStatus, 1);
}

TEST(ScenarioCases, TakeWholeKeysFromTheFileForThoseThatTheyLeaveOut) {
    const ScenarioReport report = simulated(R"({"about": "shared", "text": "x ", "clipboard": "mine",
        "library": [{"items": [{"abbreviation": "q", "content": "shared"}, {"abbreviation": "r", "content": "R"}]}],
        "cases": [
          {"name": "all", "steps": [{"type": "q"}], "expect": {"text": "x shared", "clipboard": "mine"}},
          {"name": "none", "text": "", "clipboard": null, "library": [{"items": [{"abbreviation": "q", "content": "own"}]}],
           "steps": [{"type": "q r"}], "expect": {"text": "own r", "clipboard": null}}]})");
    EXPECT_EQ(report.problems, "");
    const auto outcomes = nlohmann::json::parse(report.output);
    EXPECT_EQ(outcomes.size(), 2u);
    EXPECT_EQ(outcomes.at("all").at("text"), "x shared");
    EXPECT_EQ(outcomes.at("none").at("text"), "own r");
}

TEST(ScenarioCases, ArePlayedApartAndNamedInMessages) {
    const std::string text = R"({"cases": [
        {"name": "a", "steps": [{"type": "one"}, {"activate": "org.example.other"}, {"type": "two"}],
         "expect": {"text": "two"}},
        {"name": "b", "steps": [{"type": "s"}], "expect": {"text": "t"}},
        {"name": "c", "steps": [{"type": "u"}, {"choose": 0}]},
        {"name": "d", "expect": {"text": "", "letters": "", "application": "org.example.editor"}}]})";
    const ScenarioReport report = simulated(text);
    EXPECT_EQ(report.exitStatus, 2);
    EXPECT_EQ(report.problems,
              "s.json: b: text: expected \"t\", got \"s\"\n"
              "s.json: c: at $.cases[2].steps[1]: no list is shown to choose from\n");
    const auto outcomes = nlohmann::json::parse(report.output);
    EXPECT_TRUE(outcomes.contains("a") && outcomes.contains("b") && outcomes.contains("d"));
    EXPECT_FALSE(outcomes.contains("c")) << "it did not come to its end";

    EXPECT_EQ(simulate(text, "s.json", "b").problems, "s.json: b: text: expected \"t\", got \"s\"\n");
    EXPECT_EQ(simulate(text, "s.json", "d").exitStatus, 0);
    EXPECT_EQ(simulate(text, "s.json", "e").problems, "s.json: no case has the name \"e\"\n");
}

TEST(ScenarioPlayer, PlaysTheSameTwice) {
    const std::string text = R"({"library": [{"items": [{"abbreviation": "q", "contentType": 3,
                                 "content": "echo done"}]}], "steps": [{"type": "x q y"}]})";
    EXPECT_EQ(simulated(text).output, simulated(text).output);
}

}  // namespace plume

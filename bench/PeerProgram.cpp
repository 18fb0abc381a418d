#include "bench/PeerProgram.h"

#include <poll.h>
#include <unistd.h>

#include <fstream>
#include <nlohmann/json.hpp>

#include "testing/rig/Deadline.h"

namespace plume::bench {

namespace {

using nlohmann::json;

void write(const std::filesystem::path& file, const std::string& content) {
    std::ofstream(file) << content;
}

// What a phrase and a folder have in common.
json describe(const std::string& type, const std::vector<std::string>& abbreviations) {
    return {{"type", type},
            {"modes", abbreviations.empty() ? json::array() : json::array({1})},
            {"usageCount", 0},
            {"showInTrayMenu", false},
            {"abbreviation",
             {{"abbreviations", abbreviations},
              {"backspace", true},
              {"ignoreCase", false},
              {"immediate", true},
              {"triggerInside", false},
              {"wordChars", "[\\w]"}}},
            {"hotkey", {{"modifiers", json::array()}, {"hotKey", nullptr}}},
            {"filter", {{"regex", nullptr}, {"isRecursive", false}}}};
}

void writePhrase(const std::filesystem::path& folder, const PeerPhrase& phrase, bool forTerminal) {
    json description = describe("phrase", {phrase.abbreviation});
    description["description"] = phrase.abbreviation;
    description["prompt"] = false;
    description["omitTrigger"] = false;
    description["matchCase"] = false;
    description["sendMode"] = !phrase.paste ? "kb" : forTerminal ? "<shift>+<insert>" : "<ctrl>+v";
    write(folder / ("." + phrase.abbreviation + ".json"), description.dump());
    write(folder / (phrase.abbreviation + ".txt"), phrase.content);
}

void writeConfiguration(const std::filesystem::path& home, const std::vector<PeerPhrase>& phrases, bool forTerminal) {
    const auto configuration = home / ".config/autokey";
    const auto folder = configuration / "data/bench";
    std::filesystem::remove_all(configuration);
    std::filesystem::create_directories(folder);
    json description = describe("folder", {});
    description["title"] = "bench";
    write(folder / ".folder.json", description.dump());
    for (const PeerPhrase& phrase : phrases) writePhrase(folder, phrase, forTerminal);

    const json noHotKey = {{"enabled", false}, {"modifiers", json::array()}, {"hotKey", nullptr}};
    const json settings = {{"isFirstRun", false},   {"serviceRunning", true},     {"showTrayIcon", false},
                           {"promptToSave", false}, {"interfaceType", "XRecord"}, {"undoUsingBackspace", true}};
    const json main = {{"version", "0.95.10"},         {"userCodeDir", nullptr},          {"settings", settings},
                       {"folders", {folder.string()}}, {"toggleServiceHotkey", noHotKey}, {"configHotkey", noHotKey}};
    write(configuration / "autokey.json", main.dump(4));
}

}  // namespace

bool PeerProgram::isInstalled() {
    return access("/usr/bin/autokey-gtk", X_OK) == 0;
}

PeerProgram::PeerProgram(rig::DesktopRig& rig, const std::vector<PeerPhrase>& phrases, bool forTerminal) {
    writeConfiguration(rig.directory() / "home", phrases, forTerminal);
    process_ = rig.session().start({"/usr/bin/env", "autokey-gtk", "-l"}, "autokey-gtk");
    const rig::Deadline deadline(rig::Milliseconds(30'000));
    while (process_->logTail().find("Entering main()") == std::string::npos) {
        if (deadline.passed() || !process_->isRunning()) {
            throw rig::RigError("autokey-gtk did not start: " + process_->logTail());
        }
        poll(nullptr, 0, 50);
    }
}

}  // namespace plume::bench

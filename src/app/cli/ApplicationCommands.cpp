#include "app/cli/ApplicationCommands.h"

#include <nlohmann/json.hpp>
#include <numeric>
#include <sstream>
#include <utility>
#include <variant>

#include "Foundation/Strings.h"
#include "app/cli/StoreCommands.h"
#include "app/cli/Version.h"

namespace plume {

namespace {

CommandReply failed(const std::string& sentence) {
    return {ExitStatus::Failure, {}, "plume: " + sentence + "\n"};
}

std::size_t snippetCount(const SnippetGroups& groups) {
    return std::accumulate(groups.begin(), groups.end(), std::size_t{0},
                           [](std::size_t sum, const auto& group) { return sum + group->items().size(); });
}

}  // namespace

bool needsRunningPlume(Command command) {
    switch (command) {
        case Command::Show:
        case Command::Open:
        case Command::Toggle:
        case Command::QuickSearch:
        case Command::Suggest:
        case Command::Undo:
        case Command::ExpandTyped:
        case Command::Status:
        case Command::Quit:
            return true;
        default:
            return false;
    }
}

// What only reads is done where it was asked for.
bool isForRunningPlume(Command command) {
    const bool onlyReads = command == Command::Export || command == Command::Backups;
    return needsRunningPlume(command) || (isStoreCommand(command) && !onlyReads);
}

CommandReply ApplicationCommands::perform(const CommandRequest& request) {
    std::vector<const char*> arguments{"plume"};
    for (const std::string& argument : request.arguments) arguments.push_back(argument.c_str());
    const auto parsed = parseCommandLine(static_cast<int>(arguments.size()), arguments.data());
    if (const auto* farewell = std::get_if<Farewell>(&parsed)) {
        return {farewell->status, farewell->output, farewell->error};
    }
    return performHere(std::get<CommandLine>(parsed), request);
}

CommandReply ApplicationCommands::performHere(const CommandLine& line, const CommandRequest& request) {
    if (!delegate_.uiLoaded() && line.command != Command::Open) {
        // Whoever starts it by asking for it gets what it shows at its start.
        return line.command == Command::Show ? CommandReply() : failed("Plume is still starting.");
    }
    if (isStoreCommand(line.command)) {
        std::ostringstream output;
        std::ostringstream error;
        const int status = performOnLibrary(line, {manager_, files_, request.folder, output, error});
        // Whoever gets the reply may type at once.
        delegate_.feedExpansion();
        return {status, output.str(), error.str()};
    }
    switch (line.command) {
        case Command::Application:
            return show("main");
        case Command::Show:
            return show(line.text.empty() ? "main" : line.text);
        case Command::Open:
            return open(line, request.folder);
        case Command::Toggle:
            delegate_.onEnabledItemClick();
            return {ExitStatus::Success, delegate_.status().isEnabled ? "on\n" : "off\n", {}};
        case Command::Undo:
            delegate_.undo();
            return {};
        case Command::ExpandTyped:
            delegate_.expandAtHotkey();
            return {};
        case Command::Status:
            return status(line.json);
        case Command::Quit:
            delegate_.terminate();
            return {};
        case Command::QuickSearch:
            delegate_.quickSearch();
            return {};
        case Command::Suggest:
            delegate_.suggestAbbreviations();
            return {};
        default:
            return failed("this is no command for the Plume that runs.");
    }
}

CommandReply ApplicationCommands::show(const std::string& window) {
    if (window == "main") delegate_.applicationShouldHandleReopen();
    if (window == "preferences") delegate_.showPreferencesWindow();
    if (window == "new-snippet") delegate_.newDocument();
    if (window == "new-from-clipboard") delegate_.makeSnippetFromClipboard();
    if (window == "new-from-selection") delegate_.makeSnippetFromSelection();
    if (window == "decisions") delegate_.showDecisionsWindow();
    if (window == "reports") delegate_.showReportsWindow();
    if (window == "diagnostics") delegate_.diagnostic();
    if (window == "restore") delegate_.showRestoreWindow();
    if (window == "welcome") delegate_.showWelcomeWindow();
    if (window == "about") delegate_.showAboutWindow();
    return {};
}

CommandReply ApplicationCommands::open(const CommandLine& line, const std::filesystem::path& folder) {
    for (const std::string& file : line.files) delegate_.applicationOpenFile((folder / file).lexically_normal());
    return {};
}

CommandReply ApplicationCommands::status(bool asJson) const {
    const Status status = delegate_.status();
    const std::size_t snippets = snippetCount(manager_.snippetGroups());
    const std::string secureInput = toUtf8(status.secureInputStatus);
    if (asJson) {
        const nlohmann::ordered_json state{{"version", Version},
                                           {"enabled", status.isEnabled},
                                           {"secureInput", status.secureInput},
                                           {"secureInputStatus", secureInput},
                                           {"keyboardLost", status.keyboardIsLost},
                                           {"icon", delegate_.statusItemIsVisible()},
                                           {"snippets", snippets}};
        return {ExitStatus::Success, state.dump(2) + "\n", {}};
    }
    std::string text = std::string("Plume ") + Version + " is " + (status.isEnabled ? "on" : "off") + ", with " +
                       std::to_string(snippets) + " snippets.\n" + secureInput + ".\n";
    if (status.keyboardIsLost) text += "The keyboard is not listened to just now.\n";
    if (!delegate_.statusItemIsVisible()) text += "The desktop shows no icon of Plume.\n";
    return {ExitStatus::Success, text, {}};
}

}  // namespace plume

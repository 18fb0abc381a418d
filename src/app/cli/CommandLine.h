// What the user asked for on the command line.
#pragma once

#include <optional>
#include <string>
#include <variant>
#include <vector>

#include "app/cli/SettingsCommand.h"

namespace plume {

// Exit statuses of the program.
namespace ExitStatus {
inline constexpr int Success = 0;
inline constexpr int Failure = 1;
inline constexpr int WrongInput = 2;     // wrong arguments, or a file that does not say what it should
inline constexpr int MissingSystem = 3;  // the desktop lacks what a text expander needs
}  // namespace ExitStatus

enum class Command {
    Application,  // no command: the program with its icon and windows
    Run,
    List,
    Search,
    Expand,
    Add,
    Remove,
    Edit,
    Import,
    Export,
    Convert,
    Backup,
    Backups,
    Restore,
    Settings,
    Doctor,
    Simulate,
    Completion,
    // For the Plume that runs.
    Show,
    Open,
    Toggle,
    QuickSearch,
    Suggest,
    Undo,
    ExpandTyped,
    Status,
    Quit
};

struct CommandLine {
    Command command = Command::Application;
    std::optional<std::string> library;     // for Run, List, Search and Expand
    std::optional<std::string> settings;    // for Run
    std::vector<std::string> files;         // what is read or written
    std::optional<std::string> onlyCase;    // for Simulate
    SettingsRequest request;                // for Settings
    std::string text;                       // what to search for, the abbreviation, the window to show, or the shell
    std::string content;                    // for Add
    std::optional<std::string> group;       // for Add and Export
    std::optional<std::string> label;       // for Add
    bool withPreferences = false;           // for Export
    bool textExpanderPlaceholders = false;  // for Import and Convert
    bool json = false;                      // for Search and Status
    bool onlyAbbreviations = false;         // for List
};

// Nothing is left to do but to print this and to end.
struct Farewell {
    std::string output;
    std::string error;  // one line
    int status = ExitStatus::Success;
};

std::variant<CommandLine, Farewell> parseCommandLine(int argc, const char* const* argv);

// A command as it can be written, for shells that complete it.
struct CommandOutline {
    Command command;
    std::string name;
    std::string purpose;
    std::vector<std::string> options;  // "--json"
};
std::vector<CommandOutline> commandOutlines();
// What `show` shows.
const std::vector<std::string>& shownWindows();

}  // namespace plume

#include "app/cli/CommandLine.h"

#include <CLI/CLI.hpp>
#include <array>
#include <utility>

#include "app/cli/Version.h"

namespace plume {

namespace {

// A command, and how it is written down.
struct CommandForm {
    Command command;
    const char* name;
    const char* form;
    const char* purpose;
};

constexpr std::array Forms = {
    CommandForm{Command::Run, "run", "plume run [--library FILE.json|FILE.csv] [--settings FILE.json]",
                "Expand abbreviations in every program, until Ctrl+C"},
    CommandForm{Command::List, "list", "plume list [--library FILE.json|FILE.csv] [--abbreviations]",
                "Show all snippets"},
    CommandForm{Command::Search, "search", "plume search TEXT [--library FILE.json|FILE.csv] [--json]",
                "Show the snippets that hold every word of TEXT, the best first, and what is like them"},
    CommandForm{Command::Expand, "expand", "plume expand ABBREVIATION [--library FILE.json|FILE.csv]",
                "Print what an abbreviation expands to; its scripts are run"},
    CommandForm{Command::Add, "add", "plume add ABBREVIATION TEXT [--group NAME] [--label TEXT]",
                "Add a snippet to your library"},
    CommandForm{Command::Remove, "remove", "plume remove ABBREVIATION", "Remove a snippet from your library"},
    CommandForm{Command::Edit, "edit", "plume edit", "Change your library as JSON in $VISUAL or $EDITOR"},
    CommandForm{Command::Import, "import", "plume import FILE|FOLDER... [--placeholders textexpander]",
                "Add the snippets of other files, and of other text expanders, to your library"},
    CommandForm{Command::Export, "export",
                "plume export FILE.plume|FILE.csv|FILE.json [--group NAME] [--with-preferences]",
                "Write your library, or one group of it, into a file"},
    CommandForm{Command::Convert, "convert",
                "plume convert FILE|FOLDER FILE.plume|FILE.csv|FILE.json [--placeholders textexpander]",
                "Write what import would read as a file, without touching your library"},
    CommandForm{Command::Backup, "backup", "plume backup", "Make a backup of your library now"},
    CommandForm{Command::Backups, "backups", "plume backups", "Show the backups, the newest last"},
    CommandForm{Command::Restore, "restore", "plume restore FILE|latest",
                "Put a backup, or another file, in place of your library, after a backup of it"},
    CommandForm{Command::Settings, "settings", "plume settings [KEY [VALUE]] [--default]",
                "Show all settings, or one; or set it to VALUE, or back to its default"},
    CommandForm{Command::Doctor, "doctor", "plume doctor",
                "Check what Plume needs of this desktop, and say what to do about what is missing"},
    CommandForm{Command::Simulate, "simulate", "plume simulate FILE... [--case NAME]",
                "Play scenarios of typing on a simulated desktop and compare what comes out"},
    CommandForm{Command::Completion, "completion", "plume completion bash|zsh|fish",
                "Print what makes a shell complete commands, options and abbreviations"},
    CommandForm{Command::Show, "show", "plume show [WINDOW]", "Show a window of the Plume that runs"},
    CommandForm{Command::Open, "open", "plume open FILE...", "Have the Plume that runs import or restore a file"},
    CommandForm{Command::Toggle, "toggle", "plume toggle", "Switch expansion off, or on again"},
    CommandForm{Command::QuickSearch, "quick-search", "plume quick-search", "Search for a snippet and send it"},
    CommandForm{Command::Suggest, "suggest", "plume suggest", "Suggest snippets for what was typed last"},
    CommandForm{Command::Undo, "undo", "plume undo", "Take the last expansion back"},
    CommandForm{Command::ExpandTyped, "expand-typed", "plume expand-typed", "Expand what was typed last"},
    CommandForm{Command::Status, "status", "plume status [--json]", "Tell what the Plume that runs is doing"},
    CommandForm{Command::Quit, "quit", "plume quit", "End the Plume that runs"},
};

const std::vector<std::string> Windows{"main",      "preferences", "new-snippet",       "new-from-clipboard",
                                       "decisions", "reports",     "diagnostics",       "restore",
                                       "welcome",   "about",       "new-from-selection"};

constexpr const char* GeneralForm =
    "plume "
    "run|list|search|expand|add|remove|edit|import|export|convert|backup|backups|restore|settings|doctor|simulate|"
    "completion|show|open|"
    "toggle|quick-search|suggest|undo|expand-typed|status|quit ...";

constexpr const char* Examples = R"(
Examples:
  plume                             start Plume, or show the one that runs
  plume run                         expand your snippets in every program, without windows
  plume toggle                      switch expansion off and on: for a shortcut of your desktop
  plume run --library mine.json     expand the snippets of this file, also when it changes
  plume list                        what there is to type
  plume search arrow                find a snippet
  plume expand ;date                print an expansion
  plume settings FeedbackSound Pop  change a setting
  plume add btw "by the way"        add a snippet
  plume import old.csv              take over the snippets of a file
  plume restore latest              go back to the newest backup
  source <(plume completion bash)   complete abbreviations in this shell
  plume doctor                      why does nothing happen?

Your library and settings are kept in $XDG_CONFIG_HOME/plume (or ~/.config/plume). The first command that needs the
library begins it with examples. A library in CSV has an abbreviation, a text and a label on each line, without a heading.

Exit status: 0 all is well, 1 it did not work, 2 wrong arguments or a file with a mistake, 3 the desktop lacks
something that Plume needs.)";

class Parser {
  public:
    Parser() : app_("Plume expands abbreviations into texts wherever you type.", "plume") {
        app_.set_version_flag("--version", std::string("plume ") + Version, "Print the version");
        app_.set_help_flag("-h,--help", "Print this help");
        app_.footer(Examples);
        app_.require_subcommand(0, 1);
        for (const CommandForm& form : Forms) addCommand(form);
    }

    std::variant<CommandLine, Farewell> parse(int argc, const char* const* argv) {
        try {
            app_.parse(argc, argv);
        } catch (const CLI::CallForHelp&) {
            return Farewell{app_.help(), "", ExitStatus::Success};
        } catch (const CLI::CallForVersion& version) {
            return Farewell{std::string(version.what()) + "\n", "", ExitStatus::Success};
        } catch (const CLI::ParseError& mistake) {
            return refusal(mistake);
        }
        if (const CommandForm* form = formInUse()) result_.command = form->command;
        return result_;
    }

    std::vector<CommandOutline> outlines() const {
        std::vector<CommandOutline> outlines;
        for (const CommandForm& form : Forms) {
            CommandOutline outline{form.command, form.name, form.purpose, {}};
            for (const CLI::Option* option : app_.get_subcommand(form.name)->get_options()) {
                for (const std::string& name : option->get_lnames()) outline.options.push_back("--" + name);
            }
            outlines.push_back(std::move(outline));
        }
        return outlines;
    }

  private:
    void addCommand(const CommandForm& form) {
        CLI::App* command = app_.add_subcommand(form.name, form.purpose);
        command->footer(std::string("Form: ") + form.form);
        switch (form.command) {
            case Command::Run:
                addLibrary(*command);
                command->add_option("--settings", result_.settings, "Settings to use")->type_name("FILE.json");
                break;
            case Command::List:
                addLibrary(*command);
                command->add_flag("--abbreviations", result_.onlyAbbreviations,
                                  "Nothing but what is typed, one a line");
                break;
            case Command::Search:
                addLibrary(*command);
                command->add_option("TEXT", result_.text, "What to look for")->required();
                command->add_flag("--json", result_.json, "For programs to read");
                break;
            case Command::Expand:
                addLibrary(*command);
                command->add_option("ABBREVIATION", result_.text, "With its group's prefix, or without")->required();
                break;
            case Command::Settings:
                addSettings(*command);
                break;
            case Command::Simulate:
                command->add_option("FILE", result_.files, "Scenarios")->required();
                command->add_option("--case", result_.onlyCase, "Play only the case of this name")->type_name("NAME");
                break;
            case Command::Add:
                command->add_option("ABBREVIATION", result_.text, "What will be typed")->required();
                command->add_option("TEXT", result_.content, "What will stand there instead")->required();
                command->add_option("--group", result_.group, "The group to put it into")->type_name("NAME");
                command->add_option("--label", result_.label, "What lists call it")->type_name("TEXT");
                break;
            case Command::Remove:
                command->add_option("ABBREVIATION", result_.text, "With its group's prefix, or without")->required();
                break;
            case Command::Import:
                command->add_option("FILE", result_.files, "Libraries, or folders of them")->required();
                addPlaceholders(*command);
                break;
            case Command::Export:
                command->add_option("FILE", result_.files, "What to write")->required()->expected(1);
                command->add_option("--group", result_.group, "Only the group of this name")->type_name("NAME");
                command->add_flag("--with-preferences", result_.withPreferences,
                                  "Also the settings that belong to a library; only in a .plume file");
                break;
            case Command::Convert:
                command->add_option("FILES", result_.files, "What to read, and what to write")->required()->expected(2);
                addPlaceholders(*command);
                break;
            case Command::Restore:
                command->add_option("FILE", result_.files, "A backup, or latest")->required()->expected(1);
                break;
            case Command::Show:
                command->add_option("WINDOW", result_.text, "Which one; the main window where nothing is said")
                    ->check(CLI::IsMember(Windows));
                break;
            case Command::Completion:
                command->add_option("SHELL", result_.text, "Which shell")
                    ->required()
                    ->check(CLI::IsMember({"bash", "zsh", "fish"}));
                break;
            case Command::Open:
                command->add_option("FILE", result_.files, "Libraries")->required();
                break;
            case Command::Status:
                command->add_flag("--json", result_.json, "For programs to read");
                break;
            default:
                break;
        }
    }

    void addSettings(CLI::App& command) {
        CLI::Option* key = command.add_option("KEY", result_.request.key, "A setting's name");
        CLI::Option* value =
            command.add_option("VALUE", result_.request.value, "A text, a number, true or false; lists as JSON");
        command.add_flag("--default", result_.request.toDefault, "Forget the value that was set")
            ->needs(key)
            ->excludes(value);
    }

    void addPlaceholders(CLI::App& command) {
        command
            .add_option_function<std::string>(
                "--placeholders", [this](const std::string&) { result_.textExpanderPlaceholders = true; },
                "Whose placeholders the contents of CSV files hold")
            ->check(CLI::IsMember({"textexpander"}))
            ->type_name("textexpander");
    }

    void addLibrary(CLI::App& command) {
        command.add_option("--library", result_.library, "Snippets to use")->type_name("FILE.json|FILE.csv");
    }

    const CommandForm* formInUse() const {
        for (const CommandForm& form : Forms) {
            if (app_.got_subcommand(form.name)) return &form;
        }
        return nullptr;
    }

    std::string reasonWithoutCommand() const {
        const std::vector<std::string> unknown = app_.remaining();
        if (unknown.empty()) return "there is no command";
        return "\"" + unknown.front() + "\" is no " + (unknown.front().starts_with("-") ? "option" : "command");
    }

    Farewell refusal(const CLI::ParseError& mistake) const {
        const CommandForm* form = formInUse();
        std::string reason = form ? mistake.what() : reasonWithoutCommand();
        for (char& c : reason) {
            if (c == '\n') c = ' ';
        }
        return {"", "plume: " + reason + " (right: " + (form ? form->form : GeneralForm) + ")\n",
                ExitStatus::WrongInput};
    }

    CLI::App app_;
    CommandLine result_;
};

}  // namespace

std::variant<CommandLine, Farewell> parseCommandLine(int argc, const char* const* argv) {
    return Parser().parse(argc, argv);
}

std::vector<CommandOutline> commandOutlines() {
    return Parser().outlines();
}

const std::vector<std::string>& shownWindows() {
    return Windows;
}

}  // namespace plume

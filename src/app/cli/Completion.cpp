#include "app/cli/Completion.h"

#include <string_view>
#include <vector>

#include "app/cli/CommandLine.h"
#include "library/KnownSettings.h"

namespace plume {

namespace {

using Words = std::vector<std::string>;

enum class ArgumentKind { Nothing, Abbreviation, File, Window, Setting, Shell };

ArgumentKind argumentOf(Command command) {
    switch (command) {
        case Command::Expand:
        case Command::Remove:
            return ArgumentKind::Abbreviation;
        case Command::Import:
        case Command::Export:
        case Command::Convert:
        case Command::Restore:
        case Command::Simulate:
        case Command::Open:
            return ArgumentKind::File;
        case Command::Show:
            return ArgumentKind::Window;
        case Command::Settings:
            return ArgumentKind::Setting;
        case Command::Completion:
            return ArgumentKind::Shell;
        default:
            return ArgumentKind::Nothing;
    }
}

Words settingNames() {
    Words names;
    for (const KnownSetting& setting : knownSettings()) names.emplace_back(setting.name);
    return names;
}

// What the arguments of a kind can be; nothing when that depends.
Words choicesOf(ArgumentKind kind) {
    if (kind == ArgumentKind::Window) return shownWindows();
    if (kind == ArgumentKind::Setting) return settingNames();
    if (kind == ArgumentKind::Shell) return {"bash", "zsh", "fish"};
    return {};
}

std::string joined(const Words& words, std::string_view between) {
    std::string all;
    for (const std::string& word : words) {
        if (!all.empty()) all += between;
        all += word;
    }
    return all;
}

Words namesOf(const std::vector<CommandOutline>& commands, ArgumentKind kind) {
    Words names;
    for (const CommandOutline& command : commands) {
        if (argumentOf(command.command) == kind) names.push_back(command.name);
    }
    return names;
}

std::string filledIn(std::string script, std::string_view place, const std::string& text) {
    for (std::size_t at = script.find(place); at != std::string::npos; at = script.find(place, at + text.size())) {
        script.replace(at, place.size(), text);
    }
    return script;
}

// ---- bash ----

// Bash cuts a word at colons and the like, and replaces only what stands behind; the line is read here as the shell
// does, and the candidates are given as far as they will be put in.
constexpr const char* BashScript =
    R"SCRIPT(# What completes the command line of plume in bash: source <(plume completion bash)
_plume() {
    local line=${COMP_LINE:0:COMP_POINT} quote='' plain='' raw='' i c
    local -a words=()
    COMPREPLY=()
    for ((i = 0; i < ${#line}; i++)); do
        c=${line:i:1}
        if [[ -z $quote && $c == [[:space:]] ]]; then
            [[ -n $raw ]] && words+=("$plain")
            plain='' raw=''
            continue
        fi
        raw+=$c
        if [[ $quote == "$c" && -n $quote ]]; then
            quote=''
        elif [[ -z $quote && ( $c == "'" || $c == '"' ) ]]; then
            quote=$c
        elif [[ $c == \\ && $quote != "'" ]]; then
            ((i++))
            raw+=${line:i:1}
            [[ $quote == '"' && ${line:i:1} != [\"\\\$\`] ]] && plain+=$c
            plain+=${line:i:1}
        else
            plain+=$c
        fi
    done
    if ((${#words[@]} < 2)); then
        COMPREPLY=($(compgen -W "@COMMANDS@ --help --version" -- "$plain"))
        return
    fi
    case ${words[-1]} in
        --library | --settings) compopt -o default 2>/dev/null; return ;;
        --placeholders) COMPREPLY=($(compgen -W textexpander -- "$plain")); return ;;
        --group | --label | --case) return ;;
    esac
    if [[ $plain == --* ]]; then
        local options=
        case ${words[1]} in
@OPTIONS@
        esac
        COMPREPLY=($(compgen -W "$options" -- "$plain"))
        return
    fi
    case ${words[1]} in
@CHOICES@
        @FILES@) compopt -o default 2>/dev/null ;;
        @ABBREVIATIONS@) _plume_abbreviations "$plain" "$raw" "$quote" "$2" ;;
    esac
}
_plume_abbreviations() {
    local plain=$1 raw=$2 quote=$3 replaced=$4 kept='' each rest
    if [[ -z $quote && $raw == *"$replaced" ]]; then
        IFS= read kept <<< "${raw%"$replaced"}"
    fi
    while IFS= read -r each; do
        [[ $each == "$plain"* ]] || continue
        rest=${each#"$kept"}
        case $quote in
            "'") rest=${rest//"'"/"'\\''"} ;;
            '"') rest=${rest//\\/\\\\} rest=${rest//\"/\\\"} rest=${rest//\$/\\\$} rest=${rest//\`/\\\`} ;;
            *) printf -v rest %q "$rest" ;;
        esac
        COMPREPLY+=("$rest")
    done < <("${COMP_WORDS[0]}" list --abbreviations 2>/dev/null)
}
complete -F _plume plume
)SCRIPT";

std::string bashScript(const std::vector<CommandOutline>& commands) {
    Words names;
    std::string options;
    std::string choices;
    for (const CommandOutline& command : commands) {
        names.push_back(command.name);
        if (!command.options.empty()) {
            options += "            " + command.name + ") options='" + joined(command.options, " ") + "' ;;\n";
        }
        const Words words = choicesOf(argumentOf(command.command));
        if (words.empty()) continue;
        choices +=
            "        " + command.name + ") COMPREPLY=($(compgen -W '" + joined(words, " ") + "' -- \"$plain\")) ;;\n";
    }
    options.pop_back();
    choices.pop_back();
    std::string script = filledIn(BashScript, "@COMMANDS@", joined(names, " "));
    script = filledIn(std::move(script), "@OPTIONS@", options);
    script = filledIn(std::move(script), "@CHOICES@", choices);
    script = filledIn(std::move(script), "@FILES@", joined(namesOf(commands, ArgumentKind::File), " | "));
    return filledIn(std::move(script), "@ABBREVIATIONS@", joined(namesOf(commands, ArgumentKind::Abbreviation), " | "));
}

// ---- zsh ----

constexpr const char* ZshScript = R"SCRIPT(#compdef plume
# What completes the command line of plume in zsh: plume completion zsh > a folder of $fpath/_plume
_plume() {
    local -a commands found
    commands=(
@COMMANDS@
    )
    if ((CURRENT == 2)); then
        _describe command commands
        return
    fi
    case $words[CURRENT-1] in
        --library | --settings) _files; return ;;
        --placeholders) compadd textexpander; return ;;
        --group | --label | --case) return ;;
    esac
    if [[ $PREFIX == --* ]]; then
        case $words[2] in
@OPTIONS@
        esac
        return
    fi
    case $words[2] in
@CHOICES@
        @FILES@) _files ;;
        @ABBREVIATIONS@)
            found=("${(@f)$($words[1] list --abbreviations 2>/dev/null)}")
            compadd -- "${found[@]}" ;;
    esac
}
if [[ $funcstack[1] == _plume ]]; then _plume "$@"; else compdef _plume plume; fi
)SCRIPT";

// In single quotes, for _describe, which takes a colon for the end of the name.
std::string zshDescription(const CommandOutline& command) {
    return "        '" + command.name + ":" + filledIn(filledIn(command.purpose, ":", "\\:"), "'", "'\\''") + "'\n";
}

std::string zshScript(const std::vector<CommandOutline>& commands) {
    std::string described;
    std::string options;
    std::string choices;
    for (const CommandOutline& command : commands) {
        described += zshDescription(command);
        if (!command.options.empty()) {
            options += "            " + command.name + ") compadd -- " + joined(command.options, " ") + " ;;\n";
        }
        const Words words = choicesOf(argumentOf(command.command));
        if (!words.empty()) choices += "        " + command.name + ") compadd -- " + joined(words, " ") + " ;;\n";
    }
    described.pop_back();
    options.pop_back();
    choices.pop_back();
    std::string script = filledIn(ZshScript, "@COMMANDS@", described);
    script = filledIn(std::move(script), "@OPTIONS@", options);
    script = filledIn(std::move(script), "@CHOICES@", choices);
    script = filledIn(std::move(script), "@FILES@", joined(namesOf(commands, ArgumentKind::File), " | "));
    return filledIn(std::move(script), "@ABBREVIATIONS@", joined(namesOf(commands, ArgumentKind::Abbreviation), " | "));
}

// ---- fish ----

std::string fishQuoted(const std::string& text) {
    return "'" + filledIn(filledIn(text, "\\", "\\\\"), "'", "\\'") + "'";
}

std::string fishRule(const std::string& condition, const std::string& rest) {
    return "complete -c plume -n " + fishQuoted(condition) + " " + rest + "\n";
}

bool takesFile(const std::string& option) {
    return option == "--library" || option == "--settings";
}

bool takesText(const std::string& option) {
    return option == "--group" || option == "--label" || option == "--case" || option == "--placeholders";
}

std::string fishRulesFor(const CommandOutline& command) {
    const std::string condition = "__fish_seen_subcommand_from " + command.name;
    std::string rules = fishRule("__fish_use_subcommand", "-a " + command.name + " -d " + fishQuoted(command.purpose));
    for (const std::string& option : command.options) {
        const char* const value = takesFile(option) ? " -r -F" : takesText(option) ? " -x" : "";
        rules += fishRule(condition, "-l " + option.substr(2) + value);
    }
    const ArgumentKind kind = argumentOf(command.command);
    const Words choices = choicesOf(kind);
    if (!choices.empty()) rules += fishRule(condition, "-a " + fishQuoted(joined(choices, " ")));
    if (kind == ArgumentKind::File) rules += fishRule(condition, "-F");
    if (kind == ArgumentKind::Abbreviation)
        rules += fishRule(condition, "-a '(plume list --abbreviations 2>/dev/null)'");
    return rules;
}

std::string fishScript(const std::vector<CommandOutline>& commands) {
    std::string script =
        "# What completes the command line of plume in fish: plume completion fish | source\n"
        "complete -c plume -f\n";
    for (const CommandOutline& command : commands) script += fishRulesFor(command);
    return script;
}

}  // namespace

std::string completionScript(const std::string& shell) {
    const std::vector<CommandOutline> commands = commandOutlines();
    if (shell == "zsh") return zshScript(commands);
    return shell == "fish" ? fishScript(commands) : bashScript(commands);
}

}  // namespace plume

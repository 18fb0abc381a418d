#include "testing/real/RealProgram.h"

namespace plume::real {

namespace {

// An interactive shell, in which Return adds the line to a file, with a mark behind it.
constexpr const char* Start = R"(
record() { printf '%s\0' "$READLINE_LINE" >> "{}/text"; READLINE_LINE=; READLINE_POINT=0; }
bind -x '"\C-m": record'
bind 'set enable-bracketed-paste on'
PS1='> '
)";

RealProgram terminal(const std::string& name, const std::string& package, const std::string& windowClass,
                     std::vector<std::string> command) {
    command.insert(command.end(), {"bash", "--rcfile", "{}/start"});
    return {name,
            package,
            windowClass,
            std::move(command),
            {{.reading = Reading::Lines, .offers = {Needs::Lines}}},
            {{"start", Start}, {"text", ""}}};
}

// It would ask in a window, and wait there, whether several lines are to be pasted.
RealProgram trustingPastes(RealProgram program) {
    program.environment = {"XDG_CONFIG_HOME={}/config"};
    program.files.emplace("config/xfce4/terminal/terminalrc", "[Configuration]\nMiscShowUnsafePasteDialog=FALSE\n");
    return program;
}

}  // namespace

std::vector<RealProgram> terminals() {
    return {
        terminal("gnome-terminal", "gnome-terminal", "erminal", {"gnome-terminal", "--wait", "--"}),
        terminal("konsole", "konsole", "konsole", {"konsole", "--separate", "-e"}),
        trustingPastes(
            terminal("xfce4-terminal", "xfce4-terminal", "fce4", {"xfce4-terminal", "--disable-server", "-x"})),
        terminal("qterminal", "qterminal", "qterminal", {"qterminal", "-e"}),
        terminal("xterm", "xterm", "XTerm", {"xterm", "-e"}),
    };
}

}  // namespace plume::real

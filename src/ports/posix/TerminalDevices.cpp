#include "ports/posix/TerminalDevices.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <sys/sysmacros.h>
#include <termios.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <charconv>
#include <filesystem>
#include <map>
#include <set>
#include <sstream>
#include <string_view>
#include <system_error>

#include "ports/posix/FileDescriptor.h"

namespace plume {

namespace {

struct Process {
    std::string name;  // cut off after 15 characters
    pid_t parent = 0;
    unsigned terminal = 0;  // as a device number; 0 without one
};
using Processes = std::map<pid_t, Process>;

// "12 (name) S 1 12 12 34817 …"; the name may hold anything.
Process processIn(const std::string& stat) {
    const auto nameBegin = stat.find('(');
    const auto nameEnd = stat.rfind(')');
    if (nameBegin == std::string::npos || nameEnd == std::string::npos) return {};
    Process process{stat.substr(nameBegin + 1, nameEnd - nameBegin - 1)};
    std::istringstream values(stat.substr(nameEnd + 1));
    char state = 0;
    pid_t group = 0;
    pid_t session = 0;
    int terminal = 0;
    values >> state >> process.parent >> group >> session >> terminal;
    process.terminal = static_cast<unsigned>(terminal);
    return process;
}

std::string statOf(const std::string& folder) {
    const FileDescriptor file(open((folder + "/stat").c_str(), O_RDONLY | O_CLOEXEC));
    std::array<char, 512> text{};
    const ssize_t size = file.get() < 0 ? 0 : read(file.get(), text.data(), text.size());
    return {text.data(), static_cast<std::size_t>(std::max<ssize_t>(size, 0))};
}

Processes allProcesses() {
    Processes processes;
    std::error_code problem;
    for (const auto& entry : std::filesystem::directory_iterator("/proc", problem)) {
        const std::string name = entry.path().filename();
        pid_t number = 0;
        std::from_chars(name.data(), name.data() + name.size(), number);
        if (number > 0) processes[number] = processIn(statOf(entry.path()));
    }
    return processes;
}

bool isBelow(const Processes& processes, pid_t process, pid_t ancestor) {
    constexpr int Deepest = 100;
    for (int depth = 0; depth < Deepest; ++depth) {
        const auto found = processes.find(process);
        if (found == processes.end()) return false;
        process = found->second.parent;
        if (process == ancestor) return true;
    }
    return false;
}

// Their servers, in which the programs run, are no children of the terminal.
constexpr std::string_view MultiplexerClients[] = {"tmux: client", "screen"};
constexpr std::string_view MultiplexerServers[] = {"tmux: server", "SCREEN"};

bool isOneOf(std::string_view name, const auto& names) {
    return std::ranges::find(names, name) != std::end(names);
}

// It talks to programs through terminals of its own that never show what is sent there.
bool hidesAlways(std::string_view name) {
    return name.starts_with("emacs");
}

void collect(const Processes& processes, pid_t ancestor, std::set<unsigned>& terminals, bool& multiplexed) {
    for (const auto& [number, process] : processes) {
        if (process.terminal == 0 || !isBelow(processes, number, ancestor)) continue;
        terminals.insert(process.terminal);
        multiplexed = multiplexed || isOneOf(process.name, MultiplexerClients);
    }
}

}  // namespace

std::vector<std::string> terminalDevicesBelow(pid_t process) {
    const Processes processes = allProcesses();
    const auto itself = processes.find(process);
    if (itself == processes.end() || hidesAlways(itself->second.name)) return {};
    std::set<unsigned> terminals;
    bool multiplexed = false;
    collect(processes, process, terminals, multiplexed);
    terminals.erase(itself->second.terminal);
    for (const auto& [number, server] : processes) {
        if (multiplexed && isOneOf(server.name, MultiplexerServers)) collect(processes, number, terminals, multiplexed);
    }
    std::vector<std::string> devices;
    constexpr unsigned PseudoTerminals = 136;
    for (const unsigned terminal : terminals) {
        if (major(terminal) == PseudoTerminals) devices.push_back("/dev/pts/" + std::to_string(minor(terminal)));
    }
    return devices;
}

bool hidesInput(const std::string& device) {
    const FileDescriptor terminal(open(device.c_str(), O_RDONLY | O_NOCTTY | O_NONBLOCK | O_CLOEXEC));
    struct stat status {};
    termios modes{};
    if (terminal.get() < 0 || fstat(terminal.get(), &status) != 0 || status.st_uid != geteuid()) return false;
    if (tcgetattr(terminal.get(), &modes) != 0) return false;
    return (modes.c_lflag & ICANON) != 0 && (modes.c_lflag & ECHO) == 0;
}

}  // namespace plume

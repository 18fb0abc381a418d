#include "ports/x11/windows/KeyTools.h"

#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <charconv>
#include <filesystem>
#include <fstream>
#include <string>
#include <string_view>
#include <system_error>

#include "Foundation/Strings.h"

namespace plume {

namespace {

constexpr std::size_t MostTools = 10;
constexpr std::string_view Names[] = {"autokey-gtk", "autokey-headless", "autokey-qt", "espanso"};

// Of one of the user's processes; empty for anything else in that folder.
std::string nameOf(const std::filesystem::path& process) {
    struct stat status {};
    std::string name;
    if (stat(process.c_str(), &status) != 0 || status.st_uid != getuid()) return name;
    std::ifstream file(process / "comm");
    std::getline(file, name);
    return name;
}

RunningApplication describe(const std::filesystem::path& process, const std::string& name) {
    RunningApplication application;
    const std::string number = process.filename();
    std::from_chars(number.data(), number.data() + number.size(), application.processIdentifier);
    application.localizedName = fromUtf8(name);
    std::error_code error;
    const auto program = std::filesystem::read_symlink(process / "exe", error);
    if (!error) application.executableURL = fromUtf8(program.string());
    return application;
}

}  // namespace

std::vector<RunningApplication> runningKeyTools() {
    std::vector<RunningApplication> tools;
    std::error_code error;
    for (const auto& process : std::filesystem::directory_iterator("/proc", error)) {
        // The system cuts names off.
        const std::string name = nameOf(process.path());
        const bool known = std::ranges::any_of(
            Names, [&](std::string_view tool) { return !name.empty() && tool.substr(0, 15) == name; });
        if (known && tools.size() < MostTools) tools.push_back(describe(process.path(), name));
    }
    return tools;
}

}  // namespace plume

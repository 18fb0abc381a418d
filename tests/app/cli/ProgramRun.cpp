#include "tests/app/cli/ProgramRun.h"

#include <array>
#include <chrono>
#include <cstdlib>
#include <fstream>
#include <stdexcept>

#include "ports/posix/PosixProcessLauncher.h"

namespace plume {

ProgramHome::ProgramHome() {
    std::string name = (std::filesystem::temp_directory_path() / "plume-home-XXXXXX").string();
    if (mkdtemp(name.data()) == nullptr) throw std::runtime_error("no temporary folder");
    folder_ = name;
    set("HOME", name);
    set("XDG_CONFIG_HOME", name + "/config");
    set("XDG_RUNTIME_DIR", name);
    set("TMPDIR", name);
    set("LANG", "C.UTF-8");
    for (const char* variable :
         {"DISPLAY", "WAYLAND_DISPLAY", "DBUS_SESSION_BUS_ADDRESS", "LC_ALL", "LC_TIME", "LC_NUMERIC"}) {
        set(variable, std::nullopt);
    }
}

ProgramHome::~ProgramHome() {
    for (const auto& [name, value] : before_) put(name, value);
    std::filesystem::remove_all(folder_);
}

void ProgramHome::put(const std::string& name, const std::optional<std::string>& value) {
    if (value) {
        setenv(name.c_str(), value->c_str(), 1);
    } else {
        unsetenv(name.c_str());
    }
}

void ProgramHome::set(const std::string& name, const std::optional<std::string>& value) {
    const char* const before = std::getenv(name.c_str());
    before_.emplace(name, before ? std::optional<std::string>(before) : std::nullopt);
    put(name, value);
}

std::string ProgramHome::program() {
    return (std::filesystem::read_symlink("/proc/self/exe").parent_path() / "plume").string();
}

ProgramResult ProgramHome::run(const std::vector<std::string>& arguments) const {
    return runOther(program(), arguments);
}

ProgramResult ProgramHome::runOther(const std::string& program, const std::vector<std::string>& arguments) const {
    PosixProcessLauncher launcher;
    ProcessRequest request;
    request.program = program;
    request.arguments = arguments;
    const auto started = launcher.start(request);
    if (!started) throw std::runtime_error(started.error().message);
    RunningProcess& process = *started.value();

    ProgramResult result;
    const Moment deadline = std::chrono::steady_clock::now() + std::chrono::seconds(20);
    const std::array<ProcessStream*, 2> streams = {&process.output(), &process.error()};
    const auto readAll = [&] {
        while (process.output().read(result.output) || process.error().read(result.error)) continue;
    };
    while (!process.exitStatus() && std::chrono::steady_clock::now() < deadline) {
        process.wait(streams, deadline);
        readAll();
    }
    readAll();
    result.status = process.exitStatus().value_or(-1);
    return result;
}

std::string ProgramHome::write(const std::string& name, const std::string& content) const {
    const std::filesystem::path path = folder_ / name;
    std::filesystem::create_directories(path.parent_path());
    std::ofstream(path, std::ios::binary) << content;
    return path.string();
}

}  // namespace plume

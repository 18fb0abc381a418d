#include "app/cli/Session.h"

#include <sys/signalfd.h>

#include <csignal>
#include <sstream>

#include "app/cli/Files.h"
#include "app/linux/LinuxApplications.h"

namespace plume {

FileDescriptor endSignals() {
    sigset_t signals;
    sigemptyset(&signals);
    for (const int number : {SIGINT, SIGTERM, SIGHUP}) sigaddset(&signals, number);
    pthread_sigmask(SIG_BLOCK, &signals, nullptr);
    // A program that went away while it was written to is no reason to end.
    (void)std::signal(SIGPIPE, SIG_IGN);
    return FileDescriptor(signalfd(-1, &signals, SFD_CLOEXEC | SFD_NONBLOCK));
}

std::shared_ptr<const ApplicationTable> installedApplications(Voice& voice) {
    const auto file = dataFolder() / "applications.json";
    const LinuxApplications read = readLinuxApplications(readWholeFile(file), file.string());
    if (read.problem) {
        voice.say(read.problem->message);
        voice.say("In place of that file, the table of applications counts that Plume was built with.");
    }
    return read.table;
}

std::string systemVersion() {
    const auto text = readWholeFile("/etc/os-release");
    std::istringstream lines(text ? text.value() : std::string());
    constexpr std::string_view Key = "PRETTY_NAME=";
    for (std::string line; std::getline(lines, line);) {
        if (!line.starts_with(Key)) continue;
        std::string name = line.substr(Key.size());
        std::erase(name, '"');
        return name;
    }
    return "Linux";
}

}  // namespace plume

// The program: reads the command line and does what it says.
#include <exception>
#include <filesystem>
#include <iostream>
#include <optional>
#include <system_error>
#include <variant>

#include "app/cli/Application.h"
#include "app/cli/ApplicationCommands.h"
#include "app/cli/CommandLine.h"
#include "app/cli/Completion.h"
#include "app/cli/Doctor.h"
#include "app/cli/EditCommand.h"
#include "app/cli/Files.h"
#include "app/cli/InstanceLock.h"
#include "app/cli/LibraryChoice.h"
#include "app/cli/LibraryCommands.h"
#include "app/cli/RunCommand.h"
#include "app/cli/SearchCommand.h"
#include "app/cli/SettingsCommand.h"
#include "app/cli/SimulateCommand.h"
#include "app/cli/StoreCommands.h"
#include "app/session/CommandSocket.h"

namespace {

using plume::Command;
using plume::CommandLine;
using plume::ExitStatus::Failure;
using plume::ExitStatus::Success;
using plume::ExitStatus::WrongInput;

int withLibrary(const CommandLine& line) {
    const auto report = [](const std::string& sentence) { std::cerr << "plume: " << sentence << '\n'; };
    const auto library = plume::openLibrary(line.library, report);
    if (!library) {
        report(library.error().message);
        return WrongInput;
    }
    switch (line.command) {
        case Command::List:
            return listSnippets(library.value(), line.onlyAbbreviations, std::cout);
        case Command::Search:
            return searchSnippets(library.value(), line.text, line.json, std::cout, std::cerr);
        default:
            return expandSnippet(library.value(), line.text, std::cout, std::cerr);
    }
}

// What the Plume that runs has done with the command; nothing when none runs that could.
std::optional<int> byRunningPlume(int argc, const char* const* argv) {
    const auto socket = plume::InstanceLock::socketPathFor({});
    if (!socket) return std::nullopt;
    std::error_code ignored;
    const auto reply =
        plume::handOver(socket.value(), {std::filesystem::current_path(ignored), {argv + 1, argv + argc}});
    if (!reply) {
        std::cerr << "plume: " << reply.error().message << '\n';
        return Failure;
    }
    if (!reply.value()) return std::nullopt;
    std::cout << reply.value()->output;
    std::cerr << reply.value()->error;
    return reply.value()->status;
}

int run(int argc, char** argv) {
    const auto parsed = plume::parseCommandLine(argc, argv);
    if (const auto* farewell = std::get_if<plume::Farewell>(&parsed)) {
        std::cout << farewell->output;
        std::cerr << farewell->error;
        return farewell->status;
    }
    const auto& line = std::get<CommandLine>(parsed);
    if (line.command == Command::Application || plume::isForRunningPlume(line.command)) {
        if (const auto status = byRunningPlume(argc, argv)) return *status;
    }
    if (plume::needsRunningPlume(line.command)) {
        std::cerr << "plume: Plume is not running with its windows here; \"plume\" starts it.\n";
        return Failure;
    }
    if (plume::isStoreCommand(line.command)) return plume::performOnUsersLibrary(line, std::cout, std::cerr);
    switch (line.command) {
        case Command::Application:
            return plume::runApplication(argc, argv, std::cerr);
        case Command::Run:
            return plume::runInSession(line.library, line.settings, std::cout, std::cerr);
        case Command::List:
        case Command::Search:
        case Command::Expand:
            return withLibrary(line);
        case Command::Edit:
            return plume::editLibrary(std::cin, std::cout, std::cerr);
        case Command::Convert:
            return plume::convertFile(line, std::cout, std::cerr);
        case Command::Settings:
            return plume::runSettingsCommand(line.request, plume::configurationFolder(), std::cout, std::cerr);
        case Command::Completion:
            std::cout << plume::completionScript(line.text);
            return Success;
        case Command::Doctor:
            return plume::examineDesktop(std::cout);
        case Command::Simulate:
            return plume::simulateFiles(line.files, line.onlyCase, std::cout, std::cerr);
        default:
            return Failure;
    }
}

}  // namespace

int main(int argc, char** argv) {
    try {
        return run(argc, argv);
    } catch (const std::exception& problem) {
        std::cerr << "plume: " << problem.what() << '\n';
        return Failure;
    }
}

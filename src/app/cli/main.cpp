// The program: reads the command line and does what it says.
#include <exception>
#include <iostream>
#include <variant>

#include "app/cli/CommandLine.h"
#include "app/cli/Doctor.h"
#include "app/cli/Files.h"
#include "app/cli/LibraryChoice.h"
#include "app/cli/LibraryCommands.h"
#include "app/cli/RunCommand.h"
#include "app/cli/SettingsCommand.h"
#include "app/cli/SimulateCommand.h"

namespace {

using plume::Command;
using plume::CommandLine;
using plume::ExitStatus::Failure;
using plume::ExitStatus::WrongInput;

int withLibrary(const CommandLine& line) {
    const auto library = plume::openLibrary(line.library);
    if (!library) {
        std::cerr << "plume: " << library.error().message << '\n';
        return WrongInput;
    }
    switch (line.command) {
        case Command::List:
            return listSnippets(library.value(), std::cout);
        case Command::Search:
            return searchSnippets(library.value(), line.text, std::cout, std::cerr);
        case Command::Expand:
            return expandSnippet(library.value(), line.text, std::cout, std::cerr);
        default:
            return runInSession(library.value(), line.settings, std::cout, std::cerr);
    }
}

int run(int argc, const char* const* argv) {
    const auto parsed = plume::parseCommandLine(argc, argv);
    if (const auto* farewell = std::get_if<plume::Farewell>(&parsed)) {
        std::cout << farewell->output;
        std::cerr << farewell->error;
        return farewell->status;
    }
    const auto& line = std::get<CommandLine>(parsed);
    if (line.command == Command::Doctor) return plume::examineDesktop(std::cout);
    if (line.command == Command::Settings) {
        return plume::runSettingsCommand(line.request, plume::configurationFolder(), std::cout, std::cerr);
    }
    if (line.command == Command::Simulate) {
        return plume::simulateFiles(line.files, line.onlyCase, std::cout, std::cerr);
    }
    return withLibrary(line);
}

}  // namespace

int main(int argc, const char* const* argv) {
    try {
        return run(argc, argv);
    } catch (const std::exception& problem) {
        std::cerr << "plume: " << problem.what() << '\n';
        return Failure;
    }
}

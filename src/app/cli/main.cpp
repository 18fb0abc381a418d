// The program: reads the command line and does what it says.
#include <exception>
#include <iostream>
#include <variant>

#include "app/cli/CommandLine.h"
#include "app/cli/Doctor.h"
#include "app/cli/EditCommand.h"
#include "app/cli/Files.h"
#include "app/cli/LibraryChoice.h"
#include "app/cli/LibraryCommands.h"
#include "app/cli/RunCommand.h"
#include "app/cli/SettingsCommand.h"
#include "app/cli/SimulateCommand.h"
#include "app/cli/StoreCommands.h"

namespace {

using plume::Command;
using plume::CommandLine;
using plume::ExitStatus::Failure;
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
            return listSnippets(library.value(), std::cout);
        case Command::Search:
            return searchSnippets(library.value(), line.text, std::cout, std::cerr);
        default:
            return expandSnippet(library.value(), line.text, std::cout, std::cerr);
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
    switch (line.command) {
        case Command::Run:
            return plume::runInSession(line.library, line.settings, std::cout, std::cerr);
        case Command::List:
        case Command::Search:
        case Command::Expand:
            return withLibrary(line);
        case Command::Add:
            return plume::addSnippet(line, std::cout, std::cerr);
        case Command::Remove:
            return plume::removeSnippet(line, std::cout, std::cerr);
        case Command::Edit:
            return plume::editLibrary(std::cin, std::cout, std::cerr);
        case Command::Import:
            return plume::importFiles(line, std::cout, std::cerr);
        case Command::Export:
            return plume::exportLibrary(line, std::cout, std::cerr);
        case Command::Convert:
            return plume::convertFile(line, std::cout, std::cerr);
        case Command::Backup:
            return plume::makeBackup(std::cout, std::cerr);
        case Command::Backups:
            return plume::listBackups(std::cout, std::cerr);
        case Command::Restore:
            return plume::restoreBackup(line, std::cout, std::cerr);
        case Command::Settings:
            return plume::runSettingsCommand(line.request, plume::configurationFolder(), std::cout, std::cerr);
        case Command::Doctor:
            return plume::examineDesktop(std::cout);
        case Command::Simulate:
            return plume::simulateFiles(line.files, line.onlyCase, std::cout, std::cerr);
    }
    return Failure;
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

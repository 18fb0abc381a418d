// The commands that change the user's library, or bring it into other files and back.
#pragma once

#include <filesystem>
#include <iosfwd>

#include "app/cli/CommandLine.h"
#include "library/DataManager.h"
#include "platform/Files.h"

namespace plume {

// What a command works on. All of it outlives the command.
struct StoreCommandContext {
    DataManager& manager;
    Files& files;
    std::filesystem::path folder;  // what relative paths start from
    std::ostream& output;          // what was done
    std::ostream& error;           // what went wrong
};

// Whether performOnLibrary() knows the command.
bool isStoreCommand(Command command);
// On the thread of the library's owner. Returns the exit status.
int performOnLibrary(const CommandLine& line, const StoreCommandContext& context);
// The same on the user's library, opened for this.
int performOnUsersLibrary(const CommandLine& line, std::ostream& output, std::ostream& error);
// Works on files alone.
int convertFile(const CommandLine& line, std::ostream& output, std::ostream& error);

}  // namespace plume

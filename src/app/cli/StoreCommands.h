// The commands that change the user's library, or bring it into other files and back.
#pragma once

#include <iosfwd>

#include "app/cli/CommandLine.h"

namespace plume {

// Each writes what it did to `output`, what went wrong to `error`, and returns the exit status.
int addSnippet(const CommandLine& line, std::ostream& output, std::ostream& error);
int removeSnippet(const CommandLine& line, std::ostream& output, std::ostream& error);
int importFiles(const CommandLine& line, std::ostream& output, std::ostream& error);
int exportLibrary(const CommandLine& line, std::ostream& output, std::ostream& error);
int makeBackup(std::ostream& output, std::ostream& error);
int listBackups(std::ostream& output, std::ostream& error);
int restoreBackup(const CommandLine& line, std::ostream& output, std::ostream& error);
// Works on files alone.
int convertFile(const CommandLine& line, std::ostream& output, std::ostream& error);

}  // namespace plume

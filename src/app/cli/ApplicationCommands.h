// What the running Plume does for a `plume` on the command line, and for those who call it over the session bus.
//
// On the main thread; all that is referred to outlives it.
#pragma once

#include "app/AppDelegate.h"
#include "app/cli/CommandLine.h"
#include "app/session/CommandSocket.h"
#include "platform/Files.h"

namespace plume {

// Whether the Plume that runs does this command, where there is one.
bool isForRunningPlume(Command command);
// Whether nobody else can do it.
bool needsRunningPlume(Command command);

class ApplicationCommands {
  public:
    ApplicationCommands(AppDelegate& delegate, DataManager& manager, Files& files)
        : delegate_(delegate), manager_(manager), files_(files) {}

    // The arguments are those of a command line. What cannot be done here is refused with the reason.
    CommandReply perform(const CommandRequest& request);

  private:
    CommandReply performHere(const CommandLine& line, const CommandRequest& request);
    CommandReply show(const std::string& window);
    CommandReply open(const CommandLine& line, const std::filesystem::path& folder);
    CommandReply status(bool asJson) const;

    AppDelegate& delegate_;
    DataManager& manager_;
    Files& files_;
};

}  // namespace plume

// How a `plume` on the command line reaches the Plume that runs: a socket that only this user can open.
//
// The one that runs owns a CommandSocket, on its main thread. A request is a list of texts, the reply a status and two
// texts; requests over a mebibyte, and those that do not come within a second, are dropped.
#pragma once

#include <filesystem>
#include <functional>
#include <list>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "Foundation/Result.h"
#include "ports/posix/DescriptorLoop.h"
#include "ports/posix/FileDescriptor.h"

namespace plume {

struct CommandRequest {
    std::filesystem::path folder;  // in which the command was given
    std::vector<std::string> arguments;
};

struct CommandReply {
    int status = 0;
    std::string output;
    std::string error;
};

class CommandSocket {
  public:
    using Perform = std::function<CommandReply(const CommandRequest&)>;

    // In place of a socket that a Plume before left behind: whoever calls this holds the lock of the display.
    static Result<std::unique_ptr<CommandSocket>> open(const std::filesystem::path& path, DescriptorLoop& loop,
                                                       Perform perform);
    ~CommandSocket();
    CommandSocket(const CommandSocket&) = delete;
    CommandSocket& operator=(const CommandSocket&) = delete;

  private:
    struct Visit {
        FileDescriptor socket;
        std::string received;
        Subscription source;
        Timer patience;
    };

    CommandSocket(std::filesystem::path path, FileDescriptor socket, DescriptorLoop& loop, Perform perform);
    void acceptAll();
    void hear(Visit& visit);
    void answer(Visit& visit);
    void drop(const Visit& visit);

    const std::filesystem::path path_;
    FileDescriptor socket_;
    DescriptorLoop& loop_;
    const Perform perform_;
    std::list<Visit> visits_;
    Subscription source_;
};

// Has the Plume at this socket perform the request. Nothing when there is none; an error when it does not answer within
// ten seconds.
Result<std::optional<CommandReply>> handOver(const std::filesystem::path& socket, const CommandRequest& request);

}  // namespace plume

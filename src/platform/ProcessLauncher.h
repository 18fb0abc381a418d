// Programs that Plume starts and reads from, and the private files and streams that it hands to them.
//
// Nothing here waits without a bound that the caller sets, and nothing raises a signal in Plume. The launcher may be
// used from any thread; a process, a stream or a file by one thread at a time. They outlive the launcher without harm.
#pragma once

#include <chrono>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/Result.h"

namespace plume {

using Moment = std::chrono::steady_clock::time_point;

// Bytes that programs write and Plume reads.
class ProcessStream {
  public:
    virtual ~ProcessStream() = default;
    // Appends some of what has arrived, at most MaximumRead bytes, and never waits. False when there was nothing.
    virtual bool read(std::string& bytes) = 0;

    static constexpr std::size_t MaximumRead = std::size_t{64} * 1024;
};

// A stream that programs open for writing by its path. Nobody else can open it, and the path is gone with it.
class NamedStream : public ProcessStream {
  public:
    virtual const std::string& path() const = 0;
};

// A file that nobody else can read, removed with this object.
class TemporaryFile {
  public:
    virtual ~TemporaryFile() = default;
    virtual const std::string& path() const = 0;
};

struct ProcessRequest {
    std::string program;                 // a path: it is not looked for
    std::vector<std::string> arguments;  // without the program's own name
    bool takesInput = false;             // otherwise its standard input is empty
};

// A started program, in a process group of its own with what it starts. Destroying it ends the group when the program
// still runs; what outlived a program that ended by itself is left alone.
class RunningProcess {
  public:
    virtual ~RunningProcess() = default;

    // Only when the request said takesInput. False when not everything could be written by the deadline.
    virtual bool write(std::string_view bytes, Moment deadline) = 0;
    virtual void closeInput() = 0;
    virtual ProcessStream& output() = 0;
    virtual ProcessStream& error() = 0;

    // Waits until one of the streams (of this launcher) has bytes or lost its last writer, the program has ended, or
    // the deadline has passed; may also return early.
    virtual void wait(std::span<ProcessStream* const> streams, Moment deadline) = 0;

    // Nothing while the program runs; 128 and the signal's number when a signal ended it.
    virtual std::optional<int> exitStatus() = 0;
    // Ends the program, if it still runs, and everything in its group.
    virtual void endGroup() = 0;
};

class ProcessLauncher {
  public:
    virtual ~ProcessLauncher() = default;
    // Starts the program with Plume's environment and working directory.
    virtual Result<std::unique_ptr<RunningProcess>> start(const ProcessRequest& request) = 0;
    // A file in the system's temporary directory, or in a private one inside it, whose name starts with `prefix`.
    virtual Result<std::unique_ptr<TemporaryFile>> makeTemporaryFile(std::string_view prefix, std::string_view bytes,
                                                                     bool executable) = 0;
    virtual Result<std::unique_ptr<NamedStream>> makeNamedStream() = 0;
};

}  // namespace plume

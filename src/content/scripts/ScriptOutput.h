// What a script has written, and how long it may go on.
//
// Used on the thread that runs the script.
#pragma once

#include <atomic>
#include <cstddef>
#include <optional>
#include <string>

#include "Foundation/Result.h"
#include "platform/ProcessLauncher.h"

namespace plume {

// Beyond these a script is ended.
struct ScriptLimits {
    double time = 30;                             // seconds
    std::size_t output = std::size_t{16} << 20U;  // bytes on either stream
};

enum class ScriptEnd { Finished, TimeLimit, OutputLimit, Stopped, NotStarted };

struct ScriptOutput {
    std::string output;
    std::string error;
    ScriptEnd end = ScriptEnd::Finished;
    bool failed = false;  // it finished, and said itself that it did not succeed
    std::string problem;  // why it was not started

    static ScriptOutput notStarted(const Error& reason);

    // Takes what has arrived by now.
    void read(ProcessStream& outputStream, ProcessStream& errorStream);
    // Takes what was left in the streams by a script that has ended. Children of it that go on writing are not
    // followed.
    void readRest(ProcessStream& outputStream, ProcessStream& errorStream);

    // Standard output, or standard error when that is empty, without one trailing line feed. Nothing when both are
    // empty, and when the bytes are not UTF-8.
    std::optional<std::u16string> text() const;
    // What is delivered of it: the text of a script that has finished, or that its time ran out for.
    std::optional<std::u16string> delivered() const;
};

// Watches over one script from its start.
class ScriptWatch {
  public:
    // `stopped` may be set by another thread to end the script early.
    ScriptWatch(const ScriptLimits& limits, const std::atomic<bool>& stopped);

    // Why the script must be ended now, if it must.
    std::optional<ScriptEnd> verdict(const ScriptOutput& written) const;
    // Until when to wait before asking again.
    Moment nextLook() const;
    Moment deadline() const { return deadline_; }

  private:
    std::size_t outputLimit_;
    const std::atomic<bool>& stopped_;
    Moment deadline_;
};

}  // namespace plume

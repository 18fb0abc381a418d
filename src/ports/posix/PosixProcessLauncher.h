// Starts programs the plain POSIX way, without an event loop: for threads that may block.
#pragma once

#include <cstdint>
#include <memory>
#include <mutex>
#include <string>

#include "platform/ProcessLauncher.h"

namespace plume {

// Temporary files and named streams lie in a folder of the launcher's own that only the user can enter, made when it is
// first needed in the system's temporary directory ($TMPDIR, or /tmp) and removed with the launcher.
class PosixProcessLauncher final : public ProcessLauncher {
  public:
    PosixProcessLauncher() = default;
    ~PosixProcessLauncher() override;
    PosixProcessLauncher(const PosixProcessLauncher&) = delete;
    PosixProcessLauncher& operator=(const PosixProcessLauncher&) = delete;

    Result<std::unique_ptr<RunningProcess>> start(const ProcessRequest& request) override;
    Result<std::unique_ptr<TemporaryFile>> makeTemporaryFile(std::string_view prefix, std::string_view bytes,
                                                             bool executable) override;
    Result<std::unique_ptr<NamedStream>> makeNamedStream() override;

  private:
    // A path for a new file in the folder.
    Result<std::string> newPath(std::string_view prefix);

    std::mutex mutex_;  // guards what follows
    std::string folder_;
    std::uint64_t lastNumber_ = 0;
};

}  // namespace plume

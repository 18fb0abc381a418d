// A child process of Plume.
#pragma once

#include <sys/types.h>

#include <optional>

#include "platform/ProcessLauncher.h"
#include "ports/posix/FileDescriptor.h"
#include "ports/posix/PosixStream.h"

namespace plume {

class PosixProcess final : public RunningProcess {
  public:
    // The process `pid` leads a group of its own and was not waited for; `input` may be closed.
    PosixProcess(pid_t pid, FileDescriptor input, FileDescriptor output, FileDescriptor error);
    ~PosixProcess() override;
    PosixProcess(const PosixProcess&) = delete;
    PosixProcess& operator=(const PosixProcess&) = delete;

    bool write(std::string_view bytes, Moment deadline) override;
    void closeInput() override { input_.close(); }
    ProcessStream& output() override { return output_; }
    ProcessStream& error() override { return error_; }
    void wait(std::span<ProcessStream* const> streams, Moment deadline) override;
    std::optional<int> exitStatus() override;
    void endGroup() override;

  private:
    void reap(int options);

    pid_t pid_;
    FileDescriptor input_;       // a socket, because writing to one can be kept from raising SIGPIPE
    FileDescriptor exitSignal_;  // readable once the process has ended; closed where the system has no such thing
    PosixStream output_;
    PosixStream error_;
    std::optional<int> exitStatus_;
};

}  // namespace plume

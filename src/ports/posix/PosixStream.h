// The reading end of a pipe, with or without a name.
#pragma once

#include <memory>
#include <string>

#include "platform/ProcessLauncher.h"
#include "ports/posix/FileDescriptor.h"

namespace plume {

// The one kind of stream that the POSIX port makes; without a name path() is empty.
class PosixStream final : public NamedStream {
  public:
    // `descriptor` must not block. The file, if there is one, is removed with the stream.
    explicit PosixStream(FileDescriptor descriptor, std::unique_ptr<TemporaryFile> file = nullptr);

    bool read(std::string& bytes) override;
    const std::string& path() const override;

    // What to poll: negative, which poll skips, once the last writer is gone and everything was read.
    int pollDescriptor() const { return hungUp_ ? -1 : descriptor_.get(); }
    void setHungUp() { hungUp_ = true; }

  private:
    FileDescriptor descriptor_;
    std::unique_ptr<TemporaryFile> file_;
    bool hungUp_ = false;
};

}  // namespace plume

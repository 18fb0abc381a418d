// Sees to it that one Plume at a time hears the keyboard of a display.
#pragma once

#include <sys/types.h>

#include <string>

#include "Foundation/Result.h"
#include "ports/posix/FileDescriptor.h"

namespace plume {

class InstanceLock {
  public:
    // The lock of this display, an empty name meaning $DISPLAY; it ends with the object, or with the process in
    // whatever way. The error tells which process has it, or why there is no place for one.
    static Result<InstanceLock> take(const std::string& display);

    // Whether somebody has it; takes and leaves nothing.
    static bool isTaken(const std::string& display);

    // Where the lock file of a display lies; screens of one display share it.
    static Result<std::string> pathFor(const std::string& display);
    // Where who has the lock can be reached: see app/session/CommandSocket.h.
    static Result<std::string> socketPathFor(const std::string& display);

  private:
    explicit InstanceLock(FileDescriptor file) : file_(std::move(file)) {}
    FileDescriptor file_;
};

}  // namespace plume

#pragma once

#include <string>

#include "testing/rig/ChildProcess.h"

namespace plume::rig {

// A pipe on which a program that is being started tells in one line that it is ready, as `-displayfd` of the X server
// and
// `--print-address` of the D-Bus daemon do.
class ReportPipe {
  public:
    ReportPipe();  // throws RigError

    // The descriptor the program writes to: one of its kept descriptors, and part of its arguments.
    int writer() const { return writer_.get(); }

    // The line without its end. Throws RigError, with what the program printed, when there is none within the bound.
    std::string awaitLine(const ChildProcess& program, Milliseconds bound);

  private:
    FileDescriptor reader_;
    FileDescriptor writer_;
};

}  // namespace plume::rig

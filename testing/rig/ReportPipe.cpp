#include "testing/rig/ReportPipe.h"

#include <fcntl.h>

#include <array>

#include "testing/rig/Deadline.h"

namespace plume::rig {

ReportPipe::ReportPipe() {
    std::array<int, 2> ends{};
    if (pipe2(ends.data(), O_CLOEXEC) != 0) throw RigError("cannot make a pipe");
    reader_ = FileDescriptor(ends[0]);
    writer_ = FileDescriptor(ends[1]);
}

std::string ReportPipe::awaitLine(const ChildProcess& program, Milliseconds bound) {
    writer_.close();  // so that the end of the program ends the wait
    const Deadline deadline(bound);
    std::string line;
    while (true) {
        char byte = 0;
        if (!deadline.waitReadable(reader_.get()) || read(reader_.get(), &byte, 1) != 1) {
            throw RigError(program.name() + " did not come up:\n" + program.logTail());
        }
        if (byte == '\n') return line;
        line += byte;
    }
}

}  // namespace plume::rig

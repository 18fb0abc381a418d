#include "ports/posix/PosixStream.h"

#include <array>
#include <cerrno>

namespace plume {

PosixStream::PosixStream(FileDescriptor descriptor, std::unique_ptr<TemporaryFile> file)
    : descriptor_(std::move(descriptor)), file_(std::move(file)) {}

bool PosixStream::read(std::string& bytes) {
    std::array<char, MaximumRead> buffer;
    ssize_t count = 0;
    do {
        count = ::read(descriptor_.get(), buffer.data(), buffer.size());
    } while (count < 0 && errno == EINTR);
    if (count <= 0) return false;
    bytes.append(buffer.data(), static_cast<std::size_t>(count));
    return true;
}

const std::string& PosixStream::path() const {
    static const std::string none;
    return file_ ? file_->path() : none;
}

}  // namespace plume

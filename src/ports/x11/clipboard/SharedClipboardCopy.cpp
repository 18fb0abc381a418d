#include "ports/x11/clipboard/SharedClipboardCopy.h"

#include <sys/mman.h>
#include <unistd.h>

#include <cstring>
#include <optional>

namespace plume {

namespace {

// In front of everything: where the last entry that is whole ends.
using Mark = std::uint64_t;

struct EntryHeader {
    std::uint32_t typeSize = 0;
    xcb_atom_t form = XCB_ATOM_NONE;
    std::uint64_t format = 0;
    std::uint64_t size = 0;
};

constexpr std::uint64_t LargestCopy = std::uint64_t{256} << 20;

std::optional<std::string> readAt(int descriptor, std::uint64_t offset, std::uint64_t size) {
    std::string bytes(size, '\0');
    std::uint64_t done = 0;
    while (done < size) {
        const ssize_t count = pread(descriptor, bytes.data() + done, size - done, static_cast<off_t>(offset + done));
        if (count <= 0) return std::nullopt;
        done += static_cast<std::uint64_t>(count);
    }
    return bytes;
}

template <typename Record>
std::optional<Record> readRecord(int descriptor, std::uint64_t offset) {
    const auto bytes = readAt(descriptor, offset, sizeof(Record));
    if (!bytes) return std::nullopt;
    Record record;
    std::memcpy(&record, bytes->data(), sizeof record);
    return record;
}

}  // namespace

SharedClipboardCopy::SharedClipboardCopy() : memory_(memfd_create("clipboard", MFD_CLOEXEC)) {
    clear();
}

void SharedClipboardCopy::clear() {
    types_.clear();
    end_ = sizeof(Mark);
    if (memory_.isOpen() && ftruncate(memory_.get(), 0) != 0) end_ = LargestCopy;
}

void SharedClipboardCopy::add(std::string_view type, xcb_atom_t form, std::uint8_t format, std::string_view bytes) {
    const std::uint64_t start = end_;
    if (!memory_.isOpen() || types_.contains(type)) return;
    if (start + sizeof(EntryHeader) + type.size() + bytes.size() > LargestCopy) return;
    const EntryHeader header{static_cast<std::uint32_t>(type.size()), form, format, bytes.size()};
    if (!write(&header, sizeof header) || !write(type.data(), type.size()) || !write(bytes.data(), bytes.size())) {
        end_ = start;
        return;
    }
    // Last: an entry counts once it is whole.
    const Mark mark = end_;
    if (pwrite(memory_.get(), &mark, sizeof mark, 0) == sizeof mark) types_.emplace(type);
}

bool SharedClipboardCopy::write(const void* bytes, std::size_t size) {
    std::size_t done = 0;
    while (done < size) {
        const ssize_t count =
            pwrite(memory_.get(), static_cast<const char*>(bytes) + done, size - done, static_cast<off_t>(end_ + done));
        if (count <= 0) return false;
        done += static_cast<std::size_t>(count);
    }
    end_ += size;
    return true;
}

std::vector<SharedClipboardCopy::Entry> SharedClipboardCopy::read(int descriptor) {
    std::vector<Entry> entries;
    const auto end = readRecord<Mark>(descriptor, 0);
    if (!end || *end > LargestCopy) return entries;
    for (std::uint64_t at = sizeof(Mark); at < *end;) {
        const auto header = readRecord<EntryHeader>(descriptor, at);
        at += sizeof(EntryHeader);
        if (!header || header->size > *end || at + header->typeSize + header->size > *end) break;
        auto type = readAt(descriptor, at, header->typeSize);
        auto bytes = readAt(descriptor, at + header->typeSize, header->size);
        if (!type || !bytes) break;
        at += header->typeSize + header->size;
        entries.push_back(
            {std::move(*type), header->form, static_cast<std::uint8_t>(header->format), std::move(*bytes)});
    }
    return entries;
}

}  // namespace plume

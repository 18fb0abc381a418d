// A copy of what the user had on the clipboard, in memory that Plume shares with its watchdog.
//
// Putting an expansion on the clipboard takes the clipboard from the program that held the user's content; from then on
// only Plume has a copy. The watchdog offers it when Plume has ended and nobody else holds the clipboard. The memory
// belongs to no file. Written on the tap thread.
#pragma once

#include <xcb/xcb.h>

#include <cstdint>
#include <set>
#include <string>
#include <string_view>
#include <vector>

#include "ports/posix/FileDescriptor.h"

namespace plume {

class SharedClipboardCopy {
  public:
    // One type's content, and the type and format that its program gave for it.
    struct Entry {
        std::string type;
        xcb_atom_t form = XCB_ATOM_NONE;
        std::uint8_t format = 0;
        std::string bytes;
    };

    // Without memory to share it keeps nothing.
    SharedClipboardCopy();
    SharedClipboardCopy(const SharedClipboardCopy&) = delete;
    SharedClipboardCopy& operator=(const SharedClipboardCopy&) = delete;

    // Of the memory, for the watchdog to inherit; -1 when there is none.
    int descriptor() const { return memory_.get(); }

    // Somebody else's content is on the clipboard now.
    void clear();
    // A type that is there already is left as it is.
    void add(std::string_view type, xcb_atom_t form, std::uint8_t format, std::string_view bytes);

    // What was written before the writer ended, wherever that was.
    static std::vector<Entry> read(int descriptor);

  private:
    bool write(const void* bytes, std::size_t size);

    const FileDescriptor memory_;
    std::set<std::string, std::less<>> types_;
    std::uint64_t end_ = 0;
};

}  // namespace plume

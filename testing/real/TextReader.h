// Reads what stands in a place of a program, as its user would get at it.
#pragma once

#include <xcb/xcb.h>

#include <filesystem>
#include <memory>
#include <string>

#include "testing/real/RealProgram.h"
#include "testing/rig/DesktopRig.h"

namespace plume::real {

class TextReader {
  public:
    virtual ~TextReader() = default;
    // The text as it is now; may press keys for it. Throws RigError when the desktop is gone.
    virtual std::string read() = 0;
    // Whether the text is still there afterwards, so that it can be read again.
    virtual bool leavesText() const { return true; }
};

// `file` is what programs that write files write; `window` is the program's. The rig outlives the reader.
std::unique_ptr<TextReader> makeReader(Reading reading, rig::DesktopRig& rig, xcb_window_t window,
                                       const std::filesystem::path& file);

}  // namespace plume::real

// An eager copy of everything on the clipboard, to be written back.
//
// Used on the tap thread. Restoring does not wait for a reader.
#pragma once

#include <string>
#include <utility>
#include <vector>

#include "platform/Pasteboard.h"
#include "platform/RunLoop.h"

namespace plume {

class ClipboardBackup {
  public:
    ClipboardBackup(Pasteboard& pasteboard, RunLoop& runLoop) : pasteboard_(pasteboard), runLoop_(runLoop) {}
    ClipboardBackup(const ClipboardBackup&) = delete;
    ClipboardBackup& operator=(const ClipboardBackup&) = delete;

    void backup();
    void restore();
    void restoreAfterDelay();
    void cancelRestore();
    bool hasData() const { return hasData_; }

  private:
    Pasteboard& pasteboard_;
    RunLoop& runLoop_;
    bool hasData_ = false;
    std::vector<std::pair<std::string, std::string>> datas_;  // type and bytes, in the clipboard's order
    Timer pendingRestore_;
};

}  // namespace plume

// AutoKey, another expander, to be measured on the same desktop: Debian's package autokey-gtk.
#pragma once

#include <filesystem>
#include <memory>
#include <string>
#include <vector>

#include "testing/rig/DesktopRig.h"

namespace plume::bench {

struct PeerPhrase {
    std::string abbreviation;
    std::string content;
    bool paste = false;
};

// Runs from its construction on, until it goes. It replaces each abbreviation as soon as its last letter is typed.
class PeerProgram {
  public:
    static bool isInstalled();

    // Pastes by Shift+Insert where the target is a terminal. Throws RigError.
    PeerProgram(rig::DesktopRig& rig, const std::vector<PeerPhrase>& phrases, bool forTerminal);

  private:
    std::unique_ptr<rig::ChildProcess> process_;
};

}  // namespace plume::bench

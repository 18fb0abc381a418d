// Pastes beside a clipboard manager.
#pragma once

#include <string>

#include "testing/real/Player.h"
#include "testing/rig/DesktopRig.h"

namespace plume::real {

extern const std::string ClipboardManager;

// Something is copied and an expansion pasted a while after it, sooner and later, `rounds` times. The outcome's text is
// what the clipboard manager has kept by then, which is to be what was copied, each once. Plume runs on the rig.
Outcome playHistory(rig::DesktopRig& rig, int rounds);

}  // namespace plume::real

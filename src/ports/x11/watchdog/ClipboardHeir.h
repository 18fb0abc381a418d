// Offers what the user had on the clipboard when Plume, which held it, has ended.
#pragma once

#include <string>

namespace plume {

// Returns at once. What there is to offer is offered by a process of its own, which ends when somebody else holds the
// clipboard, now or as soon as something new is copied, and with the X server.
void offerClipboardLegacy(const std::string& display, int descriptor);

}  // namespace plume

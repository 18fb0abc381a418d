// Offers what the user had on the clipboard when Plume, which held it, has ended.
#pragma once

#include <string>

namespace plume {

// Returns when there is nothing to offer, or when somebody else holds the clipboard. Otherwise goes on in a process of
// its own until something new is copied or the X server ends, and returns in the calling one at once.
void offerClipboardLegacy(const std::string& display, int descriptor);

}  // namespace plume

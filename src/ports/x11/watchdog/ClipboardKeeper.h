// The process that offers what the user had on the clipboard when Plume, which held it, has ended.
#pragma once

#include <string>

namespace plume {

// Starts it, unless the SharedClipboardCopy behind this descriptor is empty, and returns at once. It ends when somebody
// else holds the clipboard, now or as soon as something new is copied, and with the X server.
void startClipboardKeeper(const std::string& display, int descriptor);

}  // namespace plume

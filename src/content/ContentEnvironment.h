// What the content language asks of the world: the present moment, the place, the clipboard, and somebody to tell.
#pragma once

#include <functional>
#include <string>

#include "Foundation/Date.h"
#include "platform/Pasteboard.h"

namespace plume {

// Filled by the composition root; shared by the parser and its variables. Used on the thread that sends.
struct ContentEnvironment {
    std::function<Date()> now = currentDate;
    // IANA name ("Europe/Berlin"); empty: the system's.
    std::string timeZone;
    // Locale identifier ("de_DE"); empty: the user's for dates.
    std::string locale;
    // Not owned; null: an empty clipboard.
    const PasteboardReader* pasteboard = nullptr;
    // Tells the user that something in a snippet cannot work, in one sentence. Never null.
    std::function<void(const std::string&)> report = [](const std::string&) {};
};

}  // namespace plume

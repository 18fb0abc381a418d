// What the content language asks of the world: the present moment, the place, the clipboard, and somebody to tell.
#pragma once

#include <functional>
#include <string>
#include <string_view>

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
    // Tells the user that something in a snippet cannot work, in one sentence; null: nobody is to
    // know, as what is only looked at is not used yet.
    std::function<void(const std::string&)> report = [](const std::string&) {};

    // Reports the sentence unless it was reported lately, so that the user does not read it at every expansion: the
    // last few dozen are remembered, for the whole process. From any thread.
    void reportOnce(const std::string& sentence) const;
};

// A piece of a snippet as it may stand in such a sentence: in quotes, and not too long.
std::string quotedForReport(std::u16string_view text);

}  // namespace plume

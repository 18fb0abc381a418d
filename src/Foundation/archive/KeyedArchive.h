// Keyed archives: records and values under names, in the layout of the platform that Plume's libraries come from.
//
// Pure; from any thread, as far as the records themselves allow.
#pragma once

#include <functional>
#include <map>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/Result.h"
#include "Foundation/archive/KeyedCoding.h"
#include "Foundation/archive/PropertyList.h"
#include "Foundation/text/AttributedString.h"

namespace plume {

// A binary archive whose root is a dictionary of what `encodeRoot` writes.
std::string keyedArchive(const std::function<void(KeyedEncoder& root)>& encodeRoot);

// Calls `decodeRoot` once with what the archive's root dictionary holds; binary and XML archives. Made for foreign
// bytes. The error says what is wrong and where; what the decoder does not understand inside a well-formed archive
// reads as missing. The decoder must not be kept.
Result<void> readKeyedArchive(std::string_view bytes, const std::function<void(const KeyedDecoder& root)>& decodeRoot);

// A stretch of archived text: what it looks like, and its attributes of names that Plume does not know, as far as they
// are strings or numbers.
struct ArchivedRun {
    std::size_t length = 0;  // UTF-16 units
    SharedAttributes attributes;
    std::map<std::u16string, PropertyList> others;
};
struct ArchivedRichText {
    std::u16string text;
    std::vector<ArchivedRun> runs;  // their lengths sum to the text's
};
// An archived picture, as it was encoded; TIFF mostly.
struct ArchivedImage {
    std::string bytes;
};

// An archive whose root is a text, an attributed text or a picture; nothing when it is something else.
using ArchivedRootContent = std::variant<std::monostate, ArchivedRichText, ArchivedImage>;
Result<ArchivedRootContent> contentFromKeyedArchive(std::string_view bytes);

}  // namespace plume

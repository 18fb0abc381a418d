// RTF together with the files it shows: what lies between attributed text and the flat container.
//
// Internal to the core; callers use RTFD.h. Pure; from any thread.
#pragma once

#include <map>
#include <string>
#include <string_view>

#include "Foundation/Result.h"
#include "Foundation/text/AttributedString.h"

namespace plume {

// Attached files by the name that the RTF refers to.
using RTFFiles = std::map<std::u16string, std::string>;

struct RTFDocument {
    std::string rtf;
    RTFFiles files;
};

enum class RTFAttachments { Leave, Keep };

// Distances are rounded to twips, font sizes to half points and colours to 1/100000. A paragraph takes the style of its
// first unit. Tail indents from the leading margin, tool tips outside links and chips are not written.
RTFDocument rtfDocumentFromAttributedString(const AttributedString& text, RTFAttachments attachments);

// A reference to a file that is not in `files` leaves nothing in the text.
Result<AttributedString> attributedStringFromRTFDocument(std::string_view rtf, const RTFFiles& files);

// Several files of one name are told apart by a number before it: "2__#$!@%!#__name".
inline constexpr std::u16string_view RTFFileNumberMark = u"__#$!@%!#__";

}  // namespace plume

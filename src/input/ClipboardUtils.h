// Writing a text to the clipboard at once.
#pragma once

#include <string_view>

#include "Foundation/text/AttributedString.h"
#include "platform/Pasteboard.h"

namespace plume {

class ClipboardUtils {
  public:
    static void setString(Pasteboard& pasteboard, std::u16string_view string);
    // As plain text, RTFD, RTF and HTML.
    static void setAttributedString(Pasteboard& pasteboard, const AttributedString& string);
};

}  // namespace plume

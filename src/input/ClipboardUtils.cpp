#include "input/ClipboardUtils.h"

#include <string>

#include "Foundation/text/HTMLExport.h"
#include "Foundation/text/RTFD.h"

namespace plume {

void ClipboardUtils::setString(Pasteboard& pasteboard, std::u16string_view string) {
    pasteboard.declareTypes({std::string(PasteboardType::String)}, nullptr);
    pasteboard.setString(string, PasteboardType::String);
}

void ClipboardUtils::setAttributedString(Pasteboard& pasteboard, const AttributedString& string) {
    using namespace PasteboardType;
    pasteboard.declareTypes({std::string(String), std::string(RTFD), std::string(RTF), std::string(HTML)}, nullptr);
    pasteboard.setString(string.string(), String);
    pasteboard.setData(rtfdFromAttributedString(string), RTFD);
    pasteboard.setData(rtfFromAttributedString(string), RTF);
    pasteboard.setData(htmlFromAttributedString(string, defaultExcludedTags()), HTML);
}

}  // namespace plume

// Any bytes are read as HTML and as Markdown; what was read is written and means the same when it is read again.
#include <cstdint>
#include <cstdlib>
#include <string_view>

#include "Foundation/text/HTMLExport.h"
#include "Foundation/text/HTMLImport.h"
#include "Foundation/text/MarkdownImport.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    plume::attributedStringFromMarkdown(bytes);
    const auto once = plume::attributedStringFromHTML(bytes);
    const auto excluded = plume::defaultExcludedTags();
    const auto again = plume::attributedStringFromHTML(plume::htmlFromAttributedString(once, excluded));
    if (once.isEmpty() && !again.isEmpty()) std::abort();
    return 0;
}

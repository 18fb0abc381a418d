// Any old content is rewritten without harm: rich text as plain text would be, and only where there are percent signs.
#include <cstdint>
#include <cstdlib>
#include <string>

#include "Foundation/Strings.h"
#include "content/OldSyntax.h"

namespace {

plume::AttributedString converted(const plume::AttributedString& content) {
    plume::Snippet snippet;
    snippet.setContentType(plume::ContentType::RichText);
    snippet.setRichTextContent(content);
    plume::convertOldSnippet(snippet);
    return *snippet.richTextContent();
}

// The same text with a look of its own for every third part.
plume::AttributedString striped(const std::u16string& text) {
    plume::AttributedString result;
    const std::size_t part = text.size() / 3 + 1;
    for (std::size_t start = 0; start < text.size(); start += part) {
        auto attributes = std::make_shared<plume::TextAttributes>();
        attributes->baselineOffset = static_cast<double>(start);
        result.append(text.substr(start, part), attributes);
    }
    return result;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::u16string text = plume::fromUtf8({reinterpret_cast<const char*>(data), size});
    const auto plain = converted(plume::AttributedString(text));
    const auto rich = converted(striped(text));
    if (plain.string() != rich.string()) std::abort();
    if (text.find(u'%') == std::u16string::npos && plain.string() != text) std::abort();
    std::size_t length = 0;
    for (const auto& run : rich.runs()) length += run.length;
    if (length != rich.length()) std::abort();
    return 0;
}

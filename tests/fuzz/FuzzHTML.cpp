// Any rich text becomes HTML of well-formed UTF-8 whose elements close in order and which shows the same characters.
#include <unicode/utf16.h>

#include <cstdint>
#include <cstdlib>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/Strings.h"
#include "Foundation/text/HTMLExport.h"
#include "Foundation/text/RTFD.h"

namespace {

using plume::AttributedString;

// What a tag does to the elements that are open; attributes' values hold neither "<" nor ">".
void applyTag(std::string_view tag, std::vector<std::string>& open) {
    const std::string_view name = tag.substr(0, tag.find(' '));
    if (name.empty()) std::abort();
    if (name == "br" || name == "img" || name == "meta" || name == "!DOCTYPE" || name == "?xml") return;
    if (name.front() != '/') {
        open.emplace_back(name);
        return;
    }
    if (open.empty() || open.back() != name.substr(1)) std::abort();
    open.pop_back();
}

char characterFor(std::string_view entity) {
    if (entity == "amp") return '&';
    if (entity == "lt") return '<';
    if (entity == "gt") return '>';
    if (entity == "quot") return '"';
    if (entity == "nbsp") return ' ';
    std::abort();
}

std::string textOf(std::string_view html) {
    std::string text;
    std::vector<std::string> open;
    for (std::size_t i = 0; i < html.size(); ++i) {
        const std::size_t end = html[i] == '<' ? html.find('>', i) : html[i] == '&' ? html.find(';', i) : i;
        if (end == std::string_view::npos) std::abort();
        if (html[i] == '<') {
            applyTag(html.substr(i + 1, end - i - 1), open);
        } else {
            text += html[i] == '&' ? characterFor(html.substr(i + 1, end - i - 1)) : html[i];
        }
        i = end;
    }
    if (!open.empty()) std::abort();
    return text;
}

// Without what the export shows in another way: white space, control characters and attached files.
std::u16string visible(std::u16string_view text) {
    std::u16string kept;
    for (const char16_t c : text) {
        if (c > u' ' && c != u'\xa0' && c != u'\x2028' && c != u'\x2029' && c != u'\xfffc' && c != u'\xfffd' &&
            !U16_IS_SURROGATE(c)) {
            kept += c;
        }
    }
    return kept;
}

bool holdsListsOrFiles(const AttributedString& text) {
    for (const auto& run : text.runs()) {
        if (!run.attributes) continue;
        if (run.attributes->attachment) return true;
        if (run.attributes->paragraphStyle && !run.attributes->paragraphStyle->textLists.empty()) return true;
    }
    return false;
}

void check(const AttributedString& text) {
    for (const auto& excluded : {plume::defaultExcludedTags(), std::vector<std::string>{"p"}, {}}) {
        const std::string html = plume::htmlFromAttributedString(text, excluded);
        const auto shown = plume::fromStrictUtf8(textOf(html));
        if (!shown) std::abort();
        // A list makes its own markers, and a file that is no image is shown by its name.
        if (!holdsListsOrFiles(text) && visible(*shown) != visible(text.string())) std::abort();
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    if (const auto text = plume::attributedStringFromRTFD(bytes)) check(text.value());
    if (const auto text = plume::attributedStringFromRTF("{\\rtf1 " + std::string(bytes))) check(text.value());
    // Units as they come, with halves of pairs.
    std::u16string units;
    for (std::size_t i = 0; i + 1 < size; i += 2) units += static_cast<char16_t>(data[i] | data[i + 1] << 8);
    check(AttributedString(units));
    return 0;
}

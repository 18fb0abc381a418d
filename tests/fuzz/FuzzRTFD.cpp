// Any bytes are read as RTFD and as RTF, or refused; what was read is written and comes back with the same text.
#include <cstdint>
#include <cstdlib>
#include <string>
#include <string_view>

#include "Foundation/text/RTFD.h"

namespace {

using plume::AttributedString;

void checkWriting(const AttributedString& text) {
    const auto rich = plume::attributedStringFromRTFD(plume::rtfdFromAttributedString(text));
    if (!rich || rich.value().string() != text.string()) std::abort();
    // Once written, nothing is lost any more by writing again.
    const auto again = plume::attributedStringFromRTFD(plume::rtfdFromAttributedString(rich.value()));
    if (!again || !(again.value() == rich.value())) std::abort();
    if (!plume::attributedStringFromRTF(plume::rtfFromAttributedString(text))) std::abort();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    if (const auto text = plume::attributedStringFromRTFD(bytes)) checkWriting(text.value());
    if (const auto text = plume::attributedStringFromRTF(bytes)) checkWriting(text.value());
    if (const auto text = plume::attributedStringFromRTF("{\\rtf1 " + std::string(bytes))) checkWriting(text.value());
    static_cast<void>(plume::attachmentFromFlatContainer(bytes).ok());
    return 0;
}

// A placeholder's body written back is read as the same placeholder.
#include <cstdint>
#include <cstdlib>
#include <string>

#include "Foundation/Strings.h"
#include "content/PlaceholderKinds.h"

namespace {

std::u16string writtenBack(const std::u16string& body) {
    const auto variable = plume::parseVariable(body);
    return variable ? variable->toString() : std::u16string();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::u16string text = plume::fromUtf8({reinterpret_cast<const char*>(data), size});
    const auto params = plume::parseParams(u"field:" + plume::escapeParam(text));
    if (params.size() != 1 || params.begin()->second != text) std::abort();

    // The first two may differ: what a kind does not keep (a pop-up menu its default index) goes on the way.
    const std::u16string once = writtenBack(text);
    const std::u16string twice = writtenBack(once);
    if (writtenBack(twice) != twice) std::abort();
    return 0;
}

// Any bytes are read as a property list, or refused; what was read is written and comes back the same.
#include <cstdint>
#include <cstdlib>
#include <string_view>

#include "Foundation/archive/PropertyListReader.h"
#include "Foundation/archive/PropertyListWriter.h"

namespace {

using plume::PropertyList;

// Compared as bytes: a real that is no number equals nothing.
void checkBinary(const PropertyList& list) {
    const std::string bytes = plume::binaryPropertyList(list);
    const auto back = plume::readPropertyList(bytes);
    // What a small file made large may be too large to be made of what is written.
    if (back && plume::binaryPropertyList(back.value()) != bytes) std::abort();
}

void checkXml(const PropertyList& list) {
    const auto once = plume::readPropertyList(plume::xmlPropertyList(list));
    if (!once) std::abort();
    const auto twice = plume::readPropertyList(plume::xmlPropertyList(once.value()));
    if (!twice || plume::xmlPropertyList(twice.value()) != plume::xmlPropertyList(once.value())) std::abort();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    if (const auto list = plume::readPropertyList(bytes)) {
        checkBinary(list.value());
        checkXml(list.value());
    }
    return 0;
}

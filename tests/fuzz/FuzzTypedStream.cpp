// Any bytes are read as a typed stream, or refused; so are they as the content of an object in one.
#include <cstdint>
#include <string>
#include <string_view>

#include "Foundation/archive/TypedStream.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using namespace std::string_literals;
    const std::string bytes(reinterpret_cast<const char*>(data), size);
    static_cast<void>(plume::attributedStringFromTypedStream(bytes).ok());
    const std::string start =
        "\x04\x0Bstreamtyped\x81\xE8\x03\x84\x01@\x84\x84\x84\x12NSAttributedString\0\x84\x84\x08NSObject\0\x85"
        "\x92\x84\x84\x84\x08NSString\1\x94\x84\1+\4text\x86\x84\2iI\1\4\x92"s;
    static_cast<void>(plume::attributedStringFromTypedStream(start + bytes).ok());
    return 0;
}

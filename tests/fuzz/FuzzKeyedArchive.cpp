// Any bytes are read as a keyed archive, or refused; the texts in it are written and come back the same.
#include <cstdint>
#include <cstdlib>
#include <string>
#include <string_view>

#include "Foundation/archive/KeyedArchive.h"

namespace {

using plume::AttributedString;

// Distances and sizes that are no numbers equal nothing; writing them again has to give the same bytes.
void checkWriting(const AttributedString& text) {
    const auto archive = [](const AttributedString& content) {
        return plume::keyedArchive([&](plume::KeyedEncoder& root) { root.encodeContent("k", content); });
    };
    const std::string bytes = archive(text);
    AttributedString back;
    const auto read = plume::readKeyedArchive(
        bytes, [&](const plume::KeyedDecoder& root) { back = std::get<AttributedString>(root.decodeContent("k")); });
    if (!read || back.string() != text.string() || archive(back) != bytes) std::abort();
}

void decode(const plume::KeyedDecoder& decoder, int depth) {
    for (const std::string_view key : {"k", "Snippets", "Items", "Content", "Name"}) {
        decoder.decodeInteger(key);
        decoder.decodeString(key);
        decoder.decodeStrings(key);
        decoder.decodeDate(key);
        decoder.decodeCharacterSet(key);
        decoder.decodePropertyList(key);
        const auto content = decoder.decodeContent(key);
        if (const auto* text = std::get_if<AttributedString>(&content)) checkWriting(*text);
        if (depth < 4) decoder.decodeObjects(key, [&](plume::KeyedDecoder& inner) { decode(inner, depth + 1); });
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    static_cast<void>(plume::readKeyedArchive(bytes, [](const plume::KeyedDecoder& root) { decode(root, 0); }).ok());
    static_cast<void>(plume::contentFromKeyedArchive(bytes).ok());
    return 0;
}

#include <string>
#include <utility>
#include <vector>

#include "Foundation/archive/ArchiveReader.h"
#include "Foundation/archive/ArchivedTextReader.h"
#include "Foundation/archive/KeyedArchive.h"
#include "Foundation/archive/PropertyListReader.h"
#include "Foundation/archive/PropertyListWriter.h"

namespace plume {

namespace {

// What one archive is read with.
struct Archive {
    explicit Archive(ArchiveReader& aReader) : reader(aReader) {}

    ArchiveReader& reader;
    ArchivedTextReader texts{reader};
};

// An object: a record that has its values under keys, or a dictionary, whose keys are objects too.
class ArchiveDecoder final : public KeyedDecoder {
  public:
    ArchiveDecoder(Archive& archive, const ArchivedValue& object)
        : archive_(archive),
          object_(object),
          isDictionary_(archive.reader.classOf(object) == ArchivedClass::Dictionary) {
        if (isDictionary_) entries_ = archive.reader.entriesOf(object);
    }

    bool containsValueForKey(std::string_view key) const override { return static_cast<bool>(find(key)); }
    std::int64_t decodeInteger(std::string_view key) const override { return reader().integer(find(key)).value_or(0); }
    bool decodeBool(std::string_view key) const override { return reader().integer(find(key)).value_or(0) != 0; }
    std::optional<std::u16string> decodeString(std::string_view key) const override {
        return reader().string(find(key));
    }
    std::optional<Date> decodeDate(std::string_view key) const override { return reader().date(find(key)); }
    std::optional<CharacterSet> decodeCharacterSet(std::string_view key) const override {
        return reader().characterSet(find(key));
    }
    std::optional<std::vector<std::u16string>> decodeStrings(std::string_view key) const override;
    ArchivedContent decodeContent(std::string_view key) const override;
    bool decodeObjects(std::string_view key, const std::function<void(KeyedDecoder&)>& receive) const override;
    std::optional<PropertyList> decodePropertyList(std::string_view key) const override {
        return reader().propertyList(find(key));
    }
    std::any& decodedObject() override { return object_.place == 0 ? own_ : reader().made(object_); }

  private:
    ArchiveReader& reader() const { return archive_.reader; }
    ArchivedValue find(std::string_view key) const;

    Archive& archive_;
    ArchivedValue object_;
    bool isDictionary_;
    std::vector<std::pair<std::string, ArchivedValue>> entries_;
    mutable std::size_t place_ = 0;  // keys are mostly asked for in their order
    std::any own_;
};

ArchivedValue ArchiveDecoder::find(std::string_view key) const {
    if (!isDictionary_) return reader().field(object_, key, place_);
    for (const auto& [name, value] : entries_) {
        if (name == key) return value;
    }
    return {};
}

std::optional<std::vector<std::u16string>> ArchiveDecoder::decodeStrings(std::string_view key) const {
    const ArchivedValue array = find(key);
    if (reader().classOf(array) != ArchivedClass::Array) return std::nullopt;
    std::vector<std::u16string> strings;
    for (const ArchivedValue& element : reader().elementsOf(array)) {
        if (auto text = reader().string(element)) strings.push_back(*std::move(text));
    }
    return strings;
}

ArchivedContent ArchiveDecoder::decodeContent(std::string_view key) const {
    const ArchivedValue value = find(key);
    if (auto text = reader().string(value)) return *std::move(text);
    if (auto bytes = reader().data(value)) return ArchivedData{*std::move(bytes)};
    if (auto attributed = archive_.texts.readAttributedString(value)) return *std::move(attributed);
    return std::monostate();
}

bool ArchiveDecoder::decodeObjects(std::string_view key, const std::function<void(KeyedDecoder&)>& receive) const {
    const ArchivedValue array = find(key);
    if (reader().classOf(array) != ArchivedClass::Array) return false;
    reader().nested([&] {
        for (const ArchivedValue& element : reader().elementsOf(array)) {
            if (!element.isDictionary() || !reader().spend(sizeof(ArchiveDecoder))) continue;
            ArchiveDecoder decoder(archive_, element);
            receive(decoder);
        }
    });
    return true;
}

// The archive in its binary form; `storage` holds it when it comes in another one.
Result<std::string_view> binaryForm(std::string_view bytes, std::string& storage) {
    if (BinaryObjects::isBinary(bytes)) return bytes;
    const auto list = readPropertyList(bytes);
    if (!list) return list.error();
    storage = binaryPropertyList(list.value());
    return std::string_view(storage);
}

// A picture has lists of representations; the first that is there is taken.
std::optional<std::string> imageDataIn(ArchiveReader& reader, const ArchivedValue& object) {
    for (const std::string_view key : {"NSTIFFRepresentation", "NSPNGRepresentation", "NSJPEGRepresentation"}) {
        if (auto bytes = reader.data(reader.field(object, key))) return bytes;
    }
    std::optional<std::string> found;
    reader.nested([&] {
        const ArchivedValue representations = reader.field(object, "NSReps");
        for (const ArchivedValue& element : reader.elementsOf(representations ? representations : object)) {
            if (element.isDictionary() && reader.spend(sizeof(ArchivedValue))) found = imageDataIn(reader, element);
            if (found) return;
        }
    });
    return found;
}

}  // namespace

Result<void> readKeyedArchive(std::string_view bytes, const std::function<void(const KeyedDecoder& root)>& decodeRoot) {
    std::string storage;
    const auto binary = binaryForm(bytes, storage);
    if (!binary) return binary.error();
    const auto reader = ArchiveReader::open(binary.value());
    if (!reader) return reader.error();
    Archive archive(*reader.value());
    const ArchivedValue root = archive.reader.root();
    if (archive.reader.classOf(root) != ArchivedClass::Dictionary) {
        return archive.reader.damage().value_or(
            Error{"The keyed archive is of another kind: expected a dictionary as its root object."});
    }
    const ArchiveDecoder decoder(archive, root);
    decodeRoot(decoder);
    if (archive.reader.damage()) return *archive.reader.damage();
    return {};
}

Result<ArchivedRootContent> contentFromKeyedArchive(std::string_view bytes) {
    std::string storage;
    const auto binary = binaryForm(bytes, storage);
    if (!binary) return binary.error();
    const auto opened = ArchiveReader::open(binary.value());
    if (!opened) return opened.error();
    ArchiveReader& reader = *opened.value();
    const ArchivedValue root = reader.root();
    ArchivedRootContent content;
    if (auto text = reader.string(root)) {
        ArchivedRichText rich;
        if (!text->empty()) rich.runs.push_back({text->size(), nullptr, {}});
        rich.text = *std::move(text);
        content = std::move(rich);
    } else if (auto rich = ArchivedTextReader(reader).read(root)) {
        content = *std::move(rich);
    } else if (reader.classOf(root) == ArchivedClass::Image) {
        if (auto image = imageDataIn(reader, root)) content = ArchivedImage{*std::move(image)};
    }
    if (reader.damage()) return *reader.damage();
    return content;
}

}  // namespace plume

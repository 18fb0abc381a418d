#include <map>
#include <string>
#include <utility>
#include <variant>
#include <vector>

#include "Foundation/archive/ArchiveWriter.h"
#include "Foundation/archive/ArchivedCharacterSets.h"
#include "Foundation/archive/ArchivedTextWriter.h"
#include "Foundation/archive/KeyedArchive.h"

namespace plume {

namespace {

using Object = ArchiveWriter::Object;
using Value = ArchiveWriter::Value;

constexpr ArchiveWriter::Class CharacterSetClass{"NSCharacterSet"};

// What one archive is written with.
struct Archive {
    ArchiveWriter objects;
    ArchivedTextWriter texts{objects};
    std::map<const KeyedCodable*, Object> records;
};

class ArchiveEncoder : public KeyedEncoder {
  public:
    explicit ArchiveEncoder(Archive& archive) : archive_(archive) {}

    void encodeInteger(std::string_view key, std::int64_t value) override { putNumber(key, values().integer(value)); }
    void encodeBool(std::string_view key, bool value) override { putNumber(key, values().boolean(value)); }
    void encodeString(std::string_view key, const std::optional<std::u16string>& value) override {
        if (value) putObject(key, archive_.objects.addString(*value));
    }
    void encodeDate(std::string_view key, const std::optional<Date>& value) override {
        if (value) putObject(key, archive_.objects.addDate(*value));
    }
    void encodeCharacterSet(std::string_view key, const std::optional<CharacterSet>& value) override;
    void encodeStrings(std::string_view key, const std::optional<std::vector<std::u16string>>& value) override;
    void encodeContent(std::string_view key, const ArchivedContent& value) override;
    void encodeObjects(std::string_view key, const std::vector<const KeyedCodable*>& values) override;
    void encodePropertyList(std::string_view key, const PropertyList& value) override {
        if (const Object object = archive_.objects.addPropertyList(value)) putObject(key, object);
    }

  protected:
    virtual void putNumber(std::string_view key, Value number) = 0;
    virtual void putObject(std::string_view key, Object object) = 0;

    ArchiveWriter& objects() { return archive_.objects; }
    BinaryObjectWriter& values() { return archive_.objects.values(); }

  private:
    Object addRecord(const KeyedCodable& record);

    Archive& archive_;
};

// A record keeps numbers in itself and refers to objects.
class RecordEncoder final : public ArchiveEncoder {
  public:
    explicit RecordEncoder(Archive& archive) : ArchiveEncoder(archive), fields_(archive.objects) {}

    void finish(Object object, std::string_view className) { objects().fill(object, {className}, fields_); }

  private:
    void putNumber(std::string_view key, Value number) override { fields_.put(key, number); }
    void putObject(std::string_view key, Object object) override { fields_.refer(key, object); }

    ArchiveWriter::Fields fields_;
};

// The root is a dictionary, whose values are all objects.
class RootEncoder final : public ArchiveEncoder {
  public:
    explicit RootEncoder(Archive& archive) : ArchiveEncoder(archive) {}

    void finish(Object object) { objects().fillDictionary(object, entries_); }

  private:
    void putNumber(std::string_view key, Value number) override { putObject(key, objects().add(number)); }
    void putObject(std::string_view key, Object object) override {
        entries_.emplace_back(objects().add(values().ascii(key)), object);
    }

    std::vector<std::pair<Object, Object>> entries_;
};

void ArchiveEncoder::encodeCharacterSet(std::string_view key, const std::optional<CharacterSet>& value) {
    if (!value) return;
    ArchiveWriter::Fields fields(archive_.objects);
    if (const auto text = shortTextOfCharacterSet(*value)) {
        fields.put("NSString", values().string(*text));
    } else {
        fields.put("NSBitmap", values().data(bitmapOfCharacterSet(*value)));
    }
    putObject(key, archive_.objects.add(CharacterSetClass, fields));
}

void ArchiveEncoder::encodeStrings(std::string_view key, const std::optional<std::vector<std::u16string>>& value) {
    if (!value) return;
    std::vector<Object> strings;
    for (const std::u16string& text : *value) strings.push_back(archive_.objects.addString(text));
    putObject(key, archive_.objects.addArray(archived::Array, strings));
}

void ArchiveEncoder::encodeContent(std::string_view key, const ArchivedContent& value) {
    if (const auto* text = std::get_if<std::u16string>(&value)) {
        putObject(key, archive_.objects.addString(*text));
    } else if (const auto* attributed = std::get_if<AttributedString>(&value)) {
        putObject(key, archive_.texts.add(*attributed));
    } else if (const auto* data = std::get_if<ArchivedData>(&value)) {
        putObject(key, archive_.objects.add(values().data(data->bytes)));
    }
}

void ArchiveEncoder::encodeObjects(std::string_view key, const std::vector<const KeyedCodable*>& values) {
    const Object list = archive_.objects.reserve();
    putObject(key, list);
    std::vector<Object> records;
    records.reserve(values.size());
    for (const KeyedCodable* record : values) records.push_back(addRecord(*record));
    archive_.objects.fillArray(list, archived::MutableArray, records);
}

Object ArchiveEncoder::addRecord(const KeyedCodable& record) {
    const auto known = archive_.records.find(&record);
    if (known != archive_.records.end()) return known->second;
    const Object object = archive_.objects.reserve();
    archive_.records.emplace(&record, object);
    RecordEncoder encoder(archive_);
    record.encodeWithCoder(encoder);
    encoder.finish(object, record.archiveClassName());
    return object;
}

}  // namespace

std::string keyedArchive(const std::function<void(KeyedEncoder& root)>& encodeRoot) {
    Archive archive;
    const Object root = archive.objects.reserve();
    RootEncoder encoder(archive);
    encodeRoot(encoder);
    encoder.finish(root);
    return archive.objects.finish(root);
}

}  // namespace plume

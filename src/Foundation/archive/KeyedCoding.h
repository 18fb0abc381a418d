// Writing records to, and reading them from, an archive of named values; the container behind it is somebody else's.
//
// Keys are unique within one object. Encoders and decoders live for one pass over one archive, on one thread.
#pragma once

#include <any>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

#include "Foundation/CharacterSet.h"
#include "Foundation/Date.h"
#include "Foundation/archive/PropertyList.h"
#include "Foundation/text/AttributedString.h"

namespace plume {

class KeyedEncoder;
class KeyedDecoder;

// A content as an archive may hold it: nothing, raw data, plain text or attributed text.
using ArchivedContent = std::variant<std::monostate, ArchivedData, std::u16string, AttributedString>;

// A record that archives itself.
class KeyedCodable {
  public:
    virtual ~KeyedCodable() = default;
    // The class name under which archives know the record.
    virtual std::string_view archiveClassName() const = 0;
    virtual void encodeWithCoder(KeyedEncoder& coder) const = 0;
};

class KeyedEncoder {
  public:
    virtual ~KeyedEncoder() = default;
    virtual void encodeInteger(std::string_view key, std::int64_t value) = 0;
    virtual void encodeBool(std::string_view key, bool value) = 0;
    // A nil object is simply absent from the archive.
    virtual void encodeString(std::string_view key, const std::optional<std::u16string>& value) = 0;
    virtual void encodeDate(std::string_view key, const std::optional<Date>& value) = 0;
    virtual void encodeCharacterSet(std::string_view key, const std::optional<CharacterSet>& value) = 0;
    virtual void encodeStrings(std::string_view key, const std::optional<std::vector<std::u16string>>& value) = 0;
    virtual void encodeContent(std::string_view key, const ArchivedContent& value) = 0;
    // A record that is given several times is archived once.
    virtual void encodeObjects(std::string_view key, const std::vector<const KeyedCodable*>& values) = 0;
    virtual void encodePropertyList(std::string_view key, const PropertyList& value) = 0;
};

// Reads what an encoder wrote, or an archive from elsewhere. A missing key, like a value of another kind than the one
// asked for, reads as 0, false or nothing.
class KeyedDecoder {
  public:
    virtual ~KeyedDecoder() = default;
    virtual bool containsValueForKey(std::string_view key) const = 0;
    virtual std::int64_t decodeInteger(std::string_view key) const = 0;
    virtual bool decodeBool(std::string_view key) const = 0;
    virtual std::optional<std::u16string> decodeString(std::string_view key) const = 0;
    virtual std::optional<Date> decodeDate(std::string_view key) const = 0;
    virtual std::optional<CharacterSet> decodeCharacterSet(std::string_view key) const = 0;
    virtual std::optional<std::vector<std::u16string>> decodeStrings(std::string_view key) const = 0;
    virtual ArchivedContent decodeContent(std::string_view key) const = 0;
    // Calls `receive` once per object of the array, in order, with a decoder for that object; false when no array is
    // stored under the key.
    virtual bool decodeObjects(std::string_view key, const std::function<void(KeyedDecoder&)>& receive) const = 0;
    virtual std::optional<PropertyList> decodePropertyList(std::string_view key) const = 0;
    // What was made of this object: empty at first, and what was put there when the same object is met again, so that
    // a record that stands in two lists is one record afterwards too.
    virtual std::any& decodedObject() = 0;
};

}  // namespace plume

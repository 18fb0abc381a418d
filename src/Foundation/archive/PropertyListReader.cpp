#include "Foundation/archive/PropertyListReader.h"

#include <algorithm>
#include <iterator>
#include <optional>
#include <string>
#include <utility>
#include <variant>
#include <vector>

#include "Foundation/Strings.h"
#include "Foundation/archive/AsciiPropertyList.h"
#include "Foundation/archive/BinaryObjects.h"
#include "Foundation/archive/PropertyListLimits.h"
#include "Foundation/archive/ReferenceDate.h"
#include "Foundation/archive/XmlPropertyList.h"

namespace plume {

namespace {

constexpr std::string_view Utf8Mark = "\xEF\xBB\xBF";

// Makes values of the objects of a binary property list.
class BinaryReader {
  public:
    BinaryReader(const BinaryObjects& objects, std::size_t size) : objects_(objects), left_(mostBytesMadeOf(size)) {}

    Result<PropertyList> read() {
        PropertyList list;
        if (readObject(objects_.root(), list)) return list;
        return Error{"The binary property list is damaged at byte " + std::to_string(offset_) + " (object " +
                     std::to_string(object_) + "): expected " + expected_ + "."};
    }

  private:
    bool fails(std::size_t index, const char* expected) {
        object_ = index;
        offset_ = objects_.offsetOf(index);
        expected_ = expected;
        return false;
    }

    bool readObject(std::size_t index, PropertyList& value) {
        const BinaryObject object = objects_.at(index);
        const bool isContainer =
            object.kind == BinaryObject::Kind::Array || object.kind == BinaryObject::Kind::Dictionary;
        const std::size_t cost = sizeof(PropertyList) + (isContainer ? 0 : 2 * object.bytes.size());
        if (cost > left_) return fails(index, "values that refer less often to the same objects");
        left_ -= cost;
        if (!isContainer) return readScalar(index, object, value);
        if (path_.size() >= DeepestPropertyList) return fails(index, "fewer values inside of each other");
        if (std::find(path_.begin(), path_.end(), index) != path_.end()) {
            return fails(index, "a value that does not hold itself");
        }
        path_.push_back(index);
        const bool read = object.kind == BinaryObject::Kind::Array ? readArray(index, object, value)
                                                                   : readDictionary(index, object, value);
        path_.pop_back();
        return read;
    }

    bool readScalar(std::size_t index, const BinaryObject& object, PropertyList& value) {
        using Kind = BinaryObject::Kind;
        switch (object.kind) {
            case Kind::Boolean:
                value = booleanOf(object);
                return true;
            case Kind::Integer:
                std::visit([&](auto number) { value = number; }, numberOf(object));
                return true;
            case Kind::Real:
                value = realOf(object);
                return true;
            case Kind::Data:
                value = ArchivedData{std::string(object.bytes)};
                return true;
            case Kind::Ascii:
            case Kind::Utf16:
                value = stringOf(object);
                return true;
            case Kind::Uid:
                value = PropertyList::Uid{bigEndianNumber(object.bytes)};
                return true;
            case Kind::Time:
                if (const auto date = dateFromReferenceSeconds(realOf(object))) {
                    value = *date;
                    return true;
                }
                return fails(index, "a date");
            default:
                return fails(index, "a value");
        }
    }

    bool readArray(std::size_t index, const BinaryObject& object, PropertyList& value) {
        PropertyList::Array elements;
        for (std::size_t i = 0; i < object.count; ++i) {
            const std::size_t element = objects_.reference(object, i);
            if (element >= objects_.count()) return fails(index, "references to objects that there are");
            if (!readObject(element, elements.emplace_back())) return false;
        }
        value = std::move(elements);
        return true;
    }

    bool readDictionary(std::size_t index, const BinaryObject& object, PropertyList& value) {
        PropertyList::Dictionary entries;
        for (std::size_t i = 0; i < object.count; ++i) {
            const std::size_t key = objects_.reference(object, i);
            const std::size_t element = objects_.reference(object, object.count + i);
            if (std::max(key, element) >= objects_.count()) return fails(index, "references to objects that there are");
            PropertyList name;
            if (!readObject(key, name)) return false;
            const auto* text = name.as<std::u16string>();
            if (!text) return fails(key, "a string as the key of a dictionary");
            if (!readObject(element, entries[toUtf8(*text)])) return false;
        }
        value = std::move(entries);
        return true;
    }

    const BinaryObjects& objects_;
    std::size_t left_;               // how many bytes the values may yet take
    std::vector<std::size_t> path_;  // the containers around the value
    std::size_t object_ = 0;
    std::size_t offset_ = 0;
    const char* expected_ = "";
};

Result<PropertyList> readBinary(std::string_view bytes) {
    const auto objects = BinaryObjects::open(bytes);
    if (!objects) return objects.error();
    return BinaryReader(objects.value(), bytes.size()).read();
}

// Text of two bytes a unit.
std::u16string textOfUnits(std::string_view bytes, bool bigEndian) {
    std::u16string text(bytes.size() / 2, u'\0');
    for (std::size_t i = 0; i < text.size(); ++i) {
        const auto first = static_cast<unsigned char>(bytes[2 * i]);
        const auto second = static_cast<unsigned char>(bytes[2 * i + 1]);
        text[i] = static_cast<char16_t>(bigEndian ? first << 8 | second : second << 8 | first);
    }
    return text;
}

// Text that its first two bytes tell to be UTF-16.
std::optional<std::u16string> textFromUtf16(std::string_view bytes) {
    using namespace std::string_view_literals;
    if (bytes.starts_with("\xFE\xFF"sv)) return textOfUnits(bytes.substr(2), true);
    if (bytes.starts_with("\xFF\xFE"sv)) return textOfUnits(bytes.substr(2), false);
    if (bytes.starts_with("\0<"sv)) return textOfUnits(bytes, true);
    if (bytes.starts_with("<\0"sv)) return textOfUnits(bytes, false);
    return std::nullopt;
}

// The old form has data in angle brackets, whose digits are no element's name.
bool isXml(std::string_view text) {
    if (!text.starts_with('<')) return false;
    text.remove_prefix(1);
    constexpr std::string_view Names[] = {"?",       "!",    "plist", "dict",  "array", "string",
                                          "integer", "real", "true",  "false", "date",  "data"};
    return std::any_of(std::begin(Names), std::end(Names),
                       [&](std::string_view name) { return text.starts_with(name); });
}

}  // namespace

Result<PropertyList> readPropertyList(std::string_view bytes) {
    if (BinaryObjects::isBinary(bytes)) return readBinary(bytes);
    if (const auto text = textFromUtf16(bytes)) {
        const std::string utf8 = toUtf8(trimmed(*text));
        return isXml(utf8) ? readXmlPropertyList(utf8, XmlEncoding::Utf8) : readAsciiPropertyList(*text);
    }
    if (bytes.starts_with(Utf8Mark)) bytes.remove_prefix(Utf8Mark.size());
    const std::string_view start = bytes.substr(std::min(bytes.find_first_not_of(" \t\r\n"), bytes.size()));
    return isXml(start) ? readXmlPropertyList(bytes, XmlEncoding::AsDeclared) : readAsciiPropertyList(fromUtf8(bytes));
}

}  // namespace plume

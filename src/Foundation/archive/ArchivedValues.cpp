// What the values of keyed archives hold; the other half of ArchiveReader.
#include <algorithm>
#include <array>
#include <utility>

#include "Foundation/Strings.h"
#include "Foundation/archive/ArchiveReader.h"
#include "Foundation/archive/ArchivedCharacterSets.h"
#include "Foundation/archive/ReferenceDate.h"

namespace plume {

namespace {

using Kind = BinaryObject::Kind;

// What a bitmap of one plane costs to be read.
constexpr std::size_t CostOfPlane = 0x10000;
constexpr std::size_t PlaneBytes = 8192;
constexpr std::size_t UuidSize = 16;

// A real within the range of integers, without its fraction; 0 for others.
std::int64_t truncated(double real) {
    constexpr double Limit = 9.2e18;
    return real > -Limit && real < Limit ? static_cast<std::int64_t>(real) : 0;
}

// In the canonical form: 8-4-4-4-12 digits.
std::u16string uuidText(std::string_view bytes) {
    constexpr std::u16string_view Digits = u"0123456789ABCDEF";
    std::u16string text;
    for (std::size_t i = 0; i < bytes.size(); ++i) {
        if (i == 4 || i == 6 || i == 8 || i == 10) text += u'-';
        const auto byte = static_cast<unsigned char>(bytes[i]);
        text += Digits[byte >> 4];
        text += Digits[byte & 0xF];
    }
    return text;
}

}  // namespace

std::optional<std::u16string> ArchiveReader::string(const ArchivedValue& value) {
    if (value.object.isString()) {
        if (!spend(2 * value.object.count + sizeof(std::u16string))) return std::nullopt;
        return stringOf(value.object);
    }
    if (!value.isDictionary()) return std::nullopt;
    const ArchivedClass itsClass = classOf(value);
    if (itsClass == ArchivedClass::Uuid) {
        const auto bytes = data(field(value, "NS.uuidbytes"));
        return bytes && bytes->size() == UuidSize ? std::optional(uuidText(*bytes)) : std::nullopt;
    }
    if (itsClass != ArchivedClass::String) return std::nullopt;
    const ArchivedValue text = field(value, "NS.string");
    if (text.object.isString()) return string(text);
    const auto bytes = data(field(value, "NS.bytes"));
    return bytes ? std::optional(fromUtf8(*bytes)) : std::nullopt;
}

std::optional<std::string> ArchiveReader::data(const ArchivedValue& value) {
    if (value.object.kind == Kind::Data) {
        if (!spend(value.object.bytes.size() + sizeof(std::string))) return std::nullopt;
        return std::string(value.object.bytes);
    }
    if (classOf(value) != ArchivedClass::Data) return std::nullopt;
    for (const std::string_view key : {"NS.data", "NS.bytes"}) {
        const ArchivedValue bytes = field(value, key);
        if (bytes.object.kind == Kind::Data) return data(bytes);
    }
    return std::nullopt;
}

std::optional<std::variant<std::int64_t, double>> ArchiveReader::number(const ArchivedValue& value) {
    switch (value.object.kind) {
        case Kind::Boolean:
            return std::int64_t{booleanOf(value.object)};
        case Kind::Integer:
            return numberOf(value.object);
        case Kind::Real:
            return realOf(value.object);
        default:
            break;
    }
    if (classOf(value) != ArchivedClass::Number) return std::nullopt;
    for (const std::string_view key : {"NS.boolval", "NS.intval", "NS.dblval"}) {
        const ArchivedValue inside = field(value, key);
        if (inside && !inside.isDictionary()) return number(inside);
    }
    return std::nullopt;
}

std::optional<std::int64_t> ArchiveReader::integer(const ArchivedValue& value) {
    const auto found = number(value);
    if (!found) return std::nullopt;
    const auto* real = std::get_if<double>(&*found);
    return real ? truncated(*real) : std::get<std::int64_t>(*found);
}

std::optional<double> ArchiveReader::real(const ArchivedValue& value) {
    const auto found = number(value);
    if (!found) return std::nullopt;
    return std::visit([](auto any) { return static_cast<double>(any); }, *found);
}

std::optional<Date> ArchiveReader::date(const ArchivedValue& value) {
    if (value.object.kind == Kind::Time) return dateFromReferenceSeconds(realOf(value.object));
    if (classOf(value) != ArchivedClass::Time) return std::nullopt;
    const auto seconds = real(field(value, "NS.time"));
    return seconds ? dateFromReferenceSeconds(*seconds) : std::nullopt;
}

std::optional<std::u16string> ArchiveReader::address(const ArchivedValue& url) {
    if (classOf(url) != ArchivedClass::Url) return string(url);
    auto relative = string(field(url, "NS.relative"));
    std::optional<std::u16string> base;
    nested([&] {
        if (const ArchivedValue object = field(url, "NS.base")) base = address(object);
    });
    if (!relative || !base) return relative ? relative : base;
    // An address of its own, or one that continues the folder of the base.
    if (relative->find(u"://") != std::u16string::npos) return relative;
    return base->substr(0, base->rfind(u'/') + 1) + *relative;
}

// ---- Character sets ----

std::optional<CharacterSet> ArchiveReader::characterSet(const ArchivedValue& value) {
    if (classOf(value) != ArchivedClass::CharacterSet) return std::nullopt;
    const auto known = characterSets_.find(value.place);
    if (known != characterSets_.end()) return known->second;
    auto set = readCharacterSet(value);
    if (set && value.place != 0) characterSets_.emplace(value.place, *set);
    return set;
}

std::optional<CharacterSet> ArchiveReader::readCharacterSet(const ArchivedValue& object) {
    if (!spend(CostOfPlane)) return std::nullopt;
    const auto inverted = [this, &object](const CharacterSet& set, std::string_view key) {
        return integer(field(object, key)).value_or(0) != 0 ? set.inverted() : set;
    };
    for (const auto& [key, inversion] : {std::pair("NSBuiltinID2", "NSIsInverted2"), {"NSBuiltinID", "NSIsInverted"}}) {
        const auto number = integer(field(object, key));
        const auto set = number ? builtinCharacterSet(*number) : std::nullopt;
        if (set) return inverted(*set, inversion);
    }
    if (const auto range = integer(field(object, "NSRange"))) {
        const auto first = static_cast<std::uint64_t>(*range) >> 32;
        const auto length = static_cast<std::uint64_t>(*range) & 0xFFFFFFFF;
        const auto last = static_cast<char32_t>(std::min<std::uint64_t>(first + length, 0x110000) - 1);
        const auto set = length == 0 || first > 0x10FFFF ? CharacterSet()
                                                         : CharacterSet::withRange(static_cast<char32_t>(first), last);
        return inverted(set, "NSIsInverted");
    }
    for (const std::string_view key : {"NSString", "NSStringObject"}) {
        const auto members = string(field(object, key));
        if (members) return inverted(CharacterSet::withCharacters(*members), "NSIsInverted");
    }
    for (const std::string_view key : {"NSBitmap", "NSBitmapObject"}) {
        const auto bitmap = data(field(object, key));
        if (bitmap && spend(bitmap->size() / PlaneBytes * CostOfPlane)) return characterSetFromBitmap(*bitmap);
    }
    return std::nullopt;
}

// ---- Property lists ----

std::optional<PropertyList> ArchiveReader::propertyList(const ArchivedValue& value) {
    std::optional<PropertyList> list;
    nested([&] { list = readPropertyList(value); });
    return list;
}

std::optional<PropertyList> ArchiveReader::readPropertyList(const ArchivedValue& value) {
    if (!value || !spend(sizeof(PropertyList))) return std::nullopt;
    if (value.object.kind == Kind::Boolean) return PropertyList(booleanOf(value.object));
    if (const auto found = number(value)) {
        return std::visit([](auto any) { return PropertyList(any); }, *found);
    }
    if (auto text = string(value)) return PropertyList(*std::move(text));
    if (auto bytes = data(value)) return PropertyList(ArchivedData{*std::move(bytes)});
    if (const auto moment = date(value)) return PropertyList(*moment);
    const ArchivedClass itsClass = classOf(value);
    if (itsClass == ArchivedClass::Url) {
        auto text = address(value);
        return text ? std::optional(PropertyList(*std::move(text))) : std::nullopt;
    }
    if (itsClass == ArchivedClass::Array) {
        PropertyList::Array array;
        for (const ArchivedValue& element : elementsOf(value)) {
            if (auto list = propertyList(element)) array.push_back(*std::move(list));
        }
        return PropertyList(std::move(array));
    }
    if (itsClass != ArchivedClass::Dictionary) return std::nullopt;
    PropertyList::Dictionary dictionary;
    for (const auto& [key, element] : entriesOf(value)) {
        if (auto list = propertyList(element)) dictionary.insert_or_assign(key, *std::move(list));
    }
    return PropertyList(std::move(dictionary));
}

}  // namespace plume

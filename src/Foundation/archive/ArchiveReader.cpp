#include "Foundation/archive/ArchiveReader.h"

#include <algorithm>
#include <array>

#include "Foundation/Strings.h"
#include "Foundation/archive/PropertyListLimits.h"

namespace plume {

namespace {

using Kind = BinaryObject::Kind;

constexpr std::size_t NoKey = static_cast<std::size_t>(-1);
constexpr std::size_t CostOfKey = 8;
constexpr std::size_t MostClassesInChain = 32;

struct ClassName {
    std::string_view name;
    ArchivedClass itsClass;
};
constexpr std::array ClassNames = {
    ClassName{"NSString", ArchivedClass::String},
    ClassName{"NSData", ArchivedClass::Data},
    ClassName{"NSNumber", ArchivedClass::Number},
    ClassName{"NSDate", ArchivedClass::Time},
    ClassName{"NSArray", ArchivedClass::Array},
    ClassName{"NSSet", ArchivedClass::Array},
    ClassName{"NSOrderedSet", ArchivedClass::Array},
    ClassName{"NSDictionary", ArchivedClass::Dictionary},
    ClassName{"NSUUID", ArchivedClass::Uuid},
    ClassName{"NSURL", ArchivedClass::Url},
    ClassName{"NSCharacterSet", ArchivedClass::CharacterSet},
    ClassName{"NSAttributedString", ArchivedClass::AttributedString},
    ClassName{"NSImage", ArchivedClass::Image},
};

ArchivedClass classNamed(std::string_view name) {
    // Classes whose objects can be changed hold the same.
    constexpr std::string_view Mutable = "NSMutable";
    const std::string plain =
        name.starts_with(Mutable) ? "NS" + std::string(name.substr(Mutable.size())) : std::string(name);
    const auto found =
        std::find_if(ClassNames.begin(), ClassNames.end(), [&](const ClassName& known) { return known.name == plain; });
    return found == ClassNames.end() ? ArchivedClass::Other : found->itsClass;
}

}  // namespace

ArchiveReader::ArchiveReader(BinaryObjects objects, std::size_t size)
    : binary_(objects), left_(mostBytesMadeOf(size)) {}

Result<std::unique_ptr<ArchiveReader>> ArchiveReader::open(std::string_view bytes) {
    auto objects = BinaryObjects::open(bytes);
    if (!objects) return objects.error();
    std::unique_ptr<ArchiveReader> reader(new ArchiveReader(objects.value(), bytes.size()));
    if (auto parts = reader->findParts(); !parts) return parts.error();
    return reader;
}

Result<void> ArchiveReader::findParts() {
    const ArchivedValue archive{binary_.at(binary_.root())};
    const Error noArchive{"The property list is no keyed archive: expected a dictionary with $objects and $top."};
    if (!archive.isDictionary()) return noArchive;
    const ArchivedValue objects = field(archive, "$objects");
    const ArchivedValue top = field(archive, "$top");
    if (objects.object.kind != Kind::Array || !top.isDictionary()) return damage_.value_or(noArchive);
    objects_ = objects.object;
    root_ = field(top, "root");
    // Archives may call their outermost object otherwise.
    if (!root_ && top.object.count > 0) root_ = resolve(binary_.reference(top.object, top.object.count));
    if (damage_) return *damage_;
    if (!root_) return Error{"The keyed archive is empty: expected an object that $top refers to."};
    return {};
}

void ArchiveReader::report(std::size_t number, const std::string& expected) {
    if (damage_) return;
    const std::string place = number < binary_.count() ? " at byte " + std::to_string(binary_.offsetOf(number)) : "";
    damage_ = Error{"The keyed archive is damaged" + place + ": expected " + expected + "."};
}

bool ArchiveReader::spend(std::size_t cost) {
    if (damage_) return false;
    if (cost <= left_) {
        left_ -= cost;
        return true;
    }
    report(binary_.count(), "objects that refer less often to the same ones");
    return false;
}

// ---- Parts of objects ----

ArchivedValue ArchiveReader::resolve(std::size_t number) {
    if (damage_) return {};
    if (number >= binary_.count()) {
        report(binary_.count(), "references to values that there are, not to number " + std::to_string(number));
        return {};
    }
    const BinaryObject value = binary_.at(number);
    if (value.kind != Kind::Uid) return {value, 0};
    const std::uint64_t place = bigEndianNumber(value.bytes);
    if (place == 0) return {};
    if (place >= objects_.count) {
        report(number,
               "a reference to one of " + std::to_string(objects_.count) + " objects, not to " + std::to_string(place));
        return {};
    }
    const std::size_t object = binary_.reference(objects_, place);
    if (object >= binary_.count()) {
        report(number, "a reference to an object that there is, not to " + std::to_string(object));
        return {};
    }
    return {binary_.at(object), static_cast<std::size_t>(place)};
}

std::size_t ArchiveReader::findKey(const BinaryObject& dictionary, std::string_view key, std::size_t from) {
    for (std::size_t i = 0; i < dictionary.count; ++i) {
        const std::size_t place = from + i < dictionary.count ? from + i : from + i - dictionary.count;
        const std::size_t number = binary_.reference(dictionary, place);
        if (number >= binary_.count()) {
            report(binary_.count(), "keys that there are, not value " + std::to_string(number));
            return NoKey;
        }
        if (!spend(CostOfKey)) return NoKey;
        if (isString(binary_.at(number), key)) return place;
    }
    return NoKey;
}

ArchivedValue ArchiveReader::field(const ArchivedValue& object, std::string_view key) {
    std::size_t place = 0;
    return field(object, key, place);
}

ArchivedValue ArchiveReader::field(const ArchivedValue& object, std::string_view key, std::size_t& place) {
    if (!object.isDictionary() || damage_) return {};
    const std::size_t found = findKey(object.object, key, place);
    if (found == NoKey) return {};
    place = found + 1 < object.object.count ? found + 1 : 0;
    return resolve(binary_.reference(object.object, object.object.count + found));
}

ArchivedClass ArchiveReader::classOf(const ArchivedValue& object) {
    const ArchivedValue description = field(object, "$class");
    if (description.place == 0) return ArchivedClass::Other;
    const auto known = classes_.find(description.place);
    if (known != classes_.end()) return known->second;
    return classes_.emplace(description.place, readClass(description)).first->second;
}

ArchivedClass ArchiveReader::readClass(const ArchivedValue& description) {
    const auto named = [this](const ArchivedValue& name) {
        return name.object.isString() && spend(name.object.count) ? classNamed(toUtf8(stringOf(name.object)))
                                                                  : ArchivedClass::Other;
    };
    const ArchivedClass own = named(field(description, "$classname"));
    if (own != ArchivedClass::Other) return own;
    for (const std::string_view key : {"$classes", "$classhints"}) {
        const BinaryObject chain = field(description, key).object;
        const std::size_t count = chain.kind == Kind::Array ? std::min(chain.count, MostClassesInChain) : 0;
        for (std::size_t i = 0; i < count; ++i) {
            const ArchivedClass parent = named(resolve(binary_.reference(chain, i)));
            if (parent != ArchivedClass::Other) return parent;
        }
    }
    return ArchivedClass::Other;
}

std::vector<ArchivedValue> ArchiveReader::numberedFields(const ArchivedValue& object, std::string_view prefix) {
    std::vector<ArchivedValue> values;
    std::size_t place = 0;
    for (;;) {
        const ArchivedValue value = field(object, std::string(prefix) + std::to_string(values.size()), place);
        if (!value) return values;
        values.push_back(value);
    }
}

std::vector<ArchivedValue> ArchiveReader::elementsOf(const ArchivedValue& array) {
    // A list may stand in an object's dictionary without an object of its own.
    const bool isBare = array.object.kind == Kind::Array;
    if (!isBare && classOf(array) != ArchivedClass::Array && classOf(array) != ArchivedClass::Dictionary) return {};
    const BinaryObject list = isBare ? array.object : field(array, "NS.objects").object;
    if (list.kind != Kind::Array) return numberedFields(array, "NS.object.");
    if (!spend(list.count * sizeof(ArchivedValue))) return {};
    std::vector<ArchivedValue> elements;
    elements.reserve(list.count);
    for (std::size_t i = 0; i < list.count; ++i) elements.push_back(resolve(binary_.reference(list, i)));
    return elements;
}

std::vector<std::pair<std::string, ArchivedValue>> ArchiveReader::entriesOf(const ArchivedValue& dictionary) {
    if (classOf(dictionary) != ArchivedClass::Dictionary) return {};
    const ArchivedValue list = field(dictionary, "NS.keys");
    const auto keys = list ? elementsOf(list) : numberedFields(dictionary, "NS.key.");
    const auto elements = elementsOf(dictionary);
    std::vector<std::pair<std::string, ArchivedValue>> entries;
    for (std::size_t i = 0; i < std::min(keys.size(), elements.size()); ++i) {
        if (const auto key = string(keys[i])) entries.emplace_back(toUtf8(*key), elements[i]);
    }
    return entries;
}

}  // namespace plume

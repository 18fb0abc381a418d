// Looks into a keyed archive: its objects, and the values that they consist of.
//
// Made for foreign bytes. What is not of the kind that is asked for reads as nothing. Damage is remembered: from then
// on everything reads as nothing, and damage() says what is wrong. What is read counts against a limit that follows
// from the archive's size, because objects may be referred to any number of times. One of these, one thread.
#pragma once

#include <any>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <utility>
#include <variant>
#include <vector>

#include "Foundation/CharacterSet.h"
#include "Foundation/Date.h"
#include "Foundation/Result.h"
#include "Foundation/archive/BinaryObjects.h"
#include "Foundation/archive/PropertyList.h"

namespace plume {

enum class ArchivedClass {
    Other,
    String,
    Data,
    Number,
    Time,
    Array,
    Dictionary,
    Uuid,
    Url,
    CharacterSet,
    AttributedString,
    Image
};

// A value, or the object that a value refers to; of kind Null when there is none.
struct ArchivedValue {
    BinaryObject object;
    std::size_t place = 0;  // in the archive's list of objects; 0 for a value that stands inline

    explicit operator bool() const { return object.kind != BinaryObject::Kind::Null; }
    bool isDictionary() const { return object.kind == BinaryObject::Kind::Dictionary; }
};

class ArchiveReader {
  public:
    // Of a binary archive, which outlives this.
    static Result<std::unique_ptr<ArchiveReader>> open(std::string_view bytes);

    ArchivedValue root() { return root_; }
    const std::optional<Error>& damage() const { return damage_; }

    // ---- Parts of objects ----
    ArchivedValue field(const ArchivedValue& object, std::string_view key);
    // The same, looking first behind the place where the last one was found.
    ArchivedValue field(const ArchivedValue& object, std::string_view key, std::size_t& place);
    // The class, or the first known one that it descends from.
    ArchivedClass classOf(const ArchivedValue& object);
    // Of arrays and sets.
    std::vector<ArchivedValue> elementsOf(const ArchivedValue& array);
    // Of a dictionary, its keys as UTF-8.
    std::vector<std::pair<std::string, ArchivedValue>> entriesOf(const ArchivedValue& dictionary);

    // ---- What values hold ----
    std::optional<std::u16string> string(const ArchivedValue& value);
    std::optional<std::string> data(const ArchivedValue& value);
    // A boolean or integer as an integer, a real as what it is.
    std::optional<std::variant<std::int64_t, double>> number(const ArchivedValue& value);
    std::optional<std::int64_t> integer(const ArchivedValue& value);
    std::optional<double> real(const ArchivedValue& value);
    std::optional<Date> date(const ArchivedValue& value);
    std::optional<std::u16string> address(const ArchivedValue& url);
    std::optional<CharacterSet> characterSet(const ArchivedValue& value);
    std::optional<PropertyList> propertyList(const ArchivedValue& value);

    // ---- For one pass over the archive ----
    // What was made of the object, kept for when it is met again.
    std::any& made(const ArchivedValue& object) { return made_[object.place]; }
    // False when what was read has become too much.
    bool spend(std::size_t cost);
    // Runs `read` unless objects stand too deep in each other.
    template <typename Read>
    void nested(Read&& read) {
        if (depth_ >= Deepest) return;
        ++depth_;
        read();
        --depth_;
    }

  private:
    static constexpr std::size_t Deepest = 128;

    ArchiveReader(BinaryObjects objects, std::size_t size);
    Result<void> findParts();
    ArchivedValue resolve(std::size_t number);
    std::size_t findKey(const BinaryObject& dictionary, std::string_view key, std::size_t from);
    std::vector<ArchivedValue> numberedFields(const ArchivedValue& object, std::string_view prefix);
    ArchivedClass readClass(const ArchivedValue& description);
    std::optional<CharacterSet> readCharacterSet(const ArchivedValue& object);
    std::optional<PropertyList> readPropertyList(const ArchivedValue& value);
    void report(std::size_t number, const std::string& expected);

    BinaryObjects binary_;
    std::size_t left_;
    std::size_t depth_ = 0;
    BinaryObject objects_;  // the archive's list
    ArchivedValue root_;
    std::optional<Error> damage_;
    std::unordered_map<std::size_t, ArchivedClass> classes_;
    std::unordered_map<std::size_t, CharacterSet> characterSets_;
    std::unordered_map<std::size_t, std::any> made_;
};

}  // namespace plume

// The values that property lists are made of: what settings hold, and what archives are written in.
//
// Plain values; copies are independent. May be used from any thread.
#pragma once

#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <variant>
#include <vector>

#include "Foundation/Date.h"

namespace plume {

// Raw bytes.
struct ArchivedData {
    std::string bytes;
    bool operator==(const ArchivedData&) const = default;
};

struct PropertyList {
    using Array = std::vector<PropertyList>;
    // Keys are UTF-8.
    using Dictionary = std::map<std::string, PropertyList, std::less<>>;
    // A reference to another object of a keyed archive.
    struct Uid {
        std::uint64_t number = 0;
        bool operator==(const Uid&) const = default;
    };
    using Value = std::variant<bool, std::int64_t, double, std::u16string, Date, ArchivedData, Array, Dictionary, Uid>;

    PropertyList() : value(Dictionary()) {}
    // Never stands in for the copy: no value is made from a PropertyList.
    template <typename Type>
    // NOLINTNEXTLINE(bugprone-forwarding-reference-overload)
    requires std::is_constructible_v<Value, Type&&> PropertyList(Type&& of) : value(std::forward<Type>(of)) {}

    // Null when the value is of another kind.
    template <typename Type>
    const Type* as() const {
        return std::get_if<Type>(&value);
    }
    // A value of a dictionary; null when there is no such key, or this is no dictionary.
    const PropertyList* find(std::string_view key) const {
        const auto* entries = as<Dictionary>();
        if (!entries) return nullptr;
        const auto found = entries->find(key);
        return found == entries->end() ? nullptr : &found->second;
    }
    // The same, when it is of this kind.
    template <typename Type>
    const Type* find(std::string_view key) const {
        const PropertyList* found = find(key);
        return found ? found->as<Type>() : nullptr;
    }

    bool operator==(const PropertyList&) const = default;

    Value value;
};

}  // namespace plume

// The objects of a typed stream, whatever their classes are: every object says of which types its values are.
//
// Made for foreign bytes: bounded in depth, time and memory. A stream that is damaged gives the objects, and of the
// last ones the values, that stand before the damage. Strings point into the bytes. Pure; from any thread.
#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string_view>
#include <variant>
#include <vector>

#include "Foundation/Result.h"

namespace plume {

// An object by its number; nothing for nil.
struct TypedStreamReference {
    std::optional<std::size_t> object;
};

// Text and bytes are both kept as bytes.
using TypedStreamValue = std::variant<std::int64_t, double, std::string_view, TypedStreamReference>;

// Classes and C strings are numbered among the objects: the former have a name, the latter one value.
struct TypedStreamObject {
    std::string_view className;           // of a class: its own name
    std::optional<std::size_t> itsClass;  // of a class: the class above it
    std::vector<TypedStreamValue> values;
};

struct TypedStreamObjects {
    std::vector<TypedStreamObject> objects;
    std::optional<std::size_t> root;  // the first object of the stream
    std::optional<Error> damage;

    // Whether the object is of this class or of one below it.
    bool isA(std::size_t object, std::string_view className) const;
};

// The bytes outlive what is returned.
TypedStreamObjects readTypedStream(std::string_view bytes);

}  // namespace plume

// The objects of a binary property list, looked at where they lie in its bytes.
//
// Made for foreign bytes: nothing outside of them is read, and nothing is allocated by a number that stands in them.
// Objects may refer to each other in circles; whoever follows references has to look out for that. Pure; from any
// thread.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <variant>

#include "Foundation/Result.h"

namespace plume {

struct BinaryObject {
    enum class Kind { Null, Boolean, Integer, Real, Time, Data, Ascii, Utf16, Uid, Array, Dictionary };

    Kind kind = Kind::Null;
    std::string_view bytes;  // a boolean's marker, a container's references, else the value
    std::size_t count = 0;   // elements of an array, pairs of a dictionary, units of a string

    bool isString() const { return kind == Kind::Ascii || kind == Kind::Utf16; }
};

class BinaryObjects {
  public:
    static bool isBinary(std::string_view bytes) { return bytes.starts_with("bplist0"); }
    // The bytes outlive this. That every object lies within them is checked here, what objects refer to is not.
    static Result<BinaryObjects> open(std::string_view bytes);

    std::size_t count() const { return count_; }
    std::size_t root() const { return root_; }
    // For an index below count().
    BinaryObject at(std::size_t index) const;
    std::size_t offsetOf(std::size_t index) const;
    // Element `i` of an array; of a dictionary the keys come first, then the values. May be count() or more.
    std::size_t reference(const BinaryObject& container, std::size_t i) const;

  private:
    BinaryObjects() = default;
    bool readTrailer();
    // What was expected where an object is no object; null when it is one.
    const char* parse(std::size_t offset, BinaryObject& object) const;
    const char* parseSized(std::size_t offset, unsigned low, BinaryObject::Kind kind, std::size_t unitSize,
                           BinaryObject& object) const;

    std::string_view bytes_;
    std::size_t count_ = 0;
    std::size_t root_ = 0;
    std::size_t offsetSize_ = 1;
    std::size_t referenceSize_ = 1;
    std::size_t table_ = 0;  // where the offsets begin, and the objects end
};

// ---- What scalars hold ----

std::uint64_t bigEndianNumber(std::string_view bytes);
bool booleanOf(const BinaryObject& boolean);
// A number too large for an integer comes as a real.
std::variant<std::int64_t, double> numberOf(const BinaryObject& integer);
// Of reals and of dates.
double realOf(const BinaryObject& real);
std::u16string stringOf(const BinaryObject& string);
// Whether an object is this string of ASCII.
bool isString(const BinaryObject& object, std::string_view ascii);

}  // namespace plume

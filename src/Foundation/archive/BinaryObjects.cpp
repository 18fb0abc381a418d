#include "Foundation/archive/BinaryObjects.h"

#include <bit>

namespace plume {

namespace {

constexpr std::size_t HeaderSize = 8;
constexpr std::size_t TrailerSize = 32;
constexpr std::size_t LargestNumberSize = 8;
constexpr std::size_t LargeIntegerSize = 16;

// The upper four bits of an object's first byte.
enum Marker : unsigned {
    Constant = 0x0,
    Integer = 0x1,
    Real = 0x2,
    DateMarker = 0x3,
    Data = 0x4,
    Ascii = 0x5,
    Utf16 = 0x6,
    Uid = 0x8,
    Array = 0xA,
    OrderedSet = 0xB,
    Set = 0xC,
    Dictionary = 0xD
};
constexpr unsigned False = 0x8;
constexpr unsigned True = 0x9;
// In place of a count: a count that is an integer object of its own follows.
constexpr unsigned CountFollows = 0xF;

Error damaged(std::size_t offset, const std::string& expected) {
    return Error{"The binary property list is damaged at byte " + std::to_string(offset) + ": expected " + expected +
                 "."};
}

}  // namespace

Result<BinaryObjects> BinaryObjects::open(std::string_view bytes) {
    BinaryObjects objects;
    objects.bytes_ = bytes;
    if (!isBinary(bytes) || bytes.size() < HeaderSize + TrailerSize) {
        return damaged(0, "\"bplist00\" and a trailer of 32 bytes at the end");
    }
    if (!objects.readTrailer()) {
        return damaged(bytes.size() - TrailerSize, "a trailer whose table of objects lies within the bytes");
    }
    for (std::size_t i = 0; i < objects.count_; ++i) {
        BinaryObject object;
        const std::size_t offset = objects.offsetOf(i);
        if (const char* expected = objects.parse(offset, object)) {
            return damaged(offset, std::string(expected) + " as object " + std::to_string(i));
        }
    }
    return objects;
}

bool BinaryObjects::readTrailer() {
    const std::string_view trailer = bytes_.substr(bytes_.size() - TrailerSize);
    const std::size_t end = bytes_.size() - TrailerSize;
    offsetSize_ = static_cast<unsigned char>(trailer[6]);
    referenceSize_ = static_cast<unsigned char>(trailer[7]);
    count_ = bigEndianNumber(trailer.substr(8, 8));
    root_ = bigEndianNumber(trailer.substr(16, 8));
    table_ = bigEndianNumber(trailer.substr(24, 8));
    if (offsetSize_ == 0 || offsetSize_ > LargestNumberSize) return false;
    if (referenceSize_ == 0 || referenceSize_ > LargestNumberSize) return false;
    if (table_ < HeaderSize || table_ > end) return false;
    return root_ < count_ && count_ <= (end - table_) / offsetSize_;
}

std::size_t BinaryObjects::offsetOf(std::size_t index) const {
    return bigEndianNumber(bytes_.substr(table_ + index * offsetSize_, offsetSize_));
}

BinaryObject BinaryObjects::at(std::size_t index) const {
    BinaryObject object;
    parse(offsetOf(index), object);
    return object;
}

std::size_t BinaryObjects::reference(const BinaryObject& container, std::size_t i) const {
    return bigEndianNumber(container.bytes.substr(i * referenceSize_, referenceSize_));
}

const char* BinaryObjects::parse(std::size_t offset, BinaryObject& object) const {
    using Kind = BinaryObject::Kind;
    if (offset < HeaderSize || offset >= table_) return "an offset of an object before the table";
    const auto first = static_cast<unsigned char>(bytes_[offset]);
    const unsigned low = first & 0xFU;
    std::size_t size = 0;
    switch (first >> 4) {
        case Constant:
            if (low != 0 && low != False && low != True) return "a known kind of object";
            object = {low == 0 ? Kind::Null : Kind::Boolean, bytes_.substr(offset, 1), 1};
            return nullptr;
        case Integer:
            size = std::size_t{1} << low;
            break;
        case Real:
        case DateMarker:
            size = std::size_t{1} << low;
            break;
        case Uid:
            size = low + 1;
            break;
        case Data:
            return parseSized(offset, low, Kind::Data, 1, object);
        case Ascii:
            return parseSized(offset, low, Kind::Ascii, 1, object);
        case Utf16:
            return parseSized(offset, low, Kind::Utf16, 2, object);
        case Array:
        case OrderedSet:
        case Set:
            return parseSized(offset, low, Kind::Array, referenceSize_, object);
        case Dictionary:
            return parseSized(offset, low, Kind::Dictionary, 2 * referenceSize_, object);
        default:
            return "a known kind of object";
    }
    const unsigned marker = first >> 4;
    const bool isReal = marker == Real || marker == DateMarker;
    if (isReal && size != sizeof(float) && size != sizeof(double)) return "a real number of 4 or 8 bytes";
    if (size > (marker == Integer ? LargeIntegerSize : LargestNumberSize)) return "a smaller number";
    if (size > table_ - offset - 1) return "the bytes of a number";
    const Kind kind = marker == Integer ? Kind::Integer
                      : marker == Uid   ? Kind::Uid
                      : marker == Real  ? Kind::Real
                                        : Kind::Time;
    object = {kind, bytes_.substr(offset + 1, size), 1};
    return nullptr;
}

const char* BinaryObjects::parseSized(std::size_t offset, unsigned low, BinaryObject::Kind kind, std::size_t unitSize,
                                      BinaryObject& object) const {
    std::size_t start = offset + 1;
    std::uint64_t count = low;
    if (low == CountFollows) {
        if (start == table_) return "a count";
        const auto marker = static_cast<unsigned char>(bytes_[start]);
        const std::size_t size = std::size_t{1} << (marker & 0xFU);
        if (marker >> 4 != Integer || size > LargestNumberSize || size > table_ - start - 1) return "a count";
        count = bigEndianNumber(bytes_.substr(start + 1, size));
        start += 1 + size;
    }
    if (count > (table_ - start) / unitSize) return "as many bytes as the count says";
    object = {kind, bytes_.substr(start, count * unitSize), count};
    return nullptr;
}

std::uint64_t bigEndianNumber(std::string_view bytes) {
    std::uint64_t number = 0;
    for (const char byte : bytes) number = number << 8 | static_cast<unsigned char>(byte);
    return number;
}

bool booleanOf(const BinaryObject& boolean) {
    return (static_cast<unsigned char>(boolean.bytes[0]) & 0xFU) == True;
}

std::variant<std::int64_t, double> numberOf(const BinaryObject& integer) {
    const std::string_view bytes = integer.bytes;
    if (bytes.size() <= LargestNumberSize) return static_cast<std::int64_t>(bigEndianNumber(bytes));
    const auto high = static_cast<std::int64_t>(bigEndianNumber(bytes.substr(0, LargestNumberSize)));
    const std::uint64_t low = bigEndianNumber(bytes.substr(LargestNumberSize));
    // The upper half repeats the sign of a number that fits the lower one.
    if (high == static_cast<std::int64_t>(low) >> 63) return static_cast<std::int64_t>(low);
    constexpr double HalfRange = 18446744073709551616.0;
    return static_cast<double>(high) * HalfRange + static_cast<double>(low);
}

double realOf(const BinaryObject& real) {
    const std::uint64_t bits = bigEndianNumber(real.bytes);
    if (real.bytes.size() == sizeof(float)) return std::bit_cast<float>(static_cast<std::uint32_t>(bits));
    return std::bit_cast<double>(bits);
}

std::u16string stringOf(const BinaryObject& string) {
    std::u16string text(string.count, u'\0');
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (string.kind == BinaryObject::Kind::Ascii) {
            text[i] = static_cast<unsigned char>(string.bytes[i]);
        } else {
            text[i] = static_cast<char16_t>(static_cast<unsigned char>(string.bytes[2 * i]) << 8 |
                                            static_cast<unsigned char>(string.bytes[2 * i + 1]));
        }
    }
    return text;
}

bool isString(const BinaryObject& object, std::string_view ascii) {
    if (!object.isString() || object.count != ascii.size()) return false;
    if (object.kind == BinaryObject::Kind::Ascii) return object.bytes == ascii;
    return stringOf(object) == std::u16string(ascii.begin(), ascii.end());
}

}  // namespace plume

#include "Foundation/archive/BinaryObjectWriter.h"

#include <bit>
#include <functional>
#include <limits>

namespace plume {

namespace {

constexpr std::string_view Signature = "bplist00";
constexpr std::size_t StoredReferenceSize = 4;

constexpr unsigned False = 0x08;
constexpr unsigned True = 0x09;
constexpr unsigned Integer = 0x10;
constexpr unsigned Real = 0x20;
constexpr unsigned DateMarker = 0x30;
constexpr unsigned Data = 0x40;
constexpr unsigned Ascii = 0x50;
constexpr unsigned Utf16 = 0x60;
constexpr unsigned Uid = 0x80;
constexpr unsigned Array = 0xA0;
constexpr unsigned Dictionary = 0xD0;
constexpr unsigned EightBytes = 3;      // as a power of two
constexpr unsigned CountFollows = 0xF;  // in place of the count

// How many bytes a number takes: 1, 2, 4 or 8.
std::size_t sizeOf(std::uint64_t number) {
    if (number <= std::numeric_limits<std::uint8_t>::max()) return 1;
    if (number <= std::numeric_limits<std::uint16_t>::max()) return 2;
    return number <= std::numeric_limits<std::uint32_t>::max() ? 4 : 8;
}

void appendNumber(std::string& bytes, std::uint64_t number, std::size_t size) {
    for (std::size_t i = size; i-- > 0;) bytes.push_back(static_cast<char>(number >> (8 * i) & 0xFF));
}

std::uint64_t numberAt(std::string_view bytes, std::size_t position, std::size_t size) {
    std::uint64_t number = 0;
    for (const char byte : bytes.substr(position, size)) number = number << 8 | static_cast<unsigned char>(byte);
    return number;
}

bool isAscii(std::u16string_view text) {
    char16_t all = 0;
    for (const char16_t unit : text) all |= unit;
    return all < 0x80;
}

}  // namespace

BinaryObjectWriter::BinaryObjectWriter() : table_(1024) {}

void BinaryObjectWriter::putNumber(std::uint64_t number, std::size_t size) {
    appendNumber(objects_, number, size);
}

void BinaryObjectWriter::putCount(unsigned marker, std::size_t count) {
    if (count < CountFollows) return put(marker | static_cast<unsigned>(count));
    put(marker | CountFollows);
    const std::size_t size = sizeOf(count);
    put(Integer | static_cast<unsigned>(std::countr_zero(size)));
    putNumber(count, size);
}

void BinaryObjectWriter::putReal(unsigned marker, double value) {
    put(marker | EightBytes);
    putNumber(std::bit_cast<std::uint64_t>(value), sizeof(value));
}

BinaryObjectWriter::Number BinaryObjectWriter::boolean(bool value) {
    begin();
    put(value ? True : False);
    return end();
}

BinaryObjectWriter::Number BinaryObjectWriter::integer(std::int64_t value) {
    begin();
    const auto bits = static_cast<std::uint64_t>(value);
    const std::size_t size = sizeOf(bits);  // eight bytes for negative ones, which are the only ones with a sign
    put(Integer | static_cast<unsigned>(std::countr_zero(size)));
    putNumber(bits, size);
    return end();
}

BinaryObjectWriter::Number BinaryObjectWriter::real(double value) {
    begin();
    putReal(Real, value);
    return end();
}

BinaryObjectWriter::Number BinaryObjectWriter::date(double seconds) {
    begin();
    putReal(DateMarker, seconds);
    return end();
}

BinaryObjectWriter::Number BinaryObjectWriter::data(std::string_view bytes) {
    begin();
    putCount(Data, bytes.size());
    objects_.append(bytes);
    return end();
}

BinaryObjectWriter::Number BinaryObjectWriter::string(std::u16string_view text) {
    begin();
    const bool ascii = isAscii(text);
    putCount(ascii ? Ascii : Utf16, text.size());
    for (const char16_t unit : text) {
        if (!ascii) put(unit >> 8 & 0xFFU);
        put(unit & 0xFFU);
    }
    return end();
}

BinaryObjectWriter::Number BinaryObjectWriter::ascii(std::string_view text) {
    begin();
    putCount(Ascii, text.size());
    objects_.append(text);
    return end();
}

BinaryObjectWriter::Number BinaryObjectWriter::uid(std::uint64_t uid) {
    begin();
    const std::size_t size = sizeOf(uid);
    put(Uid | static_cast<unsigned>(size - 1));
    putNumber(uid, size);
    return end();
}

BinaryObjectWriter::Number BinaryObjectWriter::array(const std::vector<Number>& elements) {
    begin();
    putCount(Array, elements.size());
    for (const Number element : elements) putNumber(element, StoredReferenceSize);
    return end();
}

BinaryObjectWriter::Number BinaryObjectWriter::dictionary(const Entry* entries, std::size_t count) {
    begin();
    putCount(Dictionary, count);
    for (std::size_t i = 0; i < count; ++i) putNumber(entries[i].first, StoredReferenceSize);
    for (std::size_t i = 0; i < count; ++i) putNumber(entries[i].second, StoredReferenceSize);
    return end();
}

// The object that was put since begin(), or the equal one from before in its place.
BinaryObjectWriter::Number BinaryObjectWriter::end() {
    const std::string_view object = std::string_view(objects_).substr(start_);
    const auto hash = static_cast<std::uint32_t>(std::hash<std::string_view>()(object));
    std::size_t place = hash & (table_.size() - 1);
    for (; table_[place] != 0; place = (place + 1) & (table_.size() - 1)) {
        const Number number = table_[place] - 1;
        if (hashes_[number] != hash) continue;
        const std::size_t start = starts_[number];
        const std::size_t end = number + 1 < starts_.size() ? starts_[number + 1] : start_;
        if (std::string_view(objects_).substr(start, end - start) != object) continue;
        objects_.resize(start_);
        return number;
    }
    starts_.push_back(start_);
    hashes_.push_back(hash);
    table_[place] = static_cast<Number>(starts_.size());
    if (starts_.size() * 2 > table_.size()) grow();
    return static_cast<Number>(starts_.size() - 1);
}

void BinaryObjectWriter::grow() {
    table_.assign(table_.size() * 2, 0);
    for (Number number = 0; number < hashes_.size(); ++number) {
        std::size_t place = hashes_[number] & (table_.size() - 1);
        while (table_[place] != 0) place = (place + 1) & (table_.size() - 1);
        table_[place] = number + 1;
    }
}

void BinaryObjectWriter::appendObject(std::string& bytes, std::size_t index, std::size_t referenceSize) const {
    const std::size_t start = starts_[index];
    const std::size_t end = index + 1 < starts_.size() ? starts_[index + 1] : objects_.size();
    const auto marker = static_cast<unsigned char>(objects_[start]);
    const bool isContainer = (marker & 0xF0U) == Array || (marker & 0xF0U) == Dictionary;
    if (!isContainer || referenceSize == StoredReferenceSize) {
        bytes.append(objects_, start, end - start);
        return;
    }
    std::size_t head = 1;
    if ((marker & 0xFU) == CountFollows) {
        head += 1 + (std::size_t{1} << (static_cast<unsigned char>(objects_[start + 1]) & 0xFU));
    }
    bytes.append(objects_, start, head);
    for (std::size_t i = start + head; i < end; i += StoredReferenceSize) {
        appendNumber(bytes, numberAt(objects_, i, StoredReferenceSize), referenceSize);
    }
}

std::string BinaryObjectWriter::finish(Number root) const {
    const std::size_t referenceSize = sizeOf(starts_.size());
    std::string bytes(Signature);
    bytes.reserve(objects_.size() + StoredReferenceSize * starts_.size() + 64);
    std::vector<std::size_t> offsets;
    offsets.reserve(starts_.size());
    for (std::size_t i = 0; i < starts_.size(); ++i) {
        offsets.push_back(bytes.size());
        appendObject(bytes, i, referenceSize);
    }
    const std::size_t table = bytes.size();
    const std::size_t offsetSize = sizeOf(table);
    for (const std::size_t offset : offsets) appendNumber(bytes, offset, offsetSize);
    bytes.append(6, '\0');
    appendNumber(bytes, offsetSize, 1);
    appendNumber(bytes, referenceSize, 1);
    for (const std::uint64_t number : {std::uint64_t{starts_.size()}, std::uint64_t{root}, std::uint64_t{table}}) {
        appendNumber(bytes, number, 8);
    }
    return bytes;
}

}  // namespace plume

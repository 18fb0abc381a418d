#include "Foundation/archive/TypedStreamObjects.h"

#include <algorithm>
#include <bit>
#include <charconv>
#include <string>
#include <utility>

namespace plume {

namespace {

// Bytes that begin something else than a number of one byte.
constexpr unsigned char Int16Head = 0x81;
constexpr unsigned char Int32Head = 0x82;
constexpr unsigned char RealHead = 0x83;
constexpr unsigned char NewHead = 0x84;
constexpr unsigned char NilHead = 0x85;
constexpr unsigned char EndHead = 0x86;
constexpr unsigned char Int64Head = 0x87;
// The number that refers to the first object or string.
constexpr std::int64_t FirstReference = -110;

constexpr unsigned char StreamVersion = 4;
constexpr std::size_t Deepest = 64;
constexpr int MostClassesInChain = 32;
// Of the name of a structure, or of the type of an array's values.
constexpr std::size_t LongestName = 256;

class StreamReader {
  public:
    explicit StreamReader(std::string_view bytes) : bytes_(bytes) {}

    TypedStreamObjects read() {
        const bool whole = readHeader() && readRoot();
        if (!whole) {
            result_.damage = Error{"The typed stream is damaged at byte " + std::to_string(position_) + ": expected " +
                                   expected_ + "."};
        }
        return std::move(result_);
    }

  private:
    using Values = std::vector<TypedStreamValue>;

    bool fails(const char* expected) {
        if (expected_.empty()) expected_ = expected;
        return false;
    }

    // ---- Bytes and numbers ----

    bool readByte(unsigned char& byte) {
        if (position_ == bytes_.size()) return fails("more bytes");
        byte = static_cast<unsigned char>(bytes_[position_++]);
        return true;
    }
    bool takeHead(unsigned char head) {
        if (position_ == bytes_.size() || static_cast<unsigned char>(bytes_[position_]) != head) return false;
        ++position_;
        return true;
    }
    bool readBytes(std::uint64_t count, std::string_view& bytes) {
        if (count > bytes_.size() - position_) return fails("as many bytes as the length before says");
        bytes = bytes_.substr(position_, count);
        position_ += count;
        return true;
    }
    bool readFixed(std::size_t size, std::uint64_t& number) {
        std::string_view bytes;
        if (!readBytes(size, bytes)) return false;
        number = 0;
        for (std::size_t i = 0; i < size; ++i) {
            number = number << 8 | static_cast<unsigned char>(bytes[bigEndian_ ? i : size - 1 - i]);
        }
        return true;
    }
    bool readInteger(std::int64_t& number) {
        unsigned char head = 0;
        if (!readByte(head)) return false;
        std::uint64_t bits = 0;
        if (head == Int16Head) {
            if (!readFixed(2, bits)) return false;
            number = static_cast<std::int16_t>(bits);
        } else if (head == Int32Head) {
            if (!readFixed(4, bits)) return false;
            number = static_cast<std::int32_t>(bits);
        } else if (head == Int64Head) {
            if (!readFixed(8, bits)) return false;
            number = static_cast<std::int64_t>(bits);
        } else if (head >= RealHead && head <= EndHead) {
            return fails("a number before this byte");
        } else {
            number = head < 0x80 ? head : head - 0x100;
        }
        return true;
    }
    // Lengths have no sign: where they take two or four bytes, they use all of them.
    bool readLength(std::uint64_t& length) {
        const bool isShort = position_ < bytes_.size() && static_cast<unsigned char>(bytes_[position_]) == Int16Head;
        std::int64_t number = 0;
        if (!readInteger(number)) return false;
        length = isShort ? static_cast<std::uint16_t>(number) : static_cast<std::uint64_t>(number);
        return true;
    }
    bool readReal(std::size_t size, Values& values) {
        if (!takeHead(RealHead)) {
            std::int64_t number = 0;
            if (!readInteger(number)) return false;
            values.emplace_back(static_cast<double>(number));
            return true;
        }
        std::uint64_t bits = 0;
        if (!readFixed(size, bits)) return false;
        values.emplace_back(size == sizeof(float) ? std::bit_cast<float>(static_cast<std::uint32_t>(bits))
                                                  : std::bit_cast<double>(bits));
        return true;
    }
    // The number of an object or string that was met before.
    bool readReference(std::size_t count, std::size_t& number) {
        std::int64_t reference = 0;
        if (!readInteger(reference)) return false;
        if (reference < FirstReference) return fails("a reference before this byte");
        // Unsigned: the largest reference and the first one are further apart than a signed number tells.
        number = static_cast<std::size_t>(reference) - static_cast<std::size_t>(FirstReference);
        return number < count || fails("a reference to what was there before");
    }

    // ---- Structure ----

    bool readHeader() {
        unsigned char version = 0;
        std::uint64_t length = 0;
        std::string_view signature;
        if (!readByte(version) || version != StreamVersion || !readLength(length) || !readBytes(length, signature)) {
            return fails("the version 4 and a signature");
        }
        bigEndian_ = signature == "typedstream";
        if (!bigEndian_ && signature != "streamtyped") return fails("the signature \"streamtyped\"");
        std::int64_t system = 0;
        return readInteger(system);
    }

    bool readRoot() {
        Values values;
        const bool whole = readGroup(values, 0);
        if (!values.empty()) {
            if (const auto* reference = std::get_if<TypedStreamReference>(&values.front()))
                result_.root = reference->object;
        }
        // A damaged root is there as far as it was read.
        if (!whole && !result_.root && firstObject_) result_.root = firstObject_;
        return whole;
    }

    // A string that is kept for later references to it; nil is an empty one.
    bool readString(std::string_view& string) {
        if (takeHead(NilHead)) {
            string = {};
            return true;
        }
        if (takeHead(NewHead)) {
            std::uint64_t length = 0;
            if (!readLength(length) || !readBytes(length, string)) return false;
            strings_.push_back(string);
            return true;
        }
        std::size_t number = 0;
        if (!readReference(strings_.size(), number)) return false;
        string = strings_[number];
        return true;
    }

    // Types, then values of these types.
    bool readGroup(Values& values, std::size_t depth) {
        std::string_view types;
        if (!readString(types)) return false;
        if (types.empty()) return fails("a type");
        while (!types.empty()) {
            if (!readValue(types, values, depth)) return false;
        }
        return true;
    }

    // Takes the type of the value from the front.
    bool readValue(std::string_view& types, Values& values, std::size_t depth) {
        if (depth > Deepest) return fails("fewer objects inside of each other");
        // Only what is empty takes no byte.
        if (++valueCount_ > bytes_.size()) return fails("fewer empty values");
        const char type = types.front();
        types.remove_prefix(1);
        switch (type) {
            case 'c':
            case 'C': {
                unsigned char byte = 0;
                if (!readByte(byte)) return false;
                values.emplace_back(std::int64_t{type == 'c' && byte >= 0x80 ? byte - 0x100 : byte});
                return true;
            }
            case 's':
            case 'S':
            case 'i':
            case 'I':
            case 'l':
            case 'L':
            case 'q':
            case 'Q': {
                std::int64_t number = 0;
                if (!readInteger(number)) return false;
                values.emplace_back(number);
                return true;
            }
            case 'f':
                return readReal(sizeof(float), values);
            case 'd':
                return readReal(sizeof(double), values);
            case '@':
                return readObject(values, depth);
            case '#':
                return readClassValue(values);
            case '*':
                return readCString(values);
            case '%':
            case ':':
            case '+':
                return readText(type, values);
            case '[':
                return readArray(types, values, depth);
            case '{':
                return readStructure(types, values, depth);
            default:
                return fails("a type that is known before this byte");
        }
    }

    bool readText(char type, Values& values) {
        std::string_view text;
        std::uint64_t length = 0;
        if (type == '+' ? !(readLength(length) && readBytes(length, text)) : !readString(text)) return false;
        values.emplace_back(text);
        return true;
    }

    bool readCString(Values& values) {
        std::string_view text;
        if (takeHead(NilHead)) {
            values.emplace_back(text);
            return true;
        }
        if (takeHead(NewHead)) {
            if (!readString(text)) return false;
            result_.objects.emplace_back().values.emplace_back(text);
        } else {
            std::size_t number = 0;
            if (!readReference(result_.objects.size(), number)) return false;
            const Values& known = result_.objects[number].values;
            const auto* string = known.size() == 1 ? std::get_if<std::string_view>(&known.front()) : nullptr;
            if (!string) return fails("a reference to a string before this byte");
            text = *string;
        }
        values.emplace_back(text);
        return true;
    }

    // "12c]": as many values of the same type; characters are plain bytes.
    bool readArray(std::string_view& types, Values& values, std::size_t depth) {
        std::size_t count = 0;
        const std::size_t digits = std::min<std::size_t>(types.size(), 10);
        const auto [end, error] = std::from_chars(types.data(), types.data() + digits, count);
        if (error != std::errc()) return fails("the length of an array in its type");
        types.remove_prefix(static_cast<std::size_t>(end - types.data()));
        if (types.starts_with("c]") || types.starts_with("C]")) {
            std::string_view bytes;
            if (!readBytes(count, bytes)) return false;
            values.emplace_back(bytes);
            types.remove_prefix(2);
            return true;
        }
        // Every value takes a byte at least, but for empty structures.
        if (count > bytes_.size() - position_) return fails("as many values as the array's type says");
        std::string_view rest = types;
        for (std::size_t i = 0; i < count; ++i) {
            rest = types;
            if (rest.empty() || !readValue(rest, values, depth + 1)) return fails("the type of an array's values");
        }
        if (count == 0) rest.remove_prefix(std::min(rest.substr(0, LongestName).find(']'), rest.size()));
        if (!rest.starts_with(']')) return fails("the end of an array's type");
        types = rest.substr(1);
        return true;
    }

    // "name=types}".
    bool readStructure(std::string_view& types, Values& values, std::size_t depth) {
        const std::size_t equals = types.substr(0, LongestName).find('=');
        if (equals == std::string_view::npos) return fails("the types of a structure");
        types.remove_prefix(equals + 1);
        if (types.starts_with('}')) return fails("a structure that is not empty");
        while (!types.starts_with('}')) {
            if (types.empty()) return fails("the end of a structure's type");
            if (!readValue(types, values, depth + 1)) return false;
        }
        types.remove_prefix(1);
        return true;
    }

    bool readClassValue(Values& values) {
        std::optional<std::size_t> itsClass;
        if (!readClass(itsClass)) return false;
        values.emplace_back(TypedStreamReference{itsClass});
        return true;
    }

    bool readObject(Values& values, std::size_t depth) {
        if (takeHead(NilHead)) {
            values.emplace_back(TypedStreamReference{});
            return true;
        }
        if (!takeHead(NewHead)) {
            std::size_t number = 0;
            if (!readReference(result_.objects.size(), number)) return false;
            values.emplace_back(TypedStreamReference{number});
            return true;
        }
        const std::size_t number = result_.objects.size();
        if (!firstObject_) firstObject_ = number;
        result_.objects.emplace_back();
        values.emplace_back(TypedStreamReference{number});
        std::optional<std::size_t> itsClass;
        if (!readClass(itsClass)) return false;
        result_.objects[number].itsClass = itsClass;
        Values own;
        bool whole = true;
        while (whole && !takeHead(EndHead)) whole = readGroup(own, depth + 1);
        result_.objects[number].values = std::move(own);
        return whole;
    }

    // A class and those above it, up to one that was met before or has none above it.
    bool readClass(std::optional<std::size_t>& itsClass) {
        std::optional<std::size_t> below;
        for (int i = 0; i < MostClassesInChain; ++i) {
            std::optional<std::size_t> next;
            const bool isNew = takeHead(NewHead);
            if (isNew) {
                TypedStreamObject description;
                std::int64_t version = 0;
                if (!readString(description.className) || !readInteger(version)) return false;
                next = result_.objects.size();
                result_.objects.push_back(std::move(description));
            } else if (!takeHead(NilHead)) {
                std::size_t number = 0;
                if (!readReference(result_.objects.size(), number)) return false;
                if (result_.objects[number].className.empty()) return fails("a reference to a class before this byte");
                next = number;
            }
            if (below) {
                result_.objects[*below].itsClass = next;
            } else {
                itsClass = next;
            }
            if (!isNew) return true;
            below = next;
        }
        return fails("fewer classes above each other");
    }

    std::string_view bytes_;
    std::size_t position_ = 0;
    bool bigEndian_ = false;
    std::vector<std::string_view> strings_;
    std::optional<std::size_t> firstObject_;
    std::size_t valueCount_ = 0;
    TypedStreamObjects result_;
    std::string expected_;
};

}  // namespace

bool TypedStreamObjects::isA(std::size_t object, std::string_view className) const {
    auto itsClass = objects[object].itsClass;
    for (int i = 0; itsClass && i < MostClassesInChain; ++i) {
        if (objects[*itsClass].className == className) return true;
        itsClass = objects[*itsClass].itsClass;
    }
    return false;
}

TypedStreamObjects readTypedStream(std::string_view bytes) {
    return StreamReader(bytes).read();
}

}  // namespace plume

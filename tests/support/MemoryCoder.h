// An archive in memory: it shows what a record writes, in which order and as which kind, and lets a test change it
// before it is read back.
#pragma once

#include <algorithm>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <type_traits>
#include <utility>
#include <variant>
#include <vector>

#include "Foundation/archive/KeyedCoding.h"

namespace plume::test {

class MemoryArchive;

// Objects are kept as what they are, whichever operation wrote them, as a real archive does.
using MemoryValue = std::variant<std::int64_t, bool, std::u16string, Date, CharacterSet, std::vector<std::u16string>,
                                 ArchivedData, AttributedString, std::vector<MemoryArchive>>;

// The values of one record.
class MemoryArchive {
  public:
    struct Entry;

    explicit MemoryArchive(std::string className = "");

    const std::string& className() const { return className_; }
    const MemoryValue* find(std::string_view key) const;
    // Replaces the value, or appends one under a new key.
    MemoryArchive& set(std::string_view key, MemoryValue value);
    MemoryArchive& remove(std::string_view key);

    // The keys in the order of writing, each with its kind: "Name:string".
    std::vector<std::string> keysAndKinds() const;

    bool operator==(const MemoryArchive& other) const;

  private:
    std::string className_;
    std::vector<Entry> entries_;
};

struct MemoryArchive::Entry {
    std::string key;
    MemoryValue value;

    bool operator==(const Entry&) const = default;
};

inline MemoryArchive::MemoryArchive(std::string className) : className_(std::move(className)) {}

inline bool MemoryArchive::operator==(const MemoryArchive& other) const {
    return className_ == other.className_ && entries_ == other.entries_;
}

inline const MemoryValue* MemoryArchive::find(std::string_view key) const {
    const auto found = std::find_if(entries_.begin(), entries_.end(), [&](const Entry& e) { return e.key == key; });
    return found == entries_.end() ? nullptr : &found->value;
}

inline MemoryArchive& MemoryArchive::set(std::string_view key, MemoryValue value) {
    const auto found = std::find_if(entries_.begin(), entries_.end(), [&](const Entry& e) { return e.key == key; });
    if (found == entries_.end()) {
        entries_.push_back({std::string(key), std::move(value)});
    } else {
        found->value = std::move(value);
    }
    return *this;
}

inline MemoryArchive& MemoryArchive::remove(std::string_view key) {
    std::erase_if(entries_, [&](const Entry& e) { return e.key == key; });
    return *this;
}

inline std::vector<std::string> MemoryArchive::keysAndKinds() const {
    static constexpr const char* Kinds[] = {"integer", "bool", "string",     "date",   "characterSet",
                                            "strings", "data", "attributed", "objects"};
    std::vector<std::string> result;
    for (const Entry& entry : entries_) result.push_back(entry.key + ":" + Kinds[entry.value.index()]);
    return result;
}

class MemoryEncoder final : public KeyedEncoder {
  public:
    static MemoryArchive encode(const KeyedCodable& record) {
        MemoryArchive archive{std::string(record.archiveClassName())};
        MemoryEncoder encoder(archive);
        record.encodeWithCoder(encoder);
        return archive;
    }

    void encodeInteger(std::string_view key, std::int64_t value) override { archive_.set(key, value); }
    void encodeBool(std::string_view key, bool value) override { archive_.set(key, value); }
    void encodeString(std::string_view key, const std::optional<std::u16string>& value) override { put(key, value); }
    void encodeDate(std::string_view key, const std::optional<Date>& value) override { put(key, value); }
    void encodeCharacterSet(std::string_view key, const std::optional<CharacterSet>& value) override {
        put(key, value);
    }
    void encodeStrings(std::string_view key, const std::optional<std::vector<std::u16string>>& value) override {
        put(key, value);
    }
    void encodeContent(std::string_view key, const ArchivedContent& value) override {
        std::visit(
            [&](const auto& content) {
                if constexpr (!std::is_same_v<std::decay_t<decltype(content)>, std::monostate>) {
                    archive_.set(key, content);
                }
            },
            value);
    }
    void encodeObjects(std::string_view key, const std::vector<const KeyedCodable*>& values) override {
        std::vector<MemoryArchive> objects;
        for (const KeyedCodable* value : values) objects.push_back(encode(*value));
        archive_.set(key, std::move(objects));
    }

  private:
    explicit MemoryEncoder(MemoryArchive& archive) : archive_(archive) {}

    template <typename Value>
    void put(std::string_view key, const std::optional<Value>& value) {
        if (value) archive_.set(key, *value);
    }

    MemoryArchive& archive_;
};

class MemoryDecoder final : public KeyedDecoder {
  public:
    // The archive must outlive the decoder.
    explicit MemoryDecoder(const MemoryArchive& archive) : archive_(archive) {}

    bool containsValueForKey(std::string_view key) const override { return archive_.find(key) != nullptr; }
    std::int64_t decodeInteger(std::string_view key) const override { return get<std::int64_t>(key).value_or(0); }
    bool decodeBool(std::string_view key) const override { return get<bool>(key).value_or(false); }
    std::optional<std::u16string> decodeString(std::string_view key) const override { return get<std::u16string>(key); }
    std::optional<Date> decodeDate(std::string_view key) const override { return get<Date>(key); }
    std::optional<CharacterSet> decodeCharacterSet(std::string_view key) const override {
        return get<CharacterSet>(key);
    }
    std::optional<std::vector<std::u16string>> decodeStrings(std::string_view key) const override {
        return get<std::vector<std::u16string>>(key);
    }
    ArchivedContent decodeContent(std::string_view key) const override {
        if (auto text = get<std::u16string>(key)) return *std::move(text);
        if (auto data = get<ArchivedData>(key)) return *std::move(data);
        if (auto attributed = get<AttributedString>(key)) return *std::move(attributed);
        return std::monostate();
    }
    bool decodeObjects(std::string_view key, const std::function<void(KeyedDecoder&)>& receive) const override {
        const auto objects = get<std::vector<MemoryArchive>>(key);
        if (!objects) return false;
        for (const MemoryArchive& object : *objects) {
            MemoryDecoder decoder(object);
            receive(decoder);
        }
        return true;
    }

  private:
    template <typename Value>
    std::optional<Value> get(std::string_view key) const {
        const MemoryValue* value = archive_.find(key);
        if (!value || !std::holds_alternative<Value>(*value)) return std::nullopt;
        return std::get<Value>(*value);
    }

    const MemoryArchive& archive_;
};

}  // namespace plume::test

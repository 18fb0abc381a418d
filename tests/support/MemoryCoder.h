// An archive in memory: it shows what a record writes, in which order and as which kind, and lets a test change it
// before it is read back.
#pragma once

#include <algorithm>
#include <any>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <variant>
#include <vector>

#include "Foundation/archive/KeyedCoding.h"

namespace plume::test {

struct MemoryArchive;

// Objects are kept as what they are, whichever operation wrote them, as a real archive does.
using MemoryValue =
    std::variant<std::monostate, std::int64_t, bool, std::u16string, Date, CharacterSet, std::vector<std::u16string>,
                 ArchivedData, AttributedString, std::vector<MemoryArchive>, PropertyList>;

// The values of one record.
struct MemoryArchive {
    std::string className = {};
    std::vector<std::pair<std::string, MemoryValue>> entries = {};  // in the order of writing

    // Nothing when there is no such key.
    MemoryValue valueOf(std::string_view key) const {
        const auto found = std::find_if(entries.begin(), entries.end(), [&](const auto& e) { return e.first == key; });
        return found == entries.end() ? MemoryValue() : found->second;
    }
    // Under a new key; nothing is left out.
    MemoryArchive& add(std::string_view key, MemoryValue value) {
        if (value.index() != 0) entries.emplace_back(key, std::move(value));
        return *this;
    }
    // The keys, each with its kind: "Name:string ShowInMenuBar:bool ".
    std::string layout() const {
        static constexpr const char* Kinds[] = {"",           "integer",      "bool",        "string",
                                                "date",       "characterSet", "strings",     "data",
                                                "attributed", "objects",      "propertyList"};
        std::string keys;
        for (const auto& [key, value] : entries) keys += key + ":" + Kinds[value.index()] + " ";
        return keys;
    }

    bool operator==(const MemoryArchive&) const = default;
};

class MemoryEncoder final : public KeyedEncoder {
  public:
    static MemoryArchive encode(const KeyedCodable& record) {
        MemoryEncoder encoder;
        encoder.archive_.className = record.archiveClassName();
        record.encodeWithCoder(encoder);
        return encoder.archive_;
    }

    void encodeInteger(std::string_view key, std::int64_t value) override { archive_.add(key, value); }
    void encodeBool(std::string_view key, bool value) override { archive_.add(key, value); }
    void encodeString(std::string_view key, const std::optional<std::u16string>& value) override { put(key, value); }
    void encodeDate(std::string_view key, const std::optional<Date>& value) override { put(key, value); }
    void encodeCharacterSet(std::string_view key, const std::optional<CharacterSet>& value) override {
        put(key, value);
    }
    void encodeStrings(std::string_view key, const std::optional<std::vector<std::u16string>>& value) override {
        put(key, value);
    }
    void encodeContent(std::string_view key, const ArchivedContent& value) override {
        std::visit([&](const auto& content) { archive_.add(key, content); }, value);
    }
    void encodeObjects(std::string_view key, const std::vector<const KeyedCodable*>& values) override {
        std::vector<MemoryArchive> objects;
        for (const KeyedCodable* value : values) objects.push_back(encode(*value));
        archive_.add(key, std::move(objects));
    }
    void encodePropertyList(std::string_view key, const PropertyList& value) override { archive_.add(key, value); }

  private:
    template <typename Value>
    void put(std::string_view key, const std::optional<Value>& value) {
        if (value) archive_.add(key, *value);
    }

    MemoryArchive archive_;
};

class MemoryDecoder final : public KeyedDecoder {
  public:
    explicit MemoryDecoder(MemoryArchive archive) : archive_(std::move(archive)) {}

    bool containsValueForKey(std::string_view key) const override { return archive_.valueOf(key).index() != 0; }
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
    std::optional<PropertyList> decodePropertyList(std::string_view key) const override {
        return get<PropertyList>(key);
    }
    std::any& decodedObject() override { return decoded_; }

  private:
    template <typename Value>
    std::optional<Value> get(std::string_view key) const {
        const MemoryValue value = archive_.valueOf(key);
        return std::holds_alternative<Value>(value) ? std::optional(std::get<Value>(value)) : std::nullopt;
    }

    MemoryArchive archive_;
    std::any decoded_;
};

}  // namespace plume::test

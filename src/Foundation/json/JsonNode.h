// Reading JSON strictly: whoever reads says what it expects, and everything else is an error that names the file, the
// place in it and what was expected.
//
// Operations throw JsonError, which does not leave the reader of a file format (LibraryFile, SettingsFile, …).
#pragma once

#include <cstdint>
#include <initializer_list>
#include <limits>
#include <memory>
#include <nlohmann/json.hpp>
#include <optional>
#include <stdexcept>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "Foundation/Result.h"

namespace plume {

// what() is the sentence for the user.
class JsonError : public std::runtime_error {
  public:
    using std::runtime_error::runtime_error;
};

class JsonObject;

// One value of a document, and where it stands. Copies share the document.
class JsonNode {
  public:
    // A whole document. Throws for text that is no JSON, and for objects that have a key twice.
    static JsonNode parse(std::string_view text, const std::string& fileName);

    bool isNull() const { return value_->is_null(); }
    bool isString() const { return value_->is_string(); }
    bool boolean() const;
    std::int64_t integer(std::int64_t least = std::numeric_limits<std::int64_t>::min(),
                         std::int64_t most = std::numeric_limits<std::int64_t>::max()) const;
    double number(double least, double most) const;
    std::u16string string() const;
    std::vector<std::u16string> strings() const;
    std::vector<JsonNode> elements() const;
    // With no other keys than these.
    JsonObject object(std::initializer_list<std::string_view> keys) const;
    // With any keys, in the document's order.
    std::vector<std::pair<std::string, JsonNode>> members() const;
    const nlohmann::ordered_json& value() const { return *value_; }
    // Where it stands in the document, such as "$[0].items[2].rtf".
    const std::string& path() const { return path_; }

    // "library.json: line 14, at $[0].items[2].rtf: expected …".
    [[noreturn]] void fail(const std::string& expected) const;

  private:
    friend class JsonObject;
    // Kept for messages.
    struct Source {
        std::string fileName;
        std::string text;
    };
    JsonNode(std::shared_ptr<const nlohmann::ordered_json> value, std::shared_ptr<const Source> source,
             std::string path)
        : value_(std::move(value)), source_(std::move(source)), path_(std::move(path)) {}
    JsonNode child(const nlohmann::ordered_json& value, const std::string& step) const;

    std::shared_ptr<const nlohmann::ordered_json> value_;
    std::shared_ptr<const Source> source_;
    std::string path_;
};

class JsonObject {
  public:
    explicit JsonObject(JsonNode node) : node_(std::move(node)) {}
    bool has(std::string_view key) const;
    // Nothing when the key is not there; null counts as there.
    std::optional<JsonNode> find(std::string_view key) const;
    const JsonNode& node() const { return node_; }

    // Reads the key with `read` where it is there and not null.
    template <typename Read>
    void whenSet(std::string_view key, Read read) const {
        if (const std::optional<JsonNode> found = find(key); found && !found->isNull()) read(*found);
    }

  private:
    JsonNode node_;
};

// Runs a reader, and turns its JsonError into a Result's error.
template <typename Read>
auto readingJson(Read read) -> Result<decltype(read())> {
    try {
        return read();
    } catch (const JsonError& error) {
        return Error{error.what()};
    }
}

}  // namespace plume

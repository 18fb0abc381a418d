// The members of a JSON object of another program, of which only some are known.
#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "Foundation/json/JsonNode.h"

namespace plume {

// All of these throw JsonError when a value is of another kind than asked for.
class JsonMembers {
  public:
    explicit JsonMembers(const JsonNode& node) : members_(node.members()) {}

    // Nothing when the key is missing or null.
    std::optional<JsonNode> find(std::string_view key) const {
        for (const auto& [name, value] : members_) {
            if (name == key) return value.isNull() ? std::nullopt : std::optional(value);
        }
        return std::nullopt;
    }
    std::u16string string(std::string_view key) const {
        const auto found = find(key);
        return found ? found->string() : std::u16string();
    }
    bool boolean(std::string_view key, bool otherwise) const {
        const auto found = find(key);
        return found ? found->boolean() : otherwise;
    }
    const std::vector<std::pair<std::string, JsonNode>>& all() const { return members_; }

  private:
    std::vector<std::pair<std::string, JsonNode>> members_;
};

}  // namespace plume

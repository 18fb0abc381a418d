#include "Foundation/json/JsonPlace.h"

#include <algorithm>
#include <nlohmann/json.hpp>

namespace plume {

namespace {

bool isPlainKey(const std::string& key) {
    return !key.empty() && std::all_of(key.begin(), key.end(), [](char c) {
        return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') || c == '_';
    });
}

// Walks over one document, value by value. The text was parsed before, so it is taken at its word.
class Walk {
  public:
    Walk(std::string_view text, std::string_view path) : text_(text), wanted_(path) {}

    // Whether the wanted value is this one or within it; then the walk stands at its beginning.
    bool value(const std::string& path) {
        skipSpace();
        if (path == wanted_) return true;
        switch (peek()) {
            case '{':
                return object(path);
            case '[':
                return array(path);
            case '"':
                string();
                return false;
            default:
                position_ = std::min(text_.find_first_of(",]} \t\r\n", position_), text_.size());
                return false;
        }
    }
    std::size_t position() const { return position_; }

  private:
    bool object(const std::string& path) {
        ++position_;
        for (skipSpace(); peek() == '"'; skipSeparator()) {
            const std::string step = jsonStep(string());
            skipSpace();
            ++position_;  // the colon
            if (value(path + step)) return true;
        }
        ++position_;
        return false;
    }
    bool array(const std::string& path) {
        ++position_;
        std::size_t index = 0;
        for (skipSpace(); position_ < text_.size() && peek() != ']'; skipSeparator()) {
            if (value(path + jsonStep(index++))) return true;
        }
        ++position_;
        return false;
    }
    std::string string() {
        const std::size_t start = position_++;
        for (; position_ < text_.size() && text_[position_] != '"'; ++position_) {
            if (text_[position_] == '\\') ++position_;
        }
        ++position_;
        return nlohmann::json::parse(text_.substr(start, position_ - start), nullptr, false).get<std::string>();
    }

    char peek() const { return position_ < text_.size() ? text_[position_] : '\0'; }
    void skipSpace() { position_ = std::min(text_.find_first_not_of(" \t\r\n", position_), text_.size()); }
    void skipSeparator() {
        skipSpace();
        if (peek() == ',') ++position_;
        skipSpace();
    }

    std::string_view text_;
    std::string_view wanted_;
    std::size_t position_ = 0;
};

}  // namespace

std::string jsonStep(const std::string& key) {
    return isPlainKey(key) ? "." + key : "[" + nlohmann::json(key).dump() + "]";
}

std::string jsonStep(std::size_t index) {
    return "[" + std::to_string(index) + "]";
}

std::optional<std::size_t> lineOfJsonPath(std::string_view text, std::string_view path) {
    Walk walk(text, path);
    if (!walk.value("$")) return std::nullopt;
    const std::string_view before = text.substr(0, walk.position());
    return static_cast<std::size_t>(std::count(before.begin(), before.end(), '\n')) + 1;
}

}  // namespace plume

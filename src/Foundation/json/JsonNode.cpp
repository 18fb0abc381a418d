#include "Foundation/json/JsonNode.h"

#include <algorithm>
#include <cmath>
#include <set>

#include "Foundation/Strings.h"
#include "Foundation/json/JsonPlace.h"

namespace plume {

namespace {

using Json = nlohmann::ordered_json;

// Deeper documents are none of ours; the bound keeps the reader's stack small.
constexpr int DeepestNesting = 64;

// Watches the parser for what it would let through.
class Watch {
  public:
    explicit Watch(const std::string& fileName) : fileName_(fileName) {}

    bool operator()(int depth, Json::parse_event_t event, Json& parsed) {
        if (depth > DeepestNesting) throw JsonError(fileName_ + ": the values are nested too deeply");
        if (event == Json::parse_event_t::object_start) keys_.emplace_back();
        if (event == Json::parse_event_t::object_end) keys_.pop_back();
        if (event == Json::parse_event_t::key && !keys_.back().insert(parsed.get<std::string>()).second) {
            throw JsonError(fileName_ + ": an object has the key " + parsed.dump() + " twice");
        }
        return true;
    }

  private:
    const std::string& fileName_;
    std::vector<std::set<std::string>> keys_;
};

// The library's own messages name the line and column behind a prefix of no use to people.
std::string explanation(const Json::exception& error) {
    const std::string message = error.what();
    const std::size_t place = message.find("] ");
    return place == std::string::npos ? message : message.substr(place + 2);
}

}  // namespace

JsonNode JsonNode::parse(std::string_view text, const std::string& fileName) {
    Watch watch(fileName);
    auto document = std::make_shared<Json>();
    try {
        *document = Json::parse(text, std::ref(watch));
    } catch (const Json::exception& error) {
        throw JsonError(fileName + ": this is no JSON: " + explanation(error));
    }
    auto source = std::make_shared<const Source>(Source{fileName, std::string(text)});
    return {std::move(document), std::move(source), "$"};
}

void JsonNode::fail(const std::string& expected) const {
    const bool hasLines = source_->text.find('\n') != std::string::npos;
    const auto line = hasLines ? lineOfJsonPath(source_->text, path_) : std::nullopt;
    const std::string place = line ? "line " + std::to_string(*line) + ", at " : "at ";
    throw JsonError(source_->fileName + ": " + place + path_ + ": " + expected);
}

JsonNode JsonNode::child(const Json& value, const std::string& step) const {
    // Shares the ownership of the whole document.
    return {std::shared_ptr<const Json>(value_, &value), source_, path_ + step};
}

bool JsonNode::boolean() const {
    if (!value_->is_boolean()) fail("expected true or false");
    return value_->get<bool>();
}

std::int64_t JsonNode::integer(std::int64_t least, std::int64_t most) const {
    if (value_->is_number_integer()) {
        const bool fits =
            !value_->is_number_unsigned() ||
            value_->get<std::uint64_t>() <= static_cast<std::uint64_t>(std::numeric_limits<std::int64_t>::max());
        const std::int64_t number = fits ? value_->get<std::int64_t>() : 0;
        if (fits && number >= least && number <= most) return number;
    }
    std::string expected = "expected a whole number";
    if (most != std::numeric_limits<std::int64_t>::max()) {
        expected += " from " + std::to_string(least) + " to " + std::to_string(most);
    } else if (least != std::numeric_limits<std::int64_t>::min()) {
        expected += " of at least " + std::to_string(least);
    }
    fail(expected);
}

double JsonNode::number(double least, double most) const {
    const double number = value_->is_number() ? value_->get<double>() : std::nan("");
    if (!(number >= least && number <= most)) {
        fail("expected a number from " + Json(least).dump() + " to " + Json(most).dump());
    }
    return number;
}

std::u16string JsonNode::string() const {
    if (!value_->is_string()) fail("expected a string");
    return fromUtf8(value_->get_ref<const std::string&>());
}

std::vector<std::u16string> JsonNode::strings() const {
    std::vector<std::u16string> texts;
    for (const JsonNode& element : elements()) texts.push_back(element.string());
    return texts;
}

std::vector<JsonNode> JsonNode::elements() const {
    if (!value_->is_array()) fail("expected a list");
    std::vector<JsonNode> nodes;
    nodes.reserve(value_->size());
    for (const Json& element : *value_) nodes.push_back(child(element, jsonStep(nodes.size())));
    return nodes;
}

std::vector<std::pair<std::string, JsonNode>> JsonNode::members() const {
    if (!value_->is_object()) fail("expected an object");
    std::vector<std::pair<std::string, JsonNode>> found;
    for (const auto& [key, value] : value_->items()) {
        found.emplace_back(key, child(value, jsonStep(key)));
    }
    return found;
}

JsonObject JsonNode::object(std::initializer_list<std::string_view> keys) const {
    for (const auto& [key, node] : members()) {
        if (std::find(keys.begin(), keys.end(), key) != keys.end()) continue;
        std::string expected = "unknown key; expected one of";
        for (const std::string_view known : keys)
            expected += (known == *keys.begin() ? " " : ", ") + std::string(known);
        node.fail(expected);
    }
    return JsonObject(*this);
}

bool JsonObject::has(std::string_view key) const {
    return node_.value().contains(key);
}

std::optional<JsonNode> JsonObject::find(std::string_view key) const {
    const auto found = node_.value().find(key);
    if (found == node_.value().end()) return std::nullopt;
    return node_.child(*found, jsonStep(std::string(key)));
}

}  // namespace plume

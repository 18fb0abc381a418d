#include "import/YamlFile.h"

#include <yaml-cpp/eventhandler.h>
#include <yaml-cpp/exceptions.h>
#include <yaml-cpp/mark.h>
#include <yaml-cpp/parser.h>

#include <algorithm>
#include <array>
#include <charconv>
#include <map>
#include <set>
#include <sstream>

#include "Foundation/Strings.h"

namespace plume {

namespace {

constexpr std::size_t DeepestValue = 64;
constexpr std::size_t MostValues = 1'000'000;
constexpr std::size_t MostBytes = std::size_t{64} << 20;
constexpr std::size_t LongestFile = std::size_t{16} << 20;
constexpr std::string_view MergeKey = "<<";

[[noreturn]] void failAt(const std::string& fileName, std::size_t line, std::size_t column, const std::string& what) {
    throw YamlError(fileName + ": line " + std::to_string(line) + ", column " + std::to_string(column) + ": " + what);
}

// Builds values from what yaml-cpp reads, one event after the other.
class Builder final : public YAML::EventHandler {
  public:
    explicit Builder(const std::string& fileName) : fileName_(std::make_shared<const std::string>(fileName)) {}

    YamlValue::Pointer root() const { return root_; }

    void OnDocumentStart(const YAML::Mark& /*mark*/) override {}
    void OnDocumentEnd() override {}
    void OnNull(const YAML::Mark& mark, YAML::anchor_t anchor) override { finish(make(mark), anchor, {1, 0}); }
    void OnScalar(const YAML::Mark& mark, const std::string& /*tag*/, YAML::anchor_t anchor,
                  const std::string& value) override {
        const auto scalar = make(mark);
        scalar->kind = YamlValue::Kind::Scalar;
        scalar->text = value;
        finish(scalar, anchor, {1, value.size()});
    }
    void OnAlias(const YAML::Mark& mark, YAML::anchor_t anchor) override {
        const auto found = anchors_.find(anchor);
        if (found == anchors_.end()) fail(mark, "an alias within what it stands for; expected one that is complete");
        add(found->second.value, found->second.size, mark);
    }
    void OnSequenceStart(const YAML::Mark& mark, const std::string& /*tag*/, YAML::anchor_t anchor,
                         YAML::EmitterStyle::value /*style*/) override {
        start(mark, anchor, YamlValue::Kind::List);
    }
    void OnSequenceEnd() override { end(); }
    void OnMapStart(const YAML::Mark& mark, const std::string& /*tag*/, YAML::anchor_t anchor,
                    YAML::EmitterStyle::value /*style*/) override {
        start(mark, anchor, YamlValue::Kind::Map);
    }
    void OnMapEnd() override { end(); }

  private:
    // With all that aliases repeat.
    struct Size {
        std::size_t values = 0;
        std::size_t bytes = 0;
    };
    struct Anchored {
        YamlValue::Pointer value;
        Size size;
    };
    struct Open {
        std::shared_ptr<YamlValue> value;
        YAML::anchor_t anchor = 0;
        Size size;
        std::set<std::string, std::less<>> keys = {};
        std::vector<YamlValue::Pointer> merged = {};
        bool awaitsValue = false;
    };

    [[noreturn]] void fail(const YAML::Mark& mark, const std::string& what) const {
        failAt(*fileName_, static_cast<std::size_t>(mark.line) + 1, static_cast<std::size_t>(mark.column) + 1, what);
    }

    std::shared_ptr<YamlValue> make(const YAML::Mark& mark) const {
        auto value = std::make_shared<YamlValue>();
        value->line = static_cast<std::size_t>(mark.line) + 1;
        value->column = static_cast<std::size_t>(mark.column) + 1;
        value->fileName = fileName_;
        return value;
    }

    void start(const YAML::Mark& mark, YAML::anchor_t anchor, YamlValue::Kind kind) {
        if (open_.size() >= DeepestValue) fail(mark, "expected at most 64 levels within each other");
        open_.push_back({make(mark), anchor, {1, 0}});
        open_.back().value->kind = kind;
    }

    void end() {
        Open closed = std::move(open_.back());
        open_.pop_back();
        merge(closed);
        finish(closed.value, closed.anchor, closed.size);
    }

    void finish(const std::shared_ptr<YamlValue>& value, YAML::anchor_t anchor, Size size) {
        if (anchor != 0) anchors_[anchor] = {value, size};
        YAML::Mark mark;
        mark.line = static_cast<int>(value->line) - 1;
        mark.column = static_cast<int>(value->column) - 1;
        add(value, size, mark);
    }

    void add(const YamlValue::Pointer& value, Size size, const YAML::Mark& mark) {
        if (open_.empty()) {
            root_ = value;
            return;
        }
        Open& parent = open_.back();
        parent.size.values += size.values;
        parent.size.bytes += size.bytes;
        if (parent.size.values > MostValues || parent.size.bytes > MostBytes) {
            fail(mark, "expected at most a million values and 64 MiB of text, counting what aliases repeat");
        }
        if (parent.value->kind == YamlValue::Kind::List) {
            parent.value->items.push_back(value);
        } else if (!parent.awaitsValue) {
            addKey(parent, value, mark);
        } else {
            addMember(parent, value);
        }
    }

    void addKey(Open& parent, const YamlValue::Pointer& key, const YAML::Mark& mark) {
        if (key->kind != YamlValue::Kind::Scalar) fail(mark, "expected a name as key");
        if (!parent.keys.insert(key->text).second) {
            fail(mark, "the key \"" + key->text + "\" stands twice; expected it once");
        }
        parent.awaitsValue = true;
        pendingKeys_.push_back(key->text);
    }

    void addMember(Open& parent, const YamlValue::Pointer& value) {
        std::string key = std::move(pendingKeys_.back());
        pendingKeys_.pop_back();
        parent.awaitsValue = false;
        if (key == MergeKey && value->kind == YamlValue::Kind::Map) {
            parent.merged.push_back(value);
        } else {
            parent.value->members.emplace_back(std::move(key), value);
        }
    }

    // What a map takes over from others; its own keys hold over those.
    static void merge(Open& map) {
        for (const YamlValue::Pointer& other : map.merged) {
            for (const auto& member : other->members) {
                if (map.keys.insert(member.first).second) map.value->members.push_back(member);
            }
        }
    }

    std::shared_ptr<const std::string> fileName_;
    YamlValue::Pointer root_;
    std::vector<Open> open_;
    std::vector<std::string> pendingKeys_;  // one for each open map that awaits a value
    std::map<YAML::anchor_t, Anchored> anchors_;
};

}  // namespace

const YamlValue* YamlValue::find(std::string_view key) const {
    const auto found = std::find_if(members.begin(), members.end(), [&](const auto& m) { return m.first == key; });
    return found == members.end() || found->second->kind == Kind::Null ? nullptr : found->second.get();
}

std::string YamlValue::string() const {
    if (kind != Kind::Scalar) fail("expected a text");
    return text;
}

bool YamlValue::boolean() const {
    constexpr std::array<std::string_view, 3> Yes = {"true", "True", "TRUE"};
    constexpr std::array<std::string_view, 3> No = {"false", "False", "FALSE"};
    if (kind == Kind::Scalar && std::find(Yes.begin(), Yes.end(), text) != Yes.end()) return true;
    if (kind == Kind::Scalar && std::find(No.begin(), No.end(), text) != No.end()) return false;
    fail("expected true or false");
}

std::int64_t YamlValue::integer() const {
    std::int64_t number = 0;
    const char* const last = text.data() + text.size();
    const auto [end, error] = std::from_chars(text.data() + (text.starts_with('+') ? 1 : 0), last, number);
    if (kind != Kind::Scalar || error != std::errc() || end != last) fail("expected a whole number");
    return number;
}

const std::vector<YamlValue::Pointer>& YamlValue::list() const {
    if (kind != Kind::List) fail("expected a list");
    return items;
}

std::vector<std::string> YamlValue::strings() const {
    if (kind == Kind::Scalar) return {text};
    std::vector<std::string> texts;
    for (const Pointer& item : list()) texts.push_back(item->string());
    return texts;
}

const YamlValue& YamlValue::map() const {
    if (kind != Kind::Map) fail("expected keys with values");
    return *this;
}

void YamlValue::fail(const std::string& expected) const {
    failAt(fileName ? *fileName : std::string(), line, column, expected);
}

YamlValue::Pointer readYaml(std::string_view utf8, const std::string& fileName) {
    if (utf8.size() > LongestFile) throw YamlError(fileName + ": the file is too large; expected at most 16 MiB");
    Builder builder(fileName);
    try {
        // Bytes that are no UTF-8 would end up in texts.
        std::istringstream stream(toUtf8(fromUtf8(utf8)));
        YAML::Parser parser(stream);
        parser.HandleNextDocument(builder);
    } catch (const YAML::Exception& error) {
        failAt(fileName, static_cast<std::size_t>(error.mark.line) + 1, static_cast<std::size_t>(error.mark.column) + 1,
               "expected YAML: " + error.msg);
    }
    return builder.root() ? builder.root() : std::make_shared<const YamlValue>();
}

}  // namespace plume

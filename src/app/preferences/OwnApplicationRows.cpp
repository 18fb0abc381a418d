#include "app/preferences/OwnApplicationRows.h"

#include <algorithm>
#include <sstream>

#include "Foundation/Strings.h"
#include "Foundation/json/JsonNode.h"

namespace plume {

namespace {

using Json = nlohmann::ordered_json;

constexpr const char* PasteKeys = "pasteKeys";
constexpr const char* NoKeys = "none";
constexpr const char* Flags = "flags";
constexpr const char* Pasting = "useClipboard";
constexpr const char* Waiting = "delayPasting";
// A family that names itself would have no end.
constexpr int DeepestFamily = 16;

const Json* member(const Json& object, const std::string& key) {
    const auto found = object.is_object() ? object.find(key) : object.end();
    return found == object.end() || found->is_null() ? nullptr : &*found;
}

bool isListed(const Json* flags, const char* flag) {
    return flags && flags->is_array() && std::find(flags->begin(), flags->end(), flag) != flags->end();
}

}  // namespace

Result<OwnApplicationRows> OwnApplicationRows::read(std::string_view builtIn, std::string_view own) {
    return readingJson([&] {
        OwnApplicationRows rows;
        if (!builtIn.empty()) rows.builtIn_ = JsonNode::parse(builtIn, "applications.json").value();
        if (own.empty()) return rows;
        const JsonNode node = JsonNode::parse(own, "CustomApplicationSettings");
        for (const auto& [name, row] : node.members()) row.members();
        rows.own_ = node.value();
        return rows;
    });
}

std::vector<std::string> OwnApplicationRows::names() const {
    std::vector<std::string> names;
    for (const auto& [name, row] : own_.items()) names.push_back(name);
    return names;
}

std::string OwnApplicationRows::add(const std::string& name) {
    for (const auto& [own, row] : own_.items()) {
        if (equalsIgnoringCase(fromUtf8(own), fromUtf8(name))) return own;
    }
    // An own row takes the whole place of the one that Plume comes with.
    const Json* known = builtInRow(name);
    own_[name] = known ? *known : Json::object();
    own_[name].erase("about");
    return name;
}

// As programs are found: by the whole name, else by its longest beginning.
const Json* OwnApplicationRows::builtInRow(const std::string& name) const {
    const std::string letters = toUtf8(lowercased(fromUtf8(name)));
    const Json* found = nullptr;
    std::size_t longest = 0;
    for (const BuiltIn& row : builtInRows()) {
        const bool isBeginning = row.name.ends_with('*');
        const std::string beginning = row.name.substr(0, row.name.size() - (isBeginning ? 1 : 0));
        if (isBeginning ? !letters.starts_with(beginning) : letters != beginning) continue;
        const std::size_t fit = isBeginning ? beginning.size() : letters.size() + 1;
        if (fit <= longest) continue;
        longest = fit;
        found = member(*member(builtIn_, "applications"), row.name);
    }
    return found;
}

const Json* OwnApplicationRows::find(const Json& row, const char* key) const {
    const Json* value = member(row, key);
    return value ? value : inherited(row, key);
}

const Json* OwnApplicationRows::inherited(const Json& row, const char* key) const {
    const Json* families = member(builtIn_, "families");
    const Json* family = member(row, "family");
    for (int depth = 0; families && family && family->is_string() && depth < DeepestFamily; ++depth) {
        const Json* of = member(*families, family->get<std::string>());
        if (!of) break;
        if (const Json* value = member(*of, key)) return value;
        family = member(*of, "family");
    }
    const Json* otherwise = member(builtIn_, "default");
    return otherwise ? member(*otherwise, key) : nullptr;
}

OwnApplicationRows::Insertion OwnApplicationRows::insertion(const std::string& name) const {
    const Json& row = own_.at(name);
    const Json* keys = find(row, PasteKeys);
    if (keys && *keys == NoKeys) return Insertion::Typed;
    return isListed(find(row, Flags), Pasting) ? Insertion::Pasted : Insertion::Automatic;
}

void OwnApplicationRows::setInsertion(const std::string& name, Insertion insertion) {
    Json& row = own_.at(name);
    if (insertion == Insertion::Typed) {
        row[PasteKeys] = NoKeys;
    } else if (const Json* keys = member(row, PasteKeys); keys && *keys == NoKeys) {
        row.erase(PasteKeys);
    }
    setFlag(name, Pasting, insertion == Insertion::Pasted);
}

// A row's list takes the place of the whole one that it would inherit, so that one is what is changed.
void OwnApplicationRows::setFlag(const std::string& name, const char* flag, bool on) {
    Json& row = own_.at(name);
    const Json* held = find(row, Flags);
    if (isListed(held, flag) == on) return;
    Json flags = held && held->is_array() ? *held : Json::array();
    if (on) {
        flags.push_back(flag);
    } else {
        flags.erase(std::remove(flags.begin(), flags.end(), flag), flags.end());
    }
    const Json* usual = inherited(row, Flags);
    if (usual ? flags == *usual : flags.empty()) {
        row.erase(Flags);
    } else {
        row[Flags] = flags;
    }
}

std::string OwnApplicationRows::pasteKeys(const std::string& name) const {
    const Json* keys = member(own_.at(name), PasteKeys);
    std::string text;
    if (!keys || !keys->is_array()) return text;
    for (const Json& key : *keys) {
        if (!key.is_string()) continue;
        if (!text.empty()) text += ' ';
        text += key.get<std::string>();
    }
    return text;
}

void OwnApplicationRows::setPasteKeys(const std::string& name, const std::string& keys) {
    Json list = Json::array();
    std::istringstream words(keys);
    for (std::string word; words >> word;) list.push_back(word);
    if (list.empty()) {
        own_.at(name).erase(PasteKeys);
    } else {
        own_.at(name)[PasteKeys] = list;
    }
}

double OwnApplicationRows::seconds(const std::string& name, const char* key) const {
    const Json* value = find(own_.at(name), key);
    return value && value->is_number() ? value->get<double>() : 0;
}

void OwnApplicationRows::setSeconds(const std::string& name, const char* key, double seconds) {
    Json& row = own_.at(name);
    const Json* usual = inherited(row, key);
    const double usualSeconds = usual && usual->is_number() ? usual->get<double>() : 0;
    if (seconds == usualSeconds) {
        row.erase(key);
    } else {
        row[key] = seconds;
    }
    // That pause alone needs a word that it counts.
    if (key == std::string_view(BeforePasting)) setFlag(name, Waiting, seconds > 0);
}

std::vector<OwnApplicationRows::BuiltIn> OwnApplicationRows::builtInRows() const {
    std::vector<BuiltIn> all;
    const Json* rows = member(builtIn_, "applications");
    if (!rows) return all;
    for (const auto& [name, row] : rows->items()) {
        const Json* family = member(row, "family");
        all.push_back({name, family && family->is_string() ? family->get<std::string>() : std::string()});
    }
    return all;
}

}  // namespace plume

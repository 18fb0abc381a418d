#include "library/LibraryFile.h"

#include <utility>

#include "Foundation/Strings.h"
#include "Foundation/Uuid.h"
#include "Foundation/text/RTFD.h"

namespace plume {

namespace {

using Json = nlohmann::ordered_json;
using Text = std::optional<std::u16string>;

// ---- Reading ----

// Behind those that Plume knows: JavaScript of imported libraries, which is kept.
constexpr std::int64_t LargestContentType = 4;

template <typename Enum>
Enum code(const JsonNode& node, std::int64_t most) {
    return static_cast<Enum>(node.integer(0, most));
}

std::optional<CharacterSet> delimiters(const JsonNode& node) {
    return SnippetGroup::replaceNewlineCharacterByCarriageReturnCharacter(CharacterSet::withCharacters(node.string()));
}

void readAvailability(const JsonNode& node, PLFunctionAvailability& availability) {
    const JsonObject object = node.object({"availability", "applications", "inputMethodsOption", "inputMethods"});
    object.whenSet("availability", [&](const JsonNode& n) { availability.availability = n.integer(0, 2); });
    object.whenSet("applications", [&](const JsonNode& n) { availability.applications = n.strings(); });
    object.whenSet("inputMethodsOption", [&](const JsonNode& n) { availability.inputMethodsOption = n.integer(0, 2); });
    object.whenSet("inputMethods", [&](const JsonNode& n) { availability.inputMethods = n.strings(); });
}

void readContent(const JsonObject& object, Snippet& snippet) {
    const auto rtf = object.find("rtf");
    if (rtf && !rtf->isNull()) {
        if (snippet.contentType() != ContentType::RichText) rtf->fail("only contentType 1, rich text, has this key");
        if (object.has("content")) rtf->fail("expected either content or rtf, not both");
        Result<AttributedString> text = attributedStringFromRTF(toUtf8(rtf->string()));
        if (!text) rtf->fail("expected RTF: " + text.error().message);
        snippet.setRichTextContent(std::move(text).value());
        return;
    }
    object.whenSet("content", [&](const JsonNode& n) { snippet.setPlainTextContent(n.string()); });
}

std::shared_ptr<Snippet> readSnippet(const JsonNode& node) {
    const JsonObject object =
        node.object({"abbreviation", "content", "contentType", "caseSensitivity", "label", "note", "uuid", "rtf"});
    std::shared_ptr<Snippet> snippet;
    object.whenSet("uuid", [&](const JsonNode& n) {
        const std::optional<Uuid> uuid = Uuid::parse(n.string());
        if (!uuid) n.fail("expected a UUID, such as 7C1B7A52-6C62-4B0C-9A0B-0C0D5C0F7E11");
        snippet = std::make_shared<Snippet>(*uuid);
    });
    if (!snippet) snippet = std::make_shared<Snippet>();
    object.whenSet("abbreviation", [&](const JsonNode& n) { snippet->setAbbreviation(n.string()); });
    object.whenSet("contentType",
                   [&](const JsonNode& n) { snippet->setContentType(code<ContentType>(n, LargestContentType)); });
    object.whenSet("caseSensitivity",
                   [&](const JsonNode& n) { snippet->setCaseSensitivity(code<CaseSensitivity>(n, 2)); });
    object.whenSet("label", [&](const JsonNode& n) { snippet->setLabel(n.string()); });
    object.whenSet("note", [&](const JsonNode& n) { snippet->setNote(n.string()); });
    readContent(object, *snippet);
    return snippet;
}

std::shared_ptr<SnippetGroup> readGroup(const JsonNode& node) {
    const JsonObject object = node.object({"name", "abbreviationPrefix", "expandAfter", "expandAfterDelimiters",
                                           "expandTrigger", "delimiters", "caseSensitivity", "resetFormatting",
                                           "suggestAbbreviations", "showInMenuBar", "availability", "items"});
    std::shared_ptr<SnippetGroup> group = SnippetGroup::make();
    object.whenSet("name", [&](const JsonNode& n) { group->setName(n.string()); });
    object.whenSet("abbreviationPrefix", [&](const JsonNode& n) { group->setAbbreviationPrefix(n.string()); });
    object.whenSet("expandAfter", [&](const JsonNode& n) { group->setExpandAfter(code<ExpandAfter>(n, 3)); });
    object.whenSet("expandAfterDelimiters", [&](const JsonNode& n) { group->setExpandAfterDelimiters(delimiters(n)); });
    object.whenSet("expandTrigger", [&](const JsonNode& n) { group->setExpandTrigger(code<ExpandTrigger>(n, 4)); });
    object.whenSet("delimiters", [&](const JsonNode& n) { group->setDelimiters(delimiters(n)); });
    object.whenSet("caseSensitivity",
                   [&](const JsonNode& n) { group->setCaseSensitivity(code<CaseSensitivity>(n, 2)); });
    object.whenSet("resetFormatting", [&](const JsonNode& n) { group->setResetFormatting(n.boolean()); });
    object.whenSet("suggestAbbreviations", [&](const JsonNode& n) { group->setSuggestAbbreviations(n.boolean()); });
    object.whenSet("showInMenuBar", [&](const JsonNode& n) { group->setShowInMenuBar(n.boolean()); });
    object.whenSet("availability", [&](const JsonNode& n) { readAvailability(n, group->availability()); });
    object.whenSet("items", [&](const JsonNode& n) {
        for (const JsonNode& item : n.elements()) group->addItem(readSnippet(item));
    });
    return group;
}

// ---- Writing ----

void put(Json& json, const char* key, const Text& text) {
    if (text) json[key] = toUtf8(*text);
}

template <typename Enum>
void put(Json& json, const char* key, Enum value, Enum usual) {
    if (value != usual) json[key] = static_cast<std::int64_t>(value);
}

void put(Json& json, const char* key, bool value, bool usual) {
    if (value != usual) json[key] = value;
}

void put(Json& json, const char* key, const std::optional<CharacterSet>& set) {
    if (set) json[key] = toUtf8(set->characters());
}

void put(Json& json, const char* key, const std::optional<std::vector<std::u16string>>& texts) {
    if (!texts) return;
    Json list = Json::array();
    for (const std::u16string& text : *texts) list.push_back(toUtf8(text));
    json[key] = std::move(list);
}

Json written(const PLFunctionAvailability& availability) {
    Json json = Json::object();
    if (availability.availability != 0) json["availability"] = availability.availability;
    put(json, "applications", availability.applications);
    if (availability.inputMethodsOption != 0) json["inputMethodsOption"] = availability.inputMethodsOption;
    put(json, "inputMethods", availability.inputMethods);
    return json;
}

Json written(const Snippet& snippet) {
    Json json = Json::object();
    put(json, "abbreviation", snippet.abbreviation());
    put(json, "contentType", snippet.contentType(), ContentType::PlainText);
    if (snippet.contentType() == ContentType::RichText && snippet.hasContent()) {
        json["rtf"] = rtfFromAttributedString(*snippet.richTextContent());
    } else {
        put(json, "content", snippet.plainTextContent());
    }
    put(json, "caseSensitivity", snippet.caseSensitivity(), CaseSensitivity::CaseSensitive);
    put(json, "label", snippet.label());
    put(json, "note", snippet.note());
    if (snippet.uuid()) json["uuid"] = toUtf8(snippet.uuid()->toString());
    return json;
}

Json written(const SnippetGroup& group) {
    Json json = Json::object();
    put(json, "name", group.name());
    put(json, "abbreviationPrefix", group.abbreviationPrefix());
    put(json, "expandAfter", group.expandAfter(), ExpandAfter::Delimiter);
    put(json, "expandAfterDelimiters", group.expandAfterDelimiters());
    put(json, "expandTrigger", group.expandTrigger(), ExpandTrigger::Immediately);
    put(json, "delimiters", group.delimiters());
    put(json, "caseSensitivity", group.caseSensitivity(), CaseSensitivity::CaseSensitive);
    put(json, "resetFormatting", group.resetFormatting(), false);
    put(json, "suggestAbbreviations", group.suggestAbbreviations(), true);
    put(json, "showInMenuBar", group.showInMenuBar(), true);
    if (Json availability = written(group.availability()); !availability.empty()) {
        json["availability"] = std::move(availability);
    }
    Json items = Json::array();
    for (const auto& snippet : group.items()) items.push_back(written(*snippet));
    json["items"] = std::move(items);
    return json;
}

}  // namespace

Result<LibraryFile::Groups> LibraryFile::read(std::string_view text, const std::string& fileName) {
    return readingJson([&] { return readFrom(JsonNode::parse(text, fileName)); });
}

LibraryFile::Groups LibraryFile::readFrom(const JsonNode& node) {
    Groups groups;
    for (const JsonNode& element : node.elements()) groups.push_back(readGroup(element));
    return groups;
}

std::string LibraryFile::write(const Groups& groups) {
    Json json = Json::array();
    for (const auto& group : groups) json.push_back(written(*group));
    return json.dump(2) + "\n";
}

}  // namespace plume

// The reference of the content language (docs/content-language.md) says what Plume does: its examples are run as they
// stand there.
#include <gtest/gtest.h>

#include <algorithm>
#include <fstream>
#include <map>
#include <sstream>
#include <stdexcept>

#include "Foundation/Strings.h"
#include "content/NestedScripts.h"
#include "content/OldSyntax.h"
#include "library/Snippet.h"
#include "tests/content/world/ContentWorld.h"

namespace plume {
namespace {

constexpr const char* Page = "docs/content-language.md";

struct Line {
    std::size_t number = 0;
    std::string left;
    std::string right;
};

// The lines of the fenced blocks by the blocks' kind, cut at the separator.
std::map<std::string, std::vector<Line>> readBlocks() {
    std::ifstream file(Page);
    if (!file) throw std::runtime_error(std::string("cannot read ") + Page);
    std::map<std::string, std::vector<Line>> blocks;
    std::string kind;
    std::string text;
    for (std::size_t number = 1; std::getline(file, text); ++number) {
        if (text.starts_with("```")) {
            kind = text.substr(3);
            continue;
        }
        if (kind.empty()) continue;
        const std::string separator = kind == "world" ? ": " : " => ";
        const std::size_t cut = text.find(separator);
        if (cut == std::string::npos) throw std::runtime_error("no " + separator + "in line " + std::to_string(number));
        blocks[kind].push_back({number, text.substr(0, cut), text.substr(cut + separator.size())});
    }
    return blocks;
}

std::string withLineBreaks(const std::string& text) {
    return toUtf8(replacingAll(fromUtf8(text), u"\\n", u"\n"));
}

// The moment and the place are those of every ContentWorld.
void setUp(ContentWorld& world, const std::vector<Line>& lines) {
    for (const auto& [number, name, value] : lines) {
        if (name == "now") {
            EXPECT_EQ(toUtf8(world.expand("【date:\"yyyy-MM-dd HH:mm:ss\"】")->string()), value);
        } else if (name == "time zone") {
            EXPECT_EQ(world.environment.timeZone, value);
        } else if (name == "locale") {
            EXPECT_EQ(world.environment.locale, value);
        } else if (name == "clipboard") {
            world.pasteboard.plainText = value;
        } else if (name.starts_with("snippet ")) {
            world.add(name.substr(8), value);
        } else if (name.starts_with("script ")) {
            world.add(name.substr(7), value, ContentType::ShellScript);
        } else {
            ADD_FAILURE() << "unknown part of the world in line " << number << ": " << name;
        }
    }
}

std::string shown(const SnippetFieldVariable& field) {
    std::string text = field.isOptional ? (field.isSelected ? "ticked " : "optional ") : "";
    if (field.isReadonly) text += "read-only ";
    text += field.isMultiline() ? "lines" : field.isPopupMenu() ? "menu" : field.isNumber() ? "number" : "field";
    if (field.name && !field.name->empty()) text += " " + toUtf8(*field.name);
    if (field.value) text += ": " + toUtf8(*field.value);
    if (field.defaultIndex != 0) text += ", at " + std::to_string(field.defaultIndex);
    if (field.hasWidth()) text += ", " + std::to_string(field.width()) + " wide";
    if (field.hasHeight()) text += ", " + std::to_string(field.height()) + " high";
    return "⟨" + text + "⟩";
}

std::string shown(const SnippetKeyVariable& key) {
    std::ostringstream text;
    text << "⟨key " << numberOf(key.keyCode);
    if (key.count != 1) text << ", " << key.count << " times";
    if (key.delay > 0) text << ", after " << key.delay << " s";
    if (!key.modifiers.isEmpty()) text << ", modifiers " << key.modifiers.bits();
    text << "⟩";
    return text.str();
}

std::string shown(const SnippetVariable& variable) {
    if (const auto* field = dynamic_cast<const SnippetFieldVariable*>(&variable)) return shown(*field);
    if (const auto* key = dynamic_cast<const SnippetKeyVariable*>(&variable)) return shown(*key);
    return "‸";
}

// The content with a sign for everything in it that is no text.
std::string shown(SnippetExpandedContent& content) {
    processScripts(content);
    for (const auto& script : content.scripts) script->result = u"⟨script " + script->script + u"⟩";
    mergeScriptResults(content);

    std::multimap<std::size_t, std::string> signs;
    for (const auto& variable : content.variables) signs.emplace(variable->location, shown(*variable));
    if (signs.empty()) return notation(content);
    std::string result;
    std::size_t position = 0;
    for (const auto& [place, sign] : signs) {
        const std::size_t location = std::min(place, content.string().size());
        result += toUtf8(content.string().substr(position, location - position)) + sign;
        position = location;
    }
    return result + toUtf8(content.string().substr(position));
}

std::string expanded(const Line& example, ContentType type, const std::vector<Line>& worldLines) {
    ContentWorld world;
    setUp(world, worldLines);
    const auto content = world.expand(withLineBreaks(example.left), type);
    return content ? shown(*content) : "refused";
}

std::string converted(const Line& example) {
    ContentWorld world;
    const auto snippet = world.snippet(example.left);
    convertOldSnippet(*snippet);
    return toUtf8(*snippet->plainTextContent());
}

TEST(Documentation, ExamplesOfTheContentLanguageAreTrue) {
    auto blocks = readBlocks();
    const std::vector<Line> world = blocks["world"];
    ASSERT_FALSE(world.empty());
    std::size_t count = 0;
    blocks.erase("world");
    for (const auto& [kind, lines] : blocks) {
        ASSERT_TRUE(kind == "plume" || kind == "plume rich" || kind == "plume old") << kind;
        const ContentType type = kind == "plume rich" ? ContentType::RichText : ContentType::PlainText;
        for (const Line& line : lines) {
            SCOPED_TRACE(Page + (":" + std::to_string(line.number)));
            EXPECT_EQ(kind == "plume old" ? converted(line) : expanded(line, type, world), withLineBreaks(line.right));
        }
        count += lines.size();
    }
    EXPECT_GT(count, 80u);
}

}  // namespace
}  // namespace plume

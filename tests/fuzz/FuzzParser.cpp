// Any library of snippets is expanded or refused; what comes out is delivered without harm, and is what editing the
// text in place would give.
#include <cstdint>
#include <cstdlib>
#include <string>
#include <string_view>

#include "Foundation/Strings.h"
#include "content/FieldMerging.h"
#include "content/NestedScripts.h"
#include "content/PLOutput.h"
#include "tests/content/world/ContentWorld.h"
#include "tests/content/world/InPlaceModel.h"

namespace {

constexpr std::size_t ModelReplacements = 200;

// Brackets stand for the markers, so that the input stays short; the first character says which type it is.
std::shared_ptr<plume::Snippet> snippetFrom(plume::ContentWorld& world, std::string_view line) {
    const auto type = line.empty() ? plume::ContentType::PlainText : static_cast<plume::ContentType>(line.front() & 3);
    std::string content;
    for (const char c : line.substr(line.empty() ? 0 : 1)) {
        content += c == '[' ? "\u3010" : c == ']' ? "\u3011" : std::string(1, c);
    }
    return world.snippet(content, type);
}

void deliver(plume::SnippetExpandedContent& content) {
    for (const auto& field : content.fields()) {
        if (!field->value) field->value = field->name;
    }
    plume::mergeFields(content);
    plume::processScripts(content);
    for (const auto& script : content.scripts) script->result = script->script;
    plume::mergeScriptResults(content);
    content.suffix = u".";
    content.applySuffix();
    plume::PLOutput output;
    output.snippetExpandedContent = std::make_shared<plume::SnippetExpandedContent>(content);
    output.refreshFragments();
    content.copyString();
    content.caretLocation();
    content.caretDistanceFromEnding();
}

// False when the model sees no end.
bool agreesWithModel(plume::ContentWorld& world, const std::shared_ptr<plume::Snippet>& snippet) {
    plume::InPlaceModel model(world.environment, snippet, world.groups, ModelReplacements);
    const auto expected = model.expand();
    if (!expected) return false;
    const auto actual =
        plume::SnippetParser(world.environment).parse(snippet, snippet->richTextContent()->string(), world.groups);
    if (!actual || actual->string() != expected->text) std::abort();
    if (describe(actual->variables) != describe(expected->variables)) std::abort();
    return true;
}

}  // namespace

// Lines are the clipboard, the snippet to expand, and the snippets that it can name: "a", "b", "c" and so on.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    plume::ContentWorld world;
    std::shared_ptr<plume::Snippet> outer;
    const auto text = plume::fromUtf8({reinterpret_cast<const char*>(data), size});
    char name = 'a';
    for (const auto& line : plume::split(text, u'\n')) {
        if (!world.pasteboard.plainText) {
            world.pasteboard.plainText = plume::toUtf8(line);
            continue;
        }
        const auto snippet = snippetFrom(world, plume::toUtf8(line));
        if (!outer) {
            outer = snippet;
            continue;
        }
        snippet->setAbbreviation(std::u16string(1, static_cast<char16_t>(name++)));
        world.groups.front()->addItem(snippet);
        if (name > 'f') break;
    }
    if (!outer) return 0;
    // Refusing one takes as long as expanding hundreds: a few are enough.
    if (!agreesWithModel(world, outer) && size % 64 != 0) return 0;
    plume::SnippetParser parser(world.environment);
    if (const auto content = parser.parseSnippet(outer, world.groups)) deliver(*content);
    if (const auto content = parser.parse(outer, *outer->richTextContent(), world.groups)) deliver(*content);
    return 0;
}

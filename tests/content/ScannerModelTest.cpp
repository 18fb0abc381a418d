// The scanner against the same language written as edits in place.
#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include "Foundation/Strings.h"
#include "tests/content/world/ContentWorld.h"
#include "tests/content/world/InPlaceModel.h"

namespace plume {
namespace {

// Contents that are likely to hold placeholders, halves of them, and placeholders that come together only when a
// nested snippet is put in.
std::string arbitraryContent() {
    const auto parts = *rc::gen::container<std::vector<std::string>>(
        rc::gen::element<std::string>("【", "】", "【", "】", "【snippet:a】", "【snippet:b】", "【snippet:c】",
                                      "snippet:c", "【snippet:a optional:1】", "【field:x】", "【|】", "【▼】",
                                      "【date:yyyy", "【key:x】", "【clipboard】", "|", "da", "te:yyyy】", "x", " "));
    std::string content;
    for (const auto& part : parts) content += part;
    return content;
}

ContentType arbitraryType() {
    return *rc::gen::element(ContentType::PlainText, ContentType::PlainText, ContentType::ShellScript);
}

RC_GTEST_PROP(ScannerModel, AgreesWithEditingInPlace, ()) {
    ContentWorld world;
    world.pasteboard.plainText = "【|】clip【";
    for (const char* abbreviation : {"a", "b", "c"}) world.add(abbreviation, arbitraryContent(), arbitraryType());
    const auto outer = world.snippet(arbitraryContent());
    SnippetParser parser(world.environment);
    for (const bool isRich : {false, true}) {
        InPlaceModel model(world.environment, outer, world.groups, 300);
        model.optionalDatesBecomeFields = !isRich;
        const auto expected = model.expand();
        if (!expected) continue;  // most likely without an end
        const auto actual = isRich ? parser.parse(outer, *outer->richTextContent(), world.groups)
                                   : parser.parseSnippet(outer, world.groups);
        RC_ASSERT(actual != nullptr);
        RC_ASSERT(toUtf8(actual->string()) == toUtf8(expected->text));
        RC_ASSERT(describe(actual->variables) == describe(expected->variables));
    }
}

}  // namespace
}  // namespace plume

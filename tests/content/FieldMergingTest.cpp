#include "content/FieldMerging.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <memory>

#include "Foundation/Strings.h"
#include "tests/content/world/ContentWorld.h"

namespace plume {
namespace {

template <class Variable>
std::shared_ptr<Variable> addVariable(SnippetExpandedContent& content, std::size_t location) {
    auto variable = std::make_shared<Variable>();
    variable->location = location;
    content.variables.push_back(variable);
    return variable;
}

std::shared_ptr<SnippetFieldVariable> addField(SnippetExpandedContent& content, std::size_t location,
                                               std::optional<std::u16string> value) {
    auto field = addVariable<SnippetFieldVariable>(content, location);
    field->value = std::move(value);
    return field;
}

TEST(FieldMerging, UnusedFieldsBecomeEmpty) {
    SnippetExpandedContent content(u"<>");
    const auto missing = addField(content, 1, std::nullopt);
    const auto unticked = addField(content, 1, u"x");
    unticked->isOptional = true;
    const auto ticked = addField(content, 1, u"y");
    ticked->isOptional = true;
    ticked->isSelected = true;
    const auto caret = addVariable<SnippetContentCaret>(content, 2);
    addField(content, 7, u"!");  // past the end
    mergeFields(content);
    EXPECT_EQ(content.string(), u"<y>!");
    EXPECT_EQ(missing->value, u"");
    EXPECT_EQ(unticked->value, u"");
    EXPECT_EQ(caret->location, 3u);
}

TEST(FieldMerging, RichContentTakesRichValuesAndFieldAttributes) {
    for (const bool isRich : {false, true}) {
        SnippetExpandedContent content(u"abc");
        if (isRich) content.setContent(rich("a*b*c"));
        addField(content, 1, u"x")->attributes = rich("_i_").attributesAt(0);
        addField(content, 2, u"yz")->richTextValue = rich("*y*_z_");
        const auto unticked = addField(content, 3, u"Jo");
        unticked->isOptional = true;
        unticked->richTextValue = rich("*Jo*");
        const auto caret = addVariable<SnippetContentCaret>(content, 3);
        mergeFields(content);
        EXPECT_EQ(notation(content), isRich ? "a_x_*by*_z_c*Jo*" : "axbyzc") << "an unticked rich value stays";
        EXPECT_EQ(unticked->value, u"");
        EXPECT_EQ(caret->location, content.string().size());
    }
}

TEST(FieldMerging, FieldsInAScriptLengthenIt) {
    SnippetExpandedContent content(u"a[b(c)d]e");
    const auto addScript = [&](std::size_t location, std::size_t length) {
        addVariable<SnippetAbbreviationVariable>(content, location)->scriptLength = length;
    };
    addScript(1, 7);
    addField(content, 2, u"12");
    addScript(3, 3);
    addField(content, 4, u"345");
    addField(content, 6, u"6");   // where the inner script ends: behind it
    addField(content, 8, u"78");  // behind the outer one
    addScript(8, 1);
    mergeFields(content);
    EXPECT_EQ(content.string(), u"a[12b(345c)6d]78e");
    std::vector<std::u16string> scripts;
    for (const auto& script : content.abbreviations()) {
        scripts.push_back(content.string().substr(script->location, script->scriptLength));
    }
    EXPECT_EQ(scripts, (std::vector<std::u16string>{u"[12b(345c)6d]", u"(345c)", u"e"}));
}

// Fields in any order, next to each other or not, among carets: what comes out is what inserting one value after the
// other, from the last field to the first, gives.
RC_GTEST_PROP(FieldMerging, IsTheSameAsInsertingOneByOne, ()) {
    const auto plain = *rc::gen::container<std::u16string>(rc::gen::inRange<char16_t>(u'a', u'z'));
    SnippetExpandedContent content(plain);
    if (*rc::gen::arbitrary<bool>()) content.setContent(AttributedString(plain, rich("*b*").attributesAt(0)));
    std::vector<std::size_t> carets;  // where each is to stand in the end
    std::size_t shift = 0;
    for (int count = *rc::gen::inRange(0, 8); count > 0; --count) {
        const auto location = *rc::gen::inRange<std::size_t>(0, plain.size() + 1);
        if (*rc::gen::arbitrary<bool>()) {
            const auto length = *rc::gen::inRange<std::size_t>(0, 4);
            addField(content, location, std::u16string(length, static_cast<char16_t>(u'0' + count)));
            shift += length;
        } else {
            addVariable<SnippetContentCaret>(content, location);
            carets.push_back(location + shift);
        }
    }
    std::u16string expected = plain;
    const auto fields = content.fields();
    for (auto field = fields.rbegin(); field != fields.rend(); ++field) {
        expected.insert((*field)->location, *(*field)->value);
    }
    mergeFields(content);
    RC_ASSERT(content.string() == expected);
    std::size_t next = 0;
    for (const auto& variable : content.variables) {
        if (std::dynamic_pointer_cast<SnippetContentCaret>(variable)) RC_ASSERT(variable->location == carets[next++]);
    }
}

}  // namespace
}  // namespace plume

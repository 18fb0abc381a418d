// Putting the values of the fill-in form into the content.
#include <gmock/gmock.h>
#include <rapidcheck/gtest.h>

#include <memory>

#include "Foundation/Strings.h"
#include "content/SnippetParser.h"
#include "tests/content/ContentWorld.h"

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

std::shared_ptr<SnippetAbbreviationVariable> addScript(SnippetExpandedContent& content, std::size_t location,
                                                       std::size_t length) {
    auto script = addVariable<SnippetAbbreviationVariable>(content, location);
    script->scriptLength = length;
    return script;
}

TEST(FieldMerging, InsertsValuesAndMovesWhatFollows) {
    SnippetExpandedContent content(u"ab");
    addField(content, 0, u"123");
    const auto key = addVariable<SnippetKeyVariable>(content, 1);
    addField(content, 1, u"4567");
    const auto caret = addVariable<SnippetContentCaret>(content, 2);
    SnippetParser::mergeFields(content);
    EXPECT_EQ(content.string(), u"123a4567b");
    EXPECT_EQ(key->location, 4u);
    EXPECT_EQ(caret->location, 9u);
    EXPECT_EQ(content.variables.size(), 4u);
}

TEST(FieldMerging, FieldsAtOnePlaceKeepTheirOrder) {
    SnippetExpandedContent content(u"<>");
    addField(content, 1, u"a");
    addField(content, 1, u"b");
    addField(content, 1, u"c");
    SnippetParser::mergeFields(content);
    EXPECT_EQ(content.string(), u"<abc>");
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
    SnippetParser::mergeFields(content);
    EXPECT_EQ(content.string(), u"<y>");
    EXPECT_EQ(missing->value, u"");
    EXPECT_EQ(unticked->value, u"");
    EXPECT_EQ(caret->location, 3u);
}

TEST(FieldMerging, RichContentTakesRichValuesAndFieldAttributes) {
    SnippetExpandedContent content(rich("a*b*c"));
    addField(content, 1, u"x")->attributes = rich("_i_").attributesAt(0);
    addField(content, 2, u"yz")->richTextValue = rich("*y*_z_");
    addField(content, 3, u"w");
    SnippetParser::mergeFields(content);
    EXPECT_EQ(notation(content), "a_x_*by*_z_cw");
}

TEST(FieldMerging, PlainContentTakesNoRichValues) {
    SnippetExpandedContent content(u"<>");
    addField(content, 1, u"x")->richTextValue = rich("*rich*");
    SnippetParser::mergeFields(content);
    EXPECT_EQ(notation(content), "<x>");
}

TEST(FieldMerging, UntickedRichValuesStayAndMoveWhatFollows) {
    SnippetExpandedContent content(rich("<>"));
    const auto field = addField(content, 1, u"Jo");
    field->isOptional = true;
    field->richTextValue = rich("*Jo*");
    const auto caret = addVariable<SnippetContentCaret>(content, 2);
    SnippetParser::mergeFields(content);
    EXPECT_EQ(notation(content), "<*Jo*>");
    EXPECT_EQ(field->value, u"");
    EXPECT_EQ(caret->location, 4u);
}

TEST(FieldMerging, FieldsInAScriptLengthenIt) {
    SnippetExpandedContent content(u"a[b(c)d]e");
    const auto outer = addScript(content, 1, 7);
    addField(content, 2, u"12");
    const auto inner = addScript(content, 3, 3);
    addField(content, 4, u"345");
    addField(content, 6, u"6");   // where the inner script ends: behind it
    addField(content, 8, u"78");  // behind the outer one
    const auto last = addScript(content, 8, 1);
    SnippetParser::mergeFields(content);
    EXPECT_EQ(content.string(), u"a[12b(345c)6d]78e");
    const auto textOf = [&](const SnippetAbbreviationVariable& script) {
        return toUtf8(content.string().substr(script.location, script.scriptLength));
    };
    EXPECT_EQ(textOf(*outer), "[12b(345c)6d]");
    EXPECT_EQ(textOf(*inner), "(345c)");
    EXPECT_EQ(textOf(*last), "e");
}

TEST(FieldMerging, LocationsPastTheEndMeanTheEnd) {
    SnippetExpandedContent content(u"ab");
    addField(content, 7, u"c");
    SnippetParser::mergeFields(content);
    EXPECT_EQ(content.string(), u"abc");
}

// Fields in any order, next to each other or not, among carets and scripts: what comes out is what inserting one value
// after the other, from the last field to the first, gives.
RC_GTEST_PROP(FieldMerging, IsTheSameAsInsertingOneByOne, ()) {
    const auto plain = *rc::gen::container<std::u16string>(rc::gen::inRange<char16_t>(u'a', u'z'));
    const bool isRich = *rc::gen::arbitrary<bool>();
    SnippetExpandedContent content;
    if (isRich) {
        content.setContent(AttributedString(plain, rich("*b*").attributesAt(0)));
    } else {
        content.setContent(plain);
    }
    const auto size = static_cast<int>(plain.size());
    for (int count = *rc::gen::inRange(0, 8); count > 0; --count) {
        const auto location = static_cast<std::size_t>(*rc::gen::inRange(0, size + 1));
        if (*rc::gen::arbitrary<bool>()) {
            addField(content, location, std::u16string(*rc::gen::inRange<std::size_t>(0, 4), u'0'));
        } else {
            addVariable<SnippetContentCaret>(content, location);
        }
    }

    std::u16string expected = plain;
    std::vector<std::size_t> locations;
    std::size_t shift = 0;
    for (const auto& variable : content.variables) {
        const auto field = std::dynamic_pointer_cast<SnippetFieldVariable>(variable);
        if (field) {
            shift += field->value->size();
        } else {
            locations.push_back(variable->location + shift);
        }
    }
    const auto fields = content.fields();
    for (auto field = fields.rbegin(); field != fields.rend(); ++field) {
        expected.insert((*field)->location, *(*field)->value);
    }

    SnippetParser::mergeFields(content);
    RC_ASSERT(content.string() == expected);
    std::size_t next = 0;
    for (const auto& variable : content.variables) {
        if (std::dynamic_pointer_cast<SnippetContentCaret>(variable))
            RC_ASSERT(variable->location == locations[next++]);
    }
}

TEST(FieldMerging, MergesWhatTheParserMade) {
    ContentWorld world;
    world.add("sh", "echo 【field:what】;", ContentType::ShellScript);
    const auto content = world.expand("Dear 【field:name】,【snippet:sh】【|】");
    content->fields()[0]->value = u"Jo";
    content->fields()[1]->value = u"hello";
    SnippetParser::mergeFields(*content);
    EXPECT_EQ(notation(*content), "Dear Jo,echo hello;");
    EXPECT_EQ(content->abbreviations()[0]->location, 8u);
    EXPECT_EQ(content->abbreviations()[0]->scriptLength, 11u);
    EXPECT_EQ(content->caretLocation(), 19);
}

}  // namespace
}  // namespace plume

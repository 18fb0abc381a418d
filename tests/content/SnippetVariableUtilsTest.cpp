#include "content/SnippetVariableUtils.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include "Foundation/Strings.h"
#include "Foundation/text/CSV.h"
#include "content/SnippetDateTimeVariable.h"

namespace plume {
namespace {

struct BodyCase {
    const char* what;
    std::u16string body;
    VariableParams params;
};

TEST(ParseParams, ReadsBodies) {
    const BodyCase cases[] = {
        {"one", u"date:short", {{u"date", u"short"}}},
        {"several", u"key:↩ code:36 count:3", {{u"key", u"↩"}, {u"code", u"36"}, {u"count", u"3"}}},
        {"no value", u"clipboard", {{u"clipboard", u""}}},
        {"empty value", u"field: type:1", {{u"field", u""}, {u"type", u"1"}}},
        {"quoted value", u"time:\"HH:mm\" locale:de", {{u"time", u"HH:mm"}, {u"locale", u"de"}}},
        {"bare pattern is cut at its colon", u"time:HH:mm hour:1", {{u"time", u"HH"}, {u"hour", u"1"}}},
        {"doubled quotes", u"field:\"a \"\"b\"\"\"", {{u"field", u"a \"b\""}}},
        {"quoted name", u"\"a b\":c", {{u"a b", u"c"}}},
        {"empty", u"", {}},
        {"starts with a space", u" date:short", {}},
        {"doubled and trailing spaces", u"a:1   b:2  ", {{u"a", u"1"}, {u"b", u"2"}}},
        {"later one counts", u"a:1 a:2 a", {{u"a", u""}}},
        {"stray quote", u"a:x\"y b:2", {{u"a", u"x"}}},
        {"text after a quoted value", u"a:\"x\"y b:2", {{u"a", u"x"}}},
        {"quote without an end", u"a:1 b:\"x c:3", {{u"a", u"1"}, {u"b", u""}}},
        {"quote without an end after a doubled one", u"a:\"x\"\"y", {{u"a", u""}}},
        {"quote without an end in the name", u"a:1 \"b", {{u"a", u"1"}}},
        {"newlines are text", u"field:N value:a\nb c:d", {{u"field", u"N"}, {u"value", u"a\nb"}, {u"c", u"d"}}},
        {"empty name", u":x", {{u"", u"x"}}}};
    for (const BodyCase& c : cases) EXPECT_EQ(SnippetVariableUtils::parseParams(c.body), c.params) << c.what;
}

VariableParams paramsOfRows(const std::u16string& body) {
    VariableParams params;
    CSVParser parser(body, u":", CharacterSet::withCharacters(u" "), false, {u"Name", u"Value"});
    const auto rows = parser.arrayOfParsedRows();
    if (!rows) return params;
    for (const auto& row : *rows) {
        const auto value = row.find(u"Value");
        params.insert_or_assign(row.at(u"Name"), value == row.end() ? std::u16string() : value->second);
    }
    return params;
}

std::u16string anyText(const std::string& alphabet) {
    return fromUtf8(*rc::gen::container<std::string>(rc::gen::elementOf(alphabet)));
}

RC_GTEST_PROP(ParseParams, ReadsWhatTheReaderOfRowsReads, ()) {
    const std::u16string body = anyText("ab :\"\n");
    RC_ASSERT(SnippetVariableUtils::parseParams(body) == paramsOfRows(body));
}

RC_GTEST_PROP(EscapeParam, IsReadBackAsItWas, ()) {
    const std::u16string first = anyText("ab :\"\n");
    const std::u16string second = anyText("ab :\"\n");
    const VariableParams params = SnippetVariableUtils::parseParams(
        u"first:" + SnippetVariableUtils::escapeParam(first) + u" second:" + SnippetVariableUtils::escapeParam(second));
    RC_ASSERT(params == (VariableParams{{u"first", first}, {u"second", second}}));
}

TEST(EscapeParam, QuotesOnlyWhatNeedsIt) {
    EXPECT_EQ(SnippetVariableUtils::escapeParam(u"short"), u"short");
    EXPECT_EQ(SnippetVariableUtils::escapeParam(u""), u"");
    EXPECT_EQ(SnippetVariableUtils::escapeParam(u"a\nb"), u"a\nb");
    EXPECT_EQ(SnippetVariableUtils::escapeParam(u"a b"), u"\"a b\"");
    EXPECT_EQ(SnippetVariableUtils::escapeParam(u"HH:mm"), u"\"HH:mm\"");
    EXPECT_EQ(SnippetVariableUtils::escapeParam(u"5\""), u"\"5\"\"\"");
}

template <typename Variable>
bool makes(std::u16string_view body) {
    return std::dynamic_pointer_cast<Variable>(SnippetVariableUtils::parseVariable(body)) != nullptr;
}

TEST(ParseVariable, ChoosesTheKindByThePrefix) {
    EXPECT_TRUE(makes<SnippetFieldVariable>(u"field"));
    EXPECT_TRUE(makes<SnippetFieldVariable>(u"fieldwork"));
    EXPECT_TRUE(makes<SnippetAbbreviationVariable>(u"snippet:abbr"));
    EXPECT_TRUE(makes<SnippetKeyVariable>(u"key:↩"));
    EXPECT_TRUE(makes<SnippetDateVariable>(u"date:"));
    EXPECT_TRUE(makes<SnippetTimeVariable>(u"time:short"));
    EXPECT_TRUE(makes<SnippetClipboardVariable>(u"clipboard"));
    EXPECT_TRUE(makes<SnippetClipboardVariable>(u"clipboards"));
    for (const char16_t* body : {u"", u"|", u"◀", u"date", u"Date:short", u" date:short", u"key", u"snippet", u"x"}) {
        EXPECT_EQ(SnippetVariableUtils::parseVariable(body), nullptr) << toUtf8(body);
    }
}

SharedAttributes size(double points) {
    TextAttributes attributes;
    attributes.font = FontAttribute{u"Times", points, false, false};
    return std::make_shared<const TextAttributes>(attributes);
}

std::string cellAt(const AttributedString& text, std::size_t index) {
    const SharedAttributes attributes = text.attributesAt(index);
    return attributes && attributes->attachment ? toUtf8(attributes->attachment->cellText) : "";
}

struct ChipCase {
    std::u16string content;
    std::u16string edited;
    std::vector<std::string> cells;
};

TEST(EditContent, ShowsPlaceholdersAsChips) {
    const ChipCase cases[] = {{u"a【date:short】b", u"a\uFFFCb", {"date:short"}},
                              {u"【|】【◀】【clipboard】", u"\uFFFC\uFFFC\uFFFC", {"|", "◀", "clipboard"}},
                              {u"【|】【|】", u"\uFFFC\uFFFC", {"|", "|"}},
                              {u"【unknown】 【date:short", u"【unknown】 【date:short", {}},
                              {u"】【】【", u"】【】【", {}},
                              {u"【a【key:↩】】", u"【a\uFFFC】", {"key:↩"}}};
    for (const ChipCase& c : cases) {
        const AttributedString edited = SnippetVariableUtils::convertToSnippetEditContent(AttributedString(c.content));
        EXPECT_EQ(toUtf8(edited.string()), toUtf8(c.edited));
        std::vector<std::string> cells;
        for (std::size_t i = 0; i < edited.length(); ++i) {
            if (const std::string cell = cellAt(edited, i); !cell.empty()) cells.push_back(cell);
        }
        EXPECT_EQ(cells, c.cells) << toUtf8(c.content);
    }
}

TEST(EditContent, GivesChipsTheLookOfTheOpeningMarker) {
    AttributedString content(u"a【", size(1));
    content.append(u"date:short", size(2));
    content.append(u"】b", size(3));
    const AttributedString edited = SnippetVariableUtils::convertToSnippetEditContent(content);
    ASSERT_EQ(edited.length(), 3U);
    EXPECT_EQ(edited.attributesAt(1)->font->size, 1);

    AttributedString back(u"a【date:short】", size(1));
    back.append(u"b", size(3));
    EXPECT_EQ(SnippetVariableUtils::convertFromSnippetEditContent(edited), back);
}

TEST(EditContent, LeavesAttachedFilesAlone) {
    TextAttributes file;
    file.attachment = std::make_shared<const TextAttachment>(TextAttachment{u"a.png", "bytes", u""});
    AttributedString content(u"\uFFFC", std::make_shared<const TextAttributes>(file));
    content.append(u"\uFFFC");
    EXPECT_EQ(SnippetVariableUtils::convertFromSnippetEditContent(content), content);
}

TEST(EditContent, TurnsANewChipIntoItsPlaceholder) {
    const AttributedString chip = SnippetVariableUtils::attributedStringFromVariable(u"field:Name");
    EXPECT_EQ(chip.length(), 1U);
    EXPECT_EQ(SnippetVariableUtils::convertFromSnippetEditContent(chip), AttributedString(u"【field:Name】"));
}

RC_GTEST_PROP(EditContent, ComesBackAsItWas, ()) {
    const auto pieces =
        *rc::gen::container<std::vector<std::string>>(rc::gen::element<std::string>("【", "】", "date:x", "|", "a"));
    AttributedString content;
    for (const std::string& piece : pieces) content.append(fromUtf8(piece), size(4));
    const AttributedString edited = SnippetVariableUtils::convertToSnippetEditContent(content);
    RC_ASSERT(SnippetVariableUtils::convertFromSnippetEditContent(edited) == content);
}

}  // namespace
}  // namespace plume

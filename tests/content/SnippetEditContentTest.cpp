#include "content/SnippetEditContent.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include "Foundation/Strings.h"

namespace plume {
namespace {

SharedAttributes size(double points) {
    TextAttributes attributes;
    attributes.font = FontAttribute{u"Times", points, false, false};
    return std::make_shared<const TextAttributes>(attributes);
}

// The text, with the cell's text of a chip in angle brackets.
std::string shown(const AttributedString& text) {
    std::string result;
    for (std::size_t i = 0; i < text.length(); ++i) {
        const SharedAttributes attributes = text.attributesAt(i);
        const bool isChip = text.string()[i] == u'\uFFFC' && attributes && attributes->attachment;
        result += isChip ? "<" + toUtf8(attributes->attachment->cellText) + ">" : toUtf8(text.string().substr(i, 1));
    }
    return result;
}

TEST(SnippetEditContent, ShowsPlaceholdersAsChips) {
    const struct {
        const char16_t* content;
        const char* edited;
    } cases[] = {
        {u"a【date:short】b", "a<date:short>b"},
        {u"【|】【◀】【clipboard】【|】", "<|><◀><clipboard><|>"},
        {u"【unknown】 【】【date:short", "【unknown】 【】【date:short"},
        {u"】【】【", "】【】【"},
        {u"【a【key:↩】】", "【a<key:↩>】"},
    };
    for (const auto& [content, edited] : cases) {
        EXPECT_EQ(shown(convertToSnippetEditContent(AttributedString(content))), edited);
    }
}

TEST(SnippetEditContent, GivesChipsTheLookOfTheOpeningMarker) {
    AttributedString content(u"a【", size(1));
    content.append(u"date:short", size(2));
    content.append(u"】b", size(3));
    const AttributedString edited = convertToSnippetEditContent(content);
    ASSERT_EQ(edited.length(), 3U);
    EXPECT_EQ(edited.attributesAt(1)->font->size, 1);

    AttributedString back(u"a【date:short】", size(1));
    back.append(u"b", size(3));
    EXPECT_EQ(convertFromSnippetEditContent(edited), back);
}

TEST(SnippetEditContent, LeavesAttachedFilesAlone) {
    TextAttributes file;
    file.attachment = std::make_shared<const TextAttachment>(TextAttachment{u"a.png", "bytes", u""});
    AttributedString content(u"\uFFFC", std::make_shared<const TextAttributes>(file));
    content.append(u"\uFFFC");
    EXPECT_EQ(convertFromSnippetEditContent(content), content);
}

TEST(SnippetEditContent, TurnsANewChipIntoItsPlaceholder) {
    const AttributedString chip = attributedStringFromVariable(u"field:Name");
    EXPECT_EQ(chip.length(), 1U);
    EXPECT_EQ(convertFromSnippetEditContent(chip), AttributedString(u"【field:Name】"));
}

RC_GTEST_PROP(SnippetEditContent, ComesBackAsItWas, ()) {
    const auto pieces =
        *rc::gen::container<std::vector<std::string>>(rc::gen::element<std::string>("【", "】", "date:x", "|", "a"));
    AttributedString content;
    for (const std::string& piece : pieces) content.append(fromUtf8(piece), size(4));
    const AttributedString edited = convertToSnippetEditContent(content);
    RC_ASSERT(convertFromSnippetEditContent(edited) == content);
}

}  // namespace
}  // namespace plume

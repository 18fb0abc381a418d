#include "library/LibraryFile.h"

#include <gtest/gtest.h>

#include "Foundation/text/TextAttributes.h"

namespace plume {

namespace {

// Two groups with everything that differs from a new record.
LibraryFile::Groups fullLibrary() {
    const auto group = SnippetGroup::make();
    group->setName(u"Mail \u65E5\u672C");
    group->setAbbreviationPrefix(u";");
    group->setExpandAfter(ExpandAfter::Digits);
    group->setExpandAfterDelimiters(CharacterSet::withCharacters(u"-\r"));
    group->setExpandTrigger(ExpandTrigger::HotKey);
    group->setDelimiters(CharacterSet::withCharacters(u" \t\""));
    group->setCaseSensitivity(CaseSensitivity::IgnoreCase);
    group->setResetFormatting(true);
    group->setSuggestAbbreviations(false);
    group->setShowInMenuBar(false);
    group->availability() = {1, {{u"org.example.a", u"b"}}, 2, std::vector<std::u16string>()};

    const auto plain = std::make_shared<Snippet>(u"sig", u"Best\n\u3010|\u3011 \U0001F600");
    plain->setCaseSensitivity(CaseSensitivity::IgnoreCaseAndAdapt);
    plain->setLabel(u"Signature");
    plain->setNote(u"a note");
    const auto script = std::make_shared<Snippet>(std::nullopt, u"date");
    script->setContentType(ContentType::ShellScript);
    const auto rich = std::make_shared<Snippet>(u"b", std::nullopt);
    rich->setContentType(ContentType::RichText);
    auto bold = std::make_shared<TextAttributes>();
    bold->font = FontAttribute{u"Helvetica", 12, true, false};
    AttributedString text;
    text.append(u"bold", bold);
    text.append(u" plain", nullptr);
    rich->setRichTextContent(text);
    group->addItems({plain, script, rich, std::make_shared<Snippet>()});
    return {group, SnippetGroup::make()};
}

}  // namespace

TEST(LibraryFile, GivesBackWhatItWrote) {
    const LibraryFile::Groups before = fullLibrary();
    const std::string written = LibraryFile::write(before);
    const Result<LibraryFile::Groups> read = LibraryFile::read(written, "l.json");
    ASSERT_TRUE(read.ok()) << read.error().message;
    ASSERT_EQ(read.value().size(), 2u);

    const SnippetGroup& a = *before[0];
    const SnippetGroup& b = *read.value()[0];
    EXPECT_EQ(b.name(), a.name());
    EXPECT_EQ(b.abbreviationPrefix(), a.abbreviationPrefix());
    EXPECT_EQ(b.expandAfter(), a.expandAfter());
    EXPECT_EQ(b.expandAfterDelimiters(), a.expandAfterDelimiters());
    EXPECT_EQ(b.expandTrigger(), a.expandTrigger());
    EXPECT_EQ(b.delimiters(), a.delimiters());
    EXPECT_EQ(b.caseSensitivity(), a.caseSensitivity());
    EXPECT_EQ(b.resetFormatting(), a.resetFormatting());
    EXPECT_EQ(b.suggestAbbreviations(), a.suggestAbbreviations());
    EXPECT_EQ(b.showInMenuBar(), a.showInMenuBar());
    EXPECT_EQ(b.availability(), a.availability());
    ASSERT_EQ(b.items().size(), a.items().size());
    for (std::size_t i = 0; i < a.items().size(); ++i) {
        const Snippet& original = *a.items()[i];
        const Snippet& copy = *b.items()[i];
        EXPECT_EQ(copy.uuid(), original.uuid());
        EXPECT_EQ(copy.abbreviation(), original.abbreviation());
        EXPECT_EQ(copy.label(), original.label());
        EXPECT_EQ(copy.note(), original.note());
        EXPECT_EQ(copy.plainTextContent(), original.plainTextContent());
        EXPECT_EQ(copy.hasContent(), original.hasContent());
        EXPECT_TRUE(copy.isContentEqualTo(original)) << i;
    }
    EXPECT_EQ(LibraryFile::write(read.value()), written);
}

TEST(LibraryFile, LeavesNewRecordsAsTheyAre) {
    const auto read = LibraryFile::read(R"([{"items": [{}]}, {"name": null, "delimiters": null}])", "l.json");
    ASSERT_TRUE(read.ok()) << read.error().message;
    const SnippetGroup& group = *read.value()[0];
    EXPECT_EQ(group.name(), std::nullopt);
    EXPECT_TRUE(group.showInMenuBar());
    EXPECT_TRUE(group.suggestAbbreviations());
    EXPECT_EQ(group.delimiters(), std::nullopt);
    EXPECT_EQ(group.items()[0]->parentGroup().get(), &group);
    EXPECT_FALSE(group.items()[0]->hasContent());
    EXPECT_TRUE(group.items()[0]->uuid().has_value());
}

TEST(LibraryFile, TakesALineFeedAmongDelimitersForReturn) {
    const auto read = LibraryFile::read(R"([{"delimiters": " \n"}])", "l.json");
    ASSERT_TRUE(read.ok());
    EXPECT_EQ(read.value()[0]->delimiters(), CharacterSet::withCharacters(u" \r"));
}

}  // namespace plume

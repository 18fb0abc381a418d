#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Foundation/text/RTFD.h"
#include "library/AbbreviationHash.h"
#include "library/Snippet.h"
#include "tests/library/LibrarySupport.h"
#include "tests/support/MemoryCoder.h"

namespace plume {
namespace {

using namespace std::chrono_literals;
using test::MemoryArchive;
using test::MemoryDecoder;
using test::MemoryEncoder;
using test::MemoryValue;
using test::StoppedDate;
using testing::ElementsAre;

Snippet read(const MemoryArchive& archive) {
    return Snippet(MemoryDecoder(archive));
}

const MemoryValue& valueOf(const MemoryArchive& archive, std::string_view key) {
    static const MemoryValue missing = std::u16string(u"(missing)");
    const MemoryValue* value = archive.find(key);
    return value ? *value : missing;
}

TEST(SnippetArchive, HoldsAllKeysInOrder) {
    Snippet snippet(u"sig", u"Best regards");
    snippet.setLabel(u"Signature");
    snippet.setNote(u"note");
    const MemoryArchive archive = MemoryEncoder::encode(snippet);
    EXPECT_EQ(archive.className(), "Snippet");
    EXPECT_THAT(archive.keysAndKinds(),
                ElementsAre("UUID:string", "Abbreviation:string", "Label:string", "ContentType:integer",
                            "CaseSensitivity:integer", "DateCreated:date", "DateModified:date", "LastTimeUsed:date",
                            "Note:string", "Content:string"));
    EXPECT_EQ(valueOf(archive, "UUID"), MemoryValue(snippet.uuid()->toString()));
    EXPECT_EQ(valueOf(archive, "Content"), MemoryValue(std::u16string(u"Best regards")));
}

TEST(SnippetArchive, LeavesMissingObjectsOut) {
    EXPECT_THAT(MemoryEncoder::encode(Snippet()).keysAndKinds(),
                ElementsAre("UUID:string", "ContentType:integer", "CaseSensitivity:integer", "DateCreated:date",
                            "DateModified:date", "LastTimeUsed:date"));
}

TEST(SnippetArchive, KeepsAnEmptyContent) {
    EXPECT_EQ(valueOf(MemoryEncoder::encode(Snippet(u"a", u"")), "Content"), MemoryValue(std::u16string()));
}

TEST(SnippetArchive, HoldsFormattingForAllTypesButPlainText) {
    Snippet snippet;
    snippet.setRichTextContent(test::richText());
    EXPECT_EQ(valueOf(MemoryEncoder::encode(snippet), "Content"), MemoryValue(std::u16string(u"plain bold")));
    for (const std::int64_t type : {1, 2, 3, 4}) {
        snippet.setContentType(static_cast<ContentType>(type));
        EXPECT_EQ(valueOf(MemoryEncoder::encode(snippet), "Content"), MemoryValue(test::richText())) << type;
    }
}

TEST(SnippetArchive, ReadsBackWhatWasWritten) {
    StoppedDate date;
    Snippet snippet(u"Sig", u"text");
    snippet.setLabel(u"Signature");
    snippet.setNote(u"note");
    snippet.setCaseSensitivity(static_cast<CaseSensitivity>(-5));
    snippet.setContentType(static_cast<ContentType>(17));
    snippet.setRichTextContent(test::richText());
    date.pass(60s);
    snippet.updateLastTimeUsed();
    date.pass(60s);
    const MemoryArchive archive = MemoryEncoder::encode(snippet);
    const Snippet back = read(archive);
    EXPECT_EQ(back.uuid(), snippet.uuid());
    EXPECT_EQ(back.abbreviation(), u"Sig");
    EXPECT_EQ(back.abbreviationHash(), hashOfSuffix(u"sig"));
    EXPECT_EQ(back.label(), u"Signature");
    EXPECT_EQ(back.note(), u"note");
    EXPECT_EQ(back.caseSensitivity(), static_cast<CaseSensitivity>(-5));
    EXPECT_EQ(back.contentType(), static_cast<ContentType>(17));
    EXPECT_EQ(back.richTextContent(), test::richText());
    EXPECT_EQ(back.dateCreated(), snippet.dateCreated());
    EXPECT_EQ(back.dateModified(), snippet.dateModified());
    EXPECT_EQ(back.lastTimeUsed(), snippet.lastTimeUsed());
}

TEST(SnippetArchive, AnEmptyArchiveGivesASnippetWithoutDates) {
    const Snippet snippet = read(MemoryArchive());
    EXPECT_TRUE(snippet.uuid().has_value());
    EXPECT_EQ(snippet.abbreviation(), std::nullopt);
    EXPECT_EQ(snippet.abbreviationHash(), EmptySuffixHash);
    EXPECT_EQ(snippet.contentType(), ContentType::PlainText);
    EXPECT_EQ(snippet.caseSensitivity(), CaseSensitivity::CaseSensitive);
    EXPECT_FALSE(snippet.hasContent());
    EXPECT_EQ(snippet.dateCreated(), std::nullopt);
    EXPECT_EQ(snippet.dateModified(), std::nullopt);
    EXPECT_EQ(snippet.lastTimeUsed(), std::nullopt);
}

TEST(SnippetArchive, ASnippetThatWasReadRemembersChanges) {
    StoppedDate date;
    const MemoryArchive archive;
    Snippet snippet{MemoryDecoder(archive)};
    snippet.setLabel(u"label");
    EXPECT_EQ(snippet.dateModified(), date.now());
}

TEST(SnippetArchive, AnIdentityThatIsNoUuidIsNone) {
    for (const MemoryValue& value : {MemoryValue(std::u16string(u"not a uuid")), MemoryValue(std::int64_t{7})}) {
        const MemoryArchive archive = MemoryArchive().set("UUID", value);
        EXPECT_EQ(read(archive).uuid(), std::nullopt);
        EXPECT_EQ(MemoryEncoder::encode(read(archive)).find("UUID"), nullptr);
    }
}

TEST(SnippetArchive, FormattingOfAPlainTextSnippetIsReadAsItStands) {
    const MemoryArchive archive = MemoryArchive().set("Content", test::richText());
    const Snippet snippet = read(archive);
    EXPECT_EQ(snippet.contentType(), ContentType::PlainText);
    EXPECT_EQ(snippet.richTextContent(), test::richText());
}

TEST(SnippetArchive, ReadsContentsOfOlderLibraries) {
    MemoryArchive archive;
    archive.set("ContentType", std::int64_t{1});
    archive.set("Content", ArchivedData{rtfdFromAttributedString(test::richText())});
    const Snippet snippet = read(archive);
    ASSERT_TRUE(snippet.hasContent());
    EXPECT_EQ(snippet.plainTextContent(), u"plain bold");
    const auto attributes = snippet.richTextContent()->attributesAt(7);
    ASSERT_TRUE(attributes && attributes->font);
    EXPECT_TRUE(attributes->font->bold);
}

TEST(SnippetArchive, AnUnreadableContentIsWrittenBackUntilThereIsAnother) {
    const ArchivedData damaged{std::string("rtfd\0\0\0", 7)};
    const MemoryArchive archive = MemoryArchive().set("Content", damaged);
    Snippet snippet{MemoryDecoder(archive)};
    EXPECT_FALSE(snippet.hasContent());
    EXPECT_EQ(valueOf(MemoryEncoder::encode(snippet), "Content"), MemoryValue(damaged));
    EXPECT_EQ(valueOf(MemoryEncoder::encode(*snippet.copySnippet()), "Content"), MemoryValue(damaged));
    snippet.setPlainTextContent(std::nullopt);
    EXPECT_EQ(MemoryEncoder::encode(snippet).find("Content"), nullptr);
}

}  // namespace
}  // namespace plume

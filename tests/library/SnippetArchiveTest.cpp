#include <gtest/gtest.h>

#include "Foundation/text/RTFD.h"
#include "library/Snippet.h"
#include "tests/library/LibrarySupport.h"
#include "tests/support/MemoryCoder.h"

namespace plume {
namespace {

using namespace std::chrono_literals;
using test::fieldsOf;
using test::MemoryArchive;
using test::MemoryDecoder;
using test::MemoryEncoder;
using test::MemoryValue;
using test::StoppedDate;

MemoryValue contentWritten(const Snippet& snippet) {
    return MemoryEncoder::encode(snippet).valueOf("Content");
}

Snippet read(std::string_view key, const MemoryValue& value) {
    return Snippet(MemoryDecoder(MemoryArchive().add(key, value)));
}

TEST(SnippetArchive, HoldsItsKeysInOrderAndLeavesMissingObjectsOut) {
    Snippet snippet(u"sig", u"Best regards");
    snippet.setLabel(u"Signature");
    snippet.setNote(u"note");
    const MemoryArchive archive = MemoryEncoder::encode(snippet);
    EXPECT_EQ(archive.className, "Snippet");
    EXPECT_EQ(archive.layout(),
              "UUID:string Abbreviation:string Label:string ContentType:integer CaseSensitivity:integer "
              "DateCreated:date DateModified:date LastTimeUsed:date Note:string Content:string ");
    EXPECT_EQ(archive.valueOf("UUID"), MemoryValue(snippet.uuid()->toString()));
    EXPECT_EQ(MemoryEncoder::encode(Snippet()).layout(),
              "UUID:string ContentType:integer CaseSensitivity:integer DateCreated:date DateModified:date "
              "LastTimeUsed:date ");
}

TEST(SnippetArchive, HoldsFormattingForAllTypesButPlainText) {
    EXPECT_EQ(contentWritten(Snippet(u"a", u"")), MemoryValue(std::u16string()));
    Snippet snippet;
    snippet.setRichTextContent(test::richText());
    EXPECT_EQ(contentWritten(snippet), MemoryValue(std::u16string(u"plain bold")));
    for (const std::int64_t type : {1, 2, 3, 4}) {
        snippet.setContentType(static_cast<ContentType>(type));
        EXPECT_EQ(contentWritten(snippet), MemoryValue(test::richText())) << type;
    }
}

TEST(SnippetArchive, ReadsBackWhatWasWritten) {
    StoppedDate date;
    const auto snippet = test::fullSnippet();
    date.pass(60s);
    // Values that have no name are kept.
    snippet->setCaseSensitivity(static_cast<CaseSensitivity>(-5));
    snippet->setContentType(static_cast<ContentType>(17));
    date.pass(60s);
    snippet->updateLastTimeUsed();
    const MemoryArchive archive = MemoryEncoder::encode(*snippet);
    const Snippet back{MemoryDecoder(archive)};
    EXPECT_EQ(fieldsOf(back), fieldsOf(*snippet));
    EXPECT_EQ(MemoryEncoder::encode(back), archive);
    EXPECT_EQ(back.dateModified(), date.now() - 60s);
}

TEST(SnippetArchive, AnEmptyArchiveGivesASnippetWithoutDatesThatRemembersChanges) {
    StoppedDate date;
    Snippet snippet{MemoryDecoder(MemoryArchive())};
    EXPECT_EQ(fieldsOf(snippet), fieldsOf(Snippet()));
    EXPECT_TRUE(snippet.uuid().has_value());
    EXPECT_EQ(snippet.dateCreated(), std::nullopt);
    EXPECT_EQ(snippet.dateModified(), std::nullopt);
    EXPECT_EQ(snippet.lastTimeUsed(), std::nullopt);
    snippet.setLabel(u"label");
    EXPECT_EQ(snippet.dateModified(), date.now());
}

TEST(SnippetArchive, AnIdentityThatIsNoUuidIsNone) {
    for (const MemoryValue& value : {MemoryValue(std::u16string(u"not a uuid")), MemoryValue(std::int64_t{7})}) {
        EXPECT_EQ(read("UUID", value).uuid(), std::nullopt);
        EXPECT_EQ(MemoryEncoder::encode(read("UUID", value)).valueOf("UUID"), MemoryValue());
    }
}

TEST(SnippetArchive, ReadsFormattingWhateverTheTypeAndContentsOfOlderLibraries) {
    EXPECT_EQ(read("Content", test::richText()).contentType(), ContentType::PlainText);
    EXPECT_EQ(read("Content", test::richText()).richTextContent(), test::richText());
    const Snippet older = read("Content", ArchivedData{rtfdFromAttributedString(test::richText())});
    EXPECT_EQ(older.richTextContent(), test::richText());
}

TEST(SnippetArchive, AnUnreadableContentIsWrittenBackUntilThereIsAnother) {
    const ArchivedData damaged{std::string("rtfd\0\0\0", 7)};
    Snippet snippet{MemoryDecoder(MemoryArchive().add("Content", damaged))};
    EXPECT_FALSE(snippet.hasContent());
    EXPECT_EQ(contentWritten(snippet), MemoryValue(damaged));
    EXPECT_EQ(contentWritten(*snippet.copySnippet()), MemoryValue(damaged));
    snippet.setPlainTextContent(std::nullopt);
    EXPECT_EQ(contentWritten(snippet), MemoryValue());
}

}  // namespace
}  // namespace plume

#include <gtest/gtest.h>

#include <cstdint>
#include <limits>
#include <string>
#include <vector>

#include "library/SnippetGroup.h"
#include "tests/library/LibrarySupport.h"
#include "tests/support/MemoryCoder.h"

namespace plume {
namespace {

using test::MemoryArchive;
using test::MemoryDecoder;
using test::MemoryEncoder;
using test::MemoryValue;
using test::StoppedDate;

using Strings = std::vector<std::u16string>;

std::shared_ptr<SnippetGroup> read(const MemoryArchive& archive) {
    return SnippetGroup::makeWithCoder(MemoryDecoder(archive));
}

std::shared_ptr<SnippetGroup> readBack(const SnippetGroup& group) {
    return read(MemoryEncoder::encode(group));
}

TEST(SnippetGroupArchive, HoldsItsKeysInOrderAndLeavesOutWhatIsNotSet) {
    const auto group = SnippetGroup::make();
    group->setName(u"Letters");
    EXPECT_EQ(MemoryEncoder::encode(*group).className, "SnippetGroup");
    EXPECT_EQ(MemoryEncoder::encode(*group).layout(),
              "UUID:string DateCreated:date Name:string Items:objects ExpandAfter:integer ExpandTrigger:integer "
              "CaseSensitivity:integer ShowInMenuBar:bool SuggestAbbreviations:bool EnabledIn:integer "
              "InputMethodsOption:integer ResetFormatting:bool ");
    EXPECT_EQ(MemoryEncoder::encode(*test::fullGroup()).layout(),
              "UUID:string DateCreated:date Name:string Items:objects ExpandAfter:integer "
              "ExpandAfterDelimiters:characterSet ExpandTrigger:integer Delimiters:characterSet "
              "CaseSensitivity:integer ShowInMenuBar:bool SuggestAbbreviations:bool AbbreviationPrefix:string "
              "EnabledIn:integer Applications:strings InputMethodsOption:integer InputMethods:strings "
              "ResetFormatting:bool ");
}

TEST(SnippetGroupArchive, ReadsBackWhatWasWritten) {
    const auto group = test::fullGroup();
    for (const bool suggests : {false, true}) {
        group->setSuggestAbbreviations(suggests);
        group->setAbbreviationPrefix(suggests ? u"" : u";");
        const auto back = readBack(*group);
        EXPECT_EQ(test::fieldsOf(*back), test::fieldsOf(*group));
        EXPECT_EQ(MemoryEncoder::encode(*back), MemoryEncoder::encode(*group));
        for (const auto& snippet : back->items()) EXPECT_EQ(snippet->parentGroup(), back);
    }
}

TEST(SnippetGroupArchive, WritesListsOnlyWhileTheirOptionUsesThemAndReadsThemAlways) {
    for (const std::int64_t option : {-1, 0, 1, 2, 3}) {
        const bool used = option == 1 || option == 2;
        const auto group = SnippetGroup::make();
        group->availability() = {option, Strings{u"org.mail"}, option, Strings{u"us"}};
        const auto back = readBack(*group);
        EXPECT_EQ(back->availability().availability, option);
        EXPECT_EQ(back->availability().inputMethodsOption, option);
        EXPECT_EQ(back->availability().applications.has_value(), used) << option;
        EXPECT_EQ(back->availability().inputMethods.has_value(), used) << option;
    }
    const auto group = read(MemoryArchive().add("Applications", Strings{u"org.mail"}));
    EXPECT_EQ(group->availability().applications, Strings{u"org.mail"});
}

TEST(SnippetGroupArchive, AnEmptyArchiveGivesTheDefaultsButNoSuggestions) {
    StoppedDate date;
    const auto group = read(MemoryArchive());
    const auto fresh = SnippetGroup::make();
    fresh->setSuggestAbbreviations(false);
    EXPECT_EQ(test::fieldsOf(*group), test::fieldsOf(*fresh));
    EXPECT_TRUE(group->uuid().has_value());
    EXPECT_EQ(group->dateCreated(), date.now());
}

TEST(SnippetGroupArchive, ReadsValuesOfAnotherKindAsNothing) {
    const std::u16string text = u"yes";
    EXPECT_FALSE(read(MemoryArchive().add("ShowInMenuBar", text))->showInMenuBar());
    EXPECT_EQ(read(MemoryArchive().add("UUID", text))->uuid(), std::nullopt);
    EXPECT_EQ(read(MemoryArchive().add("UUID", std::int64_t{7}))->uuid(), std::nullopt);
}

TEST(SnippetGroupArchive, KeepsSettingsThatHaveNoName) {
    constexpr std::int64_t TooMuch = std::int64_t{1} << 32;
    const std::pair<std::int64_t, std::int32_t> cases[] = {
        {5, 5},
        {-1, -1},
        {TooMuch, std::numeric_limits<std::int32_t>::max()},  // not cut down to a value with a meaning
        {std::numeric_limits<std::int64_t>::min(), std::numeric_limits<std::int32_t>::min()},
    };
    for (const auto& [stored, expected] : cases) {
        const auto group = readBack(*read(MemoryArchive().add("ExpandAfter", stored).add("ExpandTrigger", stored)));
        EXPECT_EQ(group->expandAfter(), static_cast<ExpandAfter>(expected)) << stored;
        EXPECT_EQ(group->expandTrigger(), static_cast<ExpandTrigger>(expected)) << stored;
    }
    EXPECT_EQ(readBack(*read(MemoryArchive().add("CaseSensitivity", TooMuch)))->caseSensitivity(),
              static_cast<CaseSensitivity>(TooMuch));
}

TEST(SnippetGroupArchive, LineFeedInDelimitersIsReadAsReturn) {
    const auto stored = CharacterSet::withCharacters(u"\n.");
    const auto group = read(MemoryArchive().add("Delimiters", stored).add("ExpandAfterDelimiters", stored));
    EXPECT_EQ(group->delimiters(), CharacterSet::withCharacters(u"\r."));
    EXPECT_EQ(group->expandAfterDelimiters(), CharacterSet::withCharacters(u"\r."));
}

}  // namespace
}  // namespace plume

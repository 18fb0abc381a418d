#include <gmock/gmock.h>
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
using testing::ElementsAre;

using Strings = std::vector<std::u16string>;

std::shared_ptr<SnippetGroup> read(const MemoryArchive& archive) {
    return SnippetGroup::makeWithCoder(MemoryDecoder(archive));
}

std::shared_ptr<SnippetGroup> readBack(const SnippetGroup& group) {
    return read(MemoryEncoder::encode(group));
}

TEST(SnippetGroupArchive, OfANewGroupLeavesOutWhatIsNotSet) {
    const auto group = SnippetGroup::make();
    group->setName(u"Letters");
    const MemoryArchive archive = MemoryEncoder::encode(*group);
    EXPECT_EQ(archive.className(), "SnippetGroup");
    EXPECT_THAT(archive.keysAndKinds(),
                ElementsAre("UUID:string", "DateCreated:date", "Name:string", "Items:objects", "ExpandAfter:integer",
                            "ExpandTrigger:integer", "CaseSensitivity:integer", "ShowInMenuBar:bool",
                            "SuggestAbbreviations:bool", "EnabledIn:integer", "InputMethodsOption:integer",
                            "ResetFormatting:bool"));
}

TEST(SnippetGroupArchive, HoldsAllKeysInOrder) {
    const auto group = SnippetGroup::make();
    group->setName(u"Letters");
    group->setExpandAfterDelimiters(CharacterSet::withCharacters(u","));
    group->setDelimiters(CharacterSet::withCharacters(u"."));
    group->setAbbreviationPrefix(u";");
    group->availability() = {PLFunctionAvailability::OnlyListed, Strings{u"org.mail"},
                             PLFunctionAvailability::ExceptListed, Strings{u"us"}};
    EXPECT_THAT(MemoryEncoder::encode(*group).keysAndKinds(),
                ElementsAre("UUID:string", "DateCreated:date", "Name:string", "Items:objects", "ExpandAfter:integer",
                            "ExpandAfterDelimiters:characterSet", "ExpandTrigger:integer", "Delimiters:characterSet",
                            "CaseSensitivity:integer", "ShowInMenuBar:bool", "SuggestAbbreviations:bool",
                            "AbbreviationPrefix:string", "EnabledIn:integer", "Applications:strings",
                            "InputMethodsOption:integer", "InputMethods:strings", "ResetFormatting:bool"));
}

TEST(SnippetGroupArchive, HoldsListsOnlyWhileTheirOptionUsesThem) {
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
}

TEST(SnippetGroupArchive, KeepsEmptyListsAndPrefixes) {
    const auto group = SnippetGroup::make();
    group->setAbbreviationPrefix(u"");
    group->availability() = {1, Strings{}, 2, Strings{}};
    const auto back = readBack(*group);
    EXPECT_EQ(back->abbreviationPrefix(), u"");
    EXPECT_EQ(back->availability(), group->availability());
}

TEST(SnippetGroupArchive, ReadsBackWhatWasWritten) {
    const auto group = SnippetGroup::make();
    group->setName(u"Letters");
    group->addItems({test::snippet(u"a"), test::snippet(u"b")});
    group->setExpandAfter(ExpandAfter::Digits);
    group->setExpandAfterDelimiters(CharacterSet::withCharacters(u",;"));
    group->setExpandTrigger(ExpandTrigger::HotKey);
    group->setDelimiters(CharacterSet::withCharacters(u".\t"));
    group->setCaseSensitivity(CaseSensitivity::IgnoreCaseAndAdapt);
    group->setShowInMenuBar(false);
    group->setSuggestAbbreviations(true);
    group->setAbbreviationPrefix(u";");
    group->setResetFormatting(true);
    const auto back = readBack(*group);
    EXPECT_EQ(back->uuid(), group->uuid());
    EXPECT_EQ(back->dateCreated(), group->dateCreated());
    EXPECT_EQ(back->name(), u"Letters");
    EXPECT_EQ(back->expandAfter(), ExpandAfter::Digits);
    EXPECT_EQ(back->expandAfterDelimiters(), group->expandAfterDelimiters());
    EXPECT_EQ(back->expandTrigger(), ExpandTrigger::HotKey);
    EXPECT_EQ(back->delimiters(), group->delimiters());
    EXPECT_EQ(back->caseSensitivity(), CaseSensitivity::IgnoreCaseAndAdapt);
    EXPECT_FALSE(back->showInMenuBar());
    EXPECT_TRUE(back->suggestAbbreviations());
    EXPECT_EQ(back->abbreviationPrefix(), u";");
    EXPECT_TRUE(back->resetFormatting());
    ASSERT_EQ(back->items().size(), 2U);
    EXPECT_EQ(back->items()[1]->abbreviation(), u"b");
    EXPECT_EQ(back->items()[1]->uuid(), group->items()[1]->uuid());
    for (const auto& snippet : back->items()) EXPECT_EQ(snippet->parentGroup(), back);
}

TEST(SnippetGroupArchive, AnEmptyArchiveGivesTheDefaultsButNoSuggestions) {
    StoppedDate date;
    const auto group = read(MemoryArchive());
    EXPECT_TRUE(group->uuid().has_value());
    EXPECT_EQ(group->dateCreated(), date.now());
    EXPECT_EQ(group->name(), std::nullopt);
    EXPECT_TRUE(group->items().empty());
    EXPECT_EQ(group->expandAfter(), ExpandAfter::Delimiter);
    EXPECT_EQ(group->expandAfterDelimiters(), std::nullopt);
    EXPECT_EQ(group->expandTrigger(), ExpandTrigger::Immediately);
    EXPECT_EQ(group->delimiters(), std::nullopt);
    EXPECT_TRUE(group->showInMenuBar());
    EXPECT_FALSE(group->suggestAbbreviations());
    EXPECT_EQ(group->abbreviationPrefix(), std::nullopt);
    EXPECT_EQ(group->availability(), PLFunctionAvailability());
    EXPECT_FALSE(group->resetFormatting());
}

TEST(SnippetGroupArchive, AMenuSettingOfAnotherKindIsOff) {
    EXPECT_FALSE(read(MemoryArchive().set("ShowInMenuBar", std::u16string(u"yes")))->showInMenuBar());
}

TEST(SnippetGroupArchive, AnIdentityThatIsNoUuidIsNone) {
    for (const MemoryValue& value : {MemoryValue(std::u16string(u"not a uuid")), MemoryValue(std::int64_t{7})}) {
        EXPECT_EQ(read(MemoryArchive().set("UUID", value))->uuid(), std::nullopt);
    }
}

TEST(SnippetGroupArchive, KeepsListsThatTheOptionDoesNotUseWhenTheyAreStored) {
    const auto group = read(MemoryArchive().set("Applications", Strings{u"org.mail"}));
    EXPECT_EQ(group->availability().applications, Strings{u"org.mail"});
}

TEST(SnippetGroupArchive, KeepsSettingsThatHaveNoName) {
    struct Case {
        std::int64_t stored;
        std::int32_t expected;
    };
    const Case cases[] = {
        {5, 5},
        {-1, -1},
        {std::int64_t{1} << 32, std::numeric_limits<std::int32_t>::max()},  // not cut down to a value with a meaning
        {std::numeric_limits<std::int64_t>::min(), std::numeric_limits<std::int32_t>::min()},
    };
    for (const Case& c : cases) {
        const auto group = readBack(*read(MemoryArchive().set("ExpandAfter", c.stored).set("ExpandTrigger", c.stored)));
        EXPECT_EQ(group->expandAfter(), static_cast<ExpandAfter>(c.expected)) << c.stored;
        EXPECT_EQ(group->expandTrigger(), static_cast<ExpandTrigger>(c.expected)) << c.stored;
    }
    const auto group = read(MemoryArchive().set("CaseSensitivity", std::int64_t{1} << 40));
    EXPECT_EQ(readBack(*group)->caseSensitivity(), static_cast<CaseSensitivity>(std::int64_t{1} << 40));
}

TEST(SnippetGroupArchive, LineFeedInDelimitersIsReadAsReturn) {
    const auto stored = CharacterSet::withCharacters(u"\n.");
    const auto group = read(MemoryArchive().set("Delimiters", stored).set("ExpandAfterDelimiters", stored));
    const auto expected = CharacterSet::withCharacters(u"\r.");
    EXPECT_EQ(group->delimiters(), expected);
    EXPECT_EQ(group->expandAfterDelimiters(), expected);
}

}  // namespace
}  // namespace plume

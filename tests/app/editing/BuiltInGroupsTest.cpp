#include "app/editing/BuiltInGroups.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <set>

#include "Foundation/Strings.h"
#include "app/ContentPreview.h"
#include "ports/posix/PosixFiles.h"
#include "tests/app/editing/EditedMachine.h"
#include "tests/content/world/ContentWorld.h"

namespace plume {
namespace {

using namespace test;
using ::testing::HasSubstr;
using ::testing::Not;

// The files of the source folder, which the tests run in.
struct BuiltInGroupsTest : ::testing::Test {
    std::shared_ptr<SnippetGroup> added(const std::string& name) {
        auto group = builtIn.addBuiltInGroup(name);
        if (!group) throw std::runtime_error(group.error().message);
        return group.value();
    }

    PosixFiles files;
    EditedMachine machine;
    BuiltInGroups builtIn{machine.editor, files, std::filesystem::absolute("data")};
};

// What comes out with "copied" in the clipboard.
std::string outcome(const std::shared_ptr<Snippet>& snippet, const SnippetGroups& groups) {
    ContentWorld world;
    world.pasteboard.plainText = "copied";
    const auto preview = previewOf(snippet, groups, world.environment, "en_US");
    return preview ? toUtf8(preview->text()) : "nothing";
}

TEST_F(BuiltInGroupsTest, EveryGroupExpandsWithoutLeftovers) {
    for (const std::string& name : BuiltInGroups::groupNames()) {
        SCOPED_TRACE(name);
        const auto group = added(name);
        EXPECT_EQ(machine.editor.groups().back(), group);
        EXPECT_EQ(toUtf8(*group->name()), name);
        EXPECT_GE(group->items().size(), 25U);
        EXPECT_LE(group->items().size(), 60U);
        const bool usesClipboard = name.find("Clipboard") != std::string::npos;
        for (const auto& snippet : group->items()) {
            SCOPED_TRACE(toUtf8(*snippet->abbreviation()));
            const std::string text = outcome(snippet, machine.editor.groups());
            EXPECT_THAT(text, Not(HasSubstr("【")));
            EXPECT_THAT(text, Not(HasSubstr("】")));
            EXPECT_NE(text, "");
            EXPECT_EQ(text.find("copied") != std::string::npos, usesClipboard) << text;
            EXPECT_TRUE(snippet->label().has_value());
        }
    }
}

// One that expands at once inside a longer one keeps that from ever being typed.
TEST_F(BuiltInGroupsTest, EveryAbbreviationOfEveryGroupCanBeTyped) {
    for (const std::string& name : BuiltInGroups::groupNames()) added(name);
    std::set<std::u16string> all;
    std::vector<std::u16string> immediate;
    for (const auto& group : machine.editor.groups()) {
        for (const auto& snippet : group->items()) {
            EXPECT_TRUE(all.insert(*snippet->abbreviationWithPrefix()).second) << toUtf8(*snippet->abbreviation());
            if (group->expandTrigger() == ExpandTrigger::Immediately) immediate.push_back(*snippet->abbreviation());
        }
    }
    for (const auto& shorter : immediate) {
        for (const auto& longer : all) {
            if (longer == shorter) continue;
            EXPECT_EQ(longer.find(shorter), std::u16string::npos) << toUtf8(shorter) << " in " << toUtf8(longer);
        }
    }
}

TEST_F(BuiltInGroupsTest, DictionariesAreGroupsOfCorrections) {
    const std::map<std::string, std::pair<std::string, std::string>> examples{
        {"English", {"recieve", "receive"}}, {"French", {"language", "langage"}}, {"German", {"seperat", "separat"}}};
    for (const std::string& language : BuiltInGroups::dictionaryLanguages()) {
        SCOPED_TRACE(language);
        const auto added = builtIn.addAutoCorrectDictionary(language);
        ASSERT_TRUE(added) << added.error().message;
        const SnippetGroup& group = *added.value();
        EXPECT_EQ(toUtf8(*group.name()), "AutoCorrect Dictionary (" + language + ")");
        EXPECT_EQ(group.expandTrigger(), ExpandTrigger::DelimiterKept);
        EXPECT_EQ(group.caseSensitivity(), CaseSensitivity::IgnoreCaseAndAdapt);
        EXPECT_GE(group.items().size(), language == "English" ? 600U : 300U);
        const auto& [misspelling, correction] = examples.at(language);
        const auto snippet = group.findSnippetWithAbbreviation(fromUtf8(misspelling));
        ASSERT_TRUE(snippet);
        EXPECT_EQ(toUtf8(*snippet->plainTextContent()), correction);
    }
}

TEST_F(BuiltInGroupsTest, WhatWasAddedCanBeTakenBackAndAddedAgain) {
    machine.addGroup(u"Mine", {u"a=b"});
    const std::string before = machine.bytes();
    const auto first = added("Symbol");
    const auto second = added("Symbol");
    EXPECT_NE(first->uuid(), second->uuid());
    EXPECT_EQ(machine.done.back().kind, EditKind::Addition);
    machine.editor.undo(machine.done.at(1));
    machine.editor.undo(machine.done.at(0));
    EXPECT_EQ(machine.bytes(), before);
}

TEST(BuiltInGroupsOfADamagedInstallation, AddNothingAndSayWhy) {
    const struct {
        const char* bytes;  // null: there is no file
        const char* groupError;
        const char* dictionaryError;
    } cases[] = {
        {nullptr, "/share/groups/Symbol.json", "/share/dictionaries/AutoCorrect Dictionary (English)"},
        {"", "/share/groups/Symbol.json", "expected pairs of lines"},
        {"[]", "there is no group in it", "expected pairs of lines"},
        {"[{\"name\": \"Symbol\"", "/share/groups/Symbol.json", "expected pairs of lines"},
        {"teh\xff\nthe\n", "/share/groups/Symbol.json", "expected text in UTF-8"},
    };
    for (const auto& each : cases) {
        SCOPED_TRACE(each.bytes ? each.bytes : "no file");
        EditedMachine machine;
        machine.addGroup(u"Mine", {u"a=b"});
        const std::string before = machine.bytes();
        SimulatedFiles files;
        for (const char* folder : {"/share", "/share/groups", "/share/dictionaries"}) {
            ASSERT_TRUE(files.createFolder(folder));
        }
        if (each.bytes) {
            ASSERT_TRUE(files.write("/share/groups/Symbol.json", each.bytes));
            ASSERT_TRUE(files.write("/share/dictionaries/AutoCorrect Dictionary (English)", each.bytes));
        }
        BuiltInGroups builtIn(machine.editor, files, "/share");
        const auto group = builtIn.addBuiltInGroup("Symbol");
        const auto dictionary = builtIn.addAutoCorrectDictionary("English");
        ASSERT_FALSE(group);
        ASSERT_FALSE(dictionary);
        EXPECT_THAT(group.error().message, HasSubstr(each.groupError));
        EXPECT_THAT(dictionary.error().message, HasSubstr(each.dictionaryError));
        EXPECT_THAT(dictionary.error().message, HasSubstr("AutoCorrect Dictionary (English)"));
        EXPECT_EQ(machine.bytes(), before);
        EXPECT_TRUE(machine.done.empty());
    }
}

}  // namespace
}  // namespace plume

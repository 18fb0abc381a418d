#include "app/editing/ImportPreview.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Foundation/Strings.h"
#include "import/Importers.h"
#include "tests/app/editing/EditedMachine.h"

namespace plume {
namespace {

using namespace test;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::SizeIs;

using Groups = std::vector<std::pair<std::u16string, std::vector<std::u16string>>>;

// Names with a colon stand for a name and a prefix.
SnippetGroups groupsOf(const Groups& described) {
    EditedMachine machine;
    for (const auto& [name, snippets] : described) {
        const std::size_t colon = name.find(u':');
        const bool hasPrefix = colon != std::u16string::npos;
        machine.addGroup(name.substr(0, colon), snippets, hasPrefix ? name.substr(colon + 1) : std::u16string());
    }
    return machine.editor.groups();
}

std::vector<std::string> conflictsOf(const ImportPreview& preview) {
    std::vector<std::string> lines;
    for (const auto& group : preview.groups) {
        for (const auto& conflict : group.conflicts) {
            lines.push_back(toUtf8(*group.group->name()) + "/" + toUtf8(*conflict.snippet->abbreviation()) +
                            (conflict.isSame ? " is " : " as ") + toUtf8(*conflict.withGroup->name()) + "/" +
                            toUtf8(*conflict.with->abbreviation()) + (conflict.isInLibrary ? "" : " (new)"));
        }
    }
    return lines;
}

TEST(ImportPreview, TellsWhichAbbreviationsAreTakenAndByWhom) {
    const struct {
        const char* name;
        Groups library;
        Groups imported;
        std::vector<std::string> conflicts;
    } cases[] = {
        {"nothing in common", {{u"A", {u"x=1"}}}, {{u"N", {u"y=1"}}}, {}},
        {"another content", {{u"A", {u"x=1"}}}, {{u"N", {u"x=2"}}}, {"N/x as A/x"}},
        {"the same content", {{u"A", {u"x=1"}}}, {{u"N", {u"x=1"}}}, {"N/x is A/x"}},
        {"the first of several", {{u"A", {u"x=1"}}, {u"B", {u"x=2"}}}, {{u"N", {u"x=2"}}}, {"N/x as A/x"}},
        {"another case", {{u"A", {u"x=1"}}}, {{u"N", {u"X=1"}}}, {}},
        {"with prefixes", {{u"A:;", {u"x=1"}}}, {{u"N", {u"x=1", u";x=2"}}}, {"N/;x as A/x"}},
        {"among what comes",
         {},
         {{u"M", {u"x=1"}}, {u"N", {u"x=1", u"y=1", u"y=2"}}},
         {"N/x is M/x (new)", "N/y as N/y (new)"}},
        {"no abbreviation", {{u"A", {u"=1"}}}, {{u"N", {u"=1"}}}, {}},
        {"only a prefix", {{u"A:;", {u"=1"}}}, {{u"N", {u";=1"}}}, {}},
    };
    for (const auto& each : cases) {
        SCOPED_TRACE(each.name);
        const SnippetGroups library = groupsOf(each.library);
        ImportedLibrary imported;
        imported.groups = groupsOf(each.imported);
        EXPECT_EQ(conflictsOf(importPreview(imported, library)), each.conflicts);
    }
}

// As importing does: the group of the system's replacements is filled anew, all others are added.
TEST(ImportPreview, WhatWillBeReplacedIsInNobodysWay) {
    const std::u16string system = SystemSubstitutionsGroup;
    const SnippetGroups library = groupsOf({{system, {u"omw=x"}}, {u"Mine", {u"brb=y"}}, {system, {u"ty=z"}}});
    ImportedLibrary imported;
    imported.groups = groupsOf({{system, {u"omw=1", u"brb=2", u"ty=3"}}, {u"Mine", {u"a=1"}}});
    const ImportPreview preview = importPreview(imported, library);
    ASSERT_THAT(preview.groups, SizeIs(2));
    EXPECT_TRUE(preview.groups[0].replaces);
    EXPECT_FALSE(preview.groups[1].replaces);
    EXPECT_EQ(preview.snippetCount(), 4U);
    EXPECT_THAT(conflictsOf(preview),
                ElementsAre(toUtf8(system) + "/brb as Mine/brb", toUtf8(system) + "/ty as " + toUtf8(system) + "/ty"));
    EXPECT_FALSE(importPreview(imported, groupsOf({{u"Other", {}}})).groups[0].replaces);
}

TEST(ImportPreview, ReadsFilesOrSaysWhyNot) {
    SimulatedFiles files;
    const struct {
        const char* path;
        const char* bytes;  // null: there is no file
        const char* error;  // null: none
        std::size_t snippets;
        bool asks;
    } cases[] = {
        {"/a.csv", "sig,Regards\nbtw,by the way\n", nullptr, 2, false},
        {"/macros.csv", "d,%Y-%m-%d\n", nullptr, 1, true},
        {"/percent.csv", "p,100 %\n", nullptr, 1, false},
        {"/none.json", "[]", nullptr, 0, false},
        {"/empty.csv", "", "/empty.csv: the file is empty", 0, false},
        {"/damaged.json", "[{", "/damaged.json", 0, false},
        {"/damaged.plume", "not an archive", "/damaged.plume", 0, false},
        {"/picture.png", "x", "/picture.png: no library has this ending", 0, false},
        {"/gone.csv", nullptr, "/gone.csv", 0, false},
    };
    for (const auto& each : cases) {
        SCOPED_TRACE(each.path);
        if (each.bytes) {
            ASSERT_TRUE(files.write(each.path, each.bytes));
        }
        const auto candidate = readForImport(each.path, files);
        EXPECT_EQ(candidate.ok(), each.error == nullptr);
        if (!candidate) {
            EXPECT_THAT(candidate.error().message, HasSubstr(each.error ? each.error : "nothing"));
            continue;
        }
        EXPECT_EQ(importPreview(candidate.value().library, {}).snippetCount(), each.snippets);
        EXPECT_EQ(candidate.value().converted.has_value(), each.asks);
    }
}

TEST(ImportPreview, KeepsTheRemarks) {
    SimulatedFiles files;
    ASSERT_TRUE(files.write("/keys.ahk", ":*:btw::by the way\n"));
    const auto candidate = readForImport("/keys.ahk", files);
    ASSERT_TRUE(candidate);
    EXPECT_EQ(importPreview(candidate.value().library, {}).remarks, candidate.value().library.remarks);
    EXPECT_THAT(candidate.value().library.remarks, Not(IsEmpty()));
}

}  // namespace
}  // namespace plume

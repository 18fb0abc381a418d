#include "app/editing/CopiedRows.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "app/editing/AbbreviationConflict.h"
#include "tests/app/editing/EditedMachine.h"

namespace plume {
namespace {

using test::EditedMachine;

class CopiedRowsTest : public testing::Test, protected EditedMachine {};

TEST_F(CopiedRowsTest, WhatWasCutComesBackAsItself) {
    const auto mail = addGroup(u"Mail", {u"a=1", u"b=2"}, u";");
    const auto work = addGroup(u"Work", {u"c=3"});
    const auto cut = mail->items().front();
    cut->setNote(u"mine");
    const std::string bytes = archiveOfRows({{work}, {cut}});
    editor.remove({{work}, {cut}});
    const auto rows = rowsOfArchive(bytes, editor.groups());
    ASSERT_TRUE(rows) << rows.error().message;
    ASSERT_EQ(rows.value().snippets.size(), 1U);
    ASSERT_EQ(rows.value().groups.size(), 1U);
    EXPECT_TRUE(rows.value().snippets.front()->isSameRecordAs(*cut));
    EXPECT_EQ(rows.value().groups.front()->uuid(), work->uuid());
    EXPECT_EQ(rows.value().groups.front()->items().front()->uuid(), work->items().front()->uuid());
}

TEST_F(CopiedRowsTest, WhatIsStillThereIsCopied) {
    const auto mail = addGroup(u"Mail", {u"a=1"}, u";");
    const std::string bytes = archiveOfRows({{mail}, mail->items()});
    const auto rows = rowsOfArchive(bytes, editor.groups());
    ASSERT_TRUE(rows);
    EXPECT_NE(rows.value().snippets.front()->uuid(), mail->items().front()->uuid());
    EXPECT_NE(rows.value().groups.front()->uuid(), mail->uuid());
    EXPECT_NE(rows.value().groups.front()->items().front()->uuid(), mail->items().front()->uuid());
    EXPECT_EQ(rows.value().groups.front()->abbreviationPrefix(), u";");
    // Pasted twice it is two.
    SnippetGroups pasted = editor.groups();
    pasted.push_back(rows.value().groups.front());
    EXPECT_NE(rowsOfArchive(bytes, pasted).value().groups.front()->uuid(), rows.value().groups.front()->uuid());
}

TEST_F(CopiedRowsTest, DamagedBytesAreAnError) {
    const auto mail = addGroup(u"Mail", {u"a=1"});
    const std::string bytes = archiveOfRows({{mail}, {}});
    for (std::size_t length = 0; length < bytes.size(); length += 7) {
        EXPECT_FALSE(rowsOfArchive(bytes.substr(0, length), {})) << length;
    }
}

// "none", "same" or "first", and the content of the other.
TEST_F(CopiedRowsTest, TellsWhoIsInTheWayOfAnAbbreviation) {
    const auto mail = addGroup(u"Mail", {u"new=x", u"sig=same group"}, u";");
    const auto plain = addGroup(u"Plain", {u";sign=other group", u";ad=early", u"=none"});
    const auto late = addGroup(u"Late", {u";lat=delimiter"});
    late->setExpandTrigger(ExpandTrigger::DelimiterKept);
    const auto told = [&](const std::u16string& abbreviation) {
        const auto conflict = conflictOf(*mail->items().front(), abbreviation, editor.groups());
        static constexpr const char* Kinds[] = {"none", "same ", "first "};
        return Kinds[static_cast<std::size_t>(conflict.kind)] +
               (conflict.other ? toUtf8(conflict.other->plainTextContent().value_or(u"")) : std::string());
    };
    EXPECT_EQ(told(u"new"), "none") << "itself";
    EXPECT_EQ(told(u""), "none");
    EXPECT_EQ(told(u"sig"), "same same group");
    EXPECT_EQ(told(u"sign"), "same other group") << "before that which expands first";
    EXPECT_EQ(told(u"signs"), "first same group");
    EXPECT_EQ(told(u"address"), "first early");
    EXPECT_EQ(told(u"later"), "none") << "that one waits for a delimiter";
    EXPECT_EQ(told(u"Sig"), "none");
}

}  // namespace
}  // namespace plume

#include "app/editing/LibraryEditor.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "app/editing/DictionaryGroup.h"
#include "app/editing/WhereUsed.h"
#include "tests/app/editing/EditedMachine.h"

namespace plume {
namespace {

using test::EditedMachine;
using testing::ElementsAre;
using testing::IsEmpty;

class LibraryEditorTest : public testing::Test, protected EditedMachine {};

// ---- Duplicate abbreviations ----

TEST_F(LibraryEditorTest, MarksWhatIsTypedTheSame) {
    const auto mail = addGroup(u"Mail", {u"sig=a", u"Sig=b", u"=c"});
    addGroup(u"Work", {u"sig=d", u"=e"});
    addGroup(u"Semicolon", {u"sig=f"}, u";");
    EXPECT_THAT(marked(), ElementsAre("sig", "sig"));
    EXPECT_TRUE(editor.setSnippetAbbreviation(mail->items()[0], u"sig2"));
    EXPECT_THAT(marked(), IsEmpty());
    EXPECT_FALSE(editor.setSnippetAbbreviation(mail->items()[0], u"sig3"));
    EXPECT_TRUE(editor.setSnippetAbbreviation(mail->items()[0], u";sig"));
    EXPECT_THAT(marked(), ElementsAre(";sig", "sig"));
}

TEST_F(LibraryEditorTest, MarksAnewWhenAPrefixChanges) {
    addGroup(u"Mail", {u"sig=a"});
    const auto other = addGroup(u"Other", {u"sig=b"}, u";");
    editor.changeSettings(other, [](SnippetGroup& group) { group.setAbbreviationPrefix(std::nullopt); });
    EXPECT_THAT(marked(), ElementsAre("sig", "sig"));
    editor.undo(done.back());
    EXPECT_THAT(marked(), IsEmpty());
}

TEST_F(LibraryEditorTest, DeletesOfThoseWithOneAbbreviationOnlyWhatIsTheSame) {
    const auto group = addGroup(u"Mail", {u"a=P", u"a=Q", u"a=P", u"b=P"});
    addGroup(u"Work", {u"a=Q", u"c=P"});
    const auto found = editor.duplicatedSnippets();
    ASSERT_EQ(found.size(), 2U);
    EXPECT_EQ(found[0].kept, group->items()[0]);
    EXPECT_EQ(found[0].others.size() + found[1].others.size(), 2U);
    editor.deleteDuplicatedSnippets(found);
    EXPECT_THAT(library(), ElementsAre("Mail: a=P a=Q b=P", "Work: c=P"));
    EXPECT_THAT(marked(), ElementsAre("a", "a"));
}

TEST_F(LibraryEditorTest, DuplicatesIntoTheSameGroupAndCountsTheBareAbbreviation) {
    const auto plain = addGroup(u"Plain", {u"x=1", u"y=2"});
    const auto prefixed = addGroup(u"Prefixed", {u"x=3"}, u";");
    const auto copies = editor.duplicate({{}, {plain->items()[1], prefixed->items()[0]}});
    EXPECT_EQ(copies.snippets.size(), 2U);
    EXPECT_NE(copies.snippets[1]->uuid(), prefixed->items()[0]->uuid());
    EXPECT_THAT(library(), ElementsAre("Plain: x=1 y=2 y=2", "Prefixed: x=3 x=3"));
    // ";x" is counted once as yet, and "x" twice.
    EXPECT_THAT(marked(), ElementsAre("x", "y", "y"));
    editor.reloadDuplicateManager();
    EXPECT_THAT(marked(), ElementsAre("y", "y", "x", "x"));
}

TEST_F(LibraryEditorTest, DuplicatesGroupsToTheEnd) {
    const auto mail = addGroup(u"Mail", {u"a=1"}, u";");
    addGroup(u"Work", {});
    const auto copies = editor.duplicate({{mail}, {}});
    EXPECT_THAT(library(), ElementsAre("Mail: a=1", "Work:", "Mail - Copy: a=1"));
    EXPECT_EQ(copies.groups.front()->abbreviationPrefix(), u";");
    EXPECT_THAT(marked(), ElementsAre("a", "a"));
}

// ---- Order ----

TEST_F(LibraryEditorTest, SortsTheLibraryItself) {
    addGroup(u"Mail", {u"b=X", u"A=z", u"c=y"})->items()[2]->setLabel(u"a label");
    using enum SortBy;
    const std::vector<std::pair<SortBy, std::string>> steps{
        {Abbreviation, "Mail: A=z b=X c=y"},   {Abbreviation, "Mail: c=y b=X A=z"}, {None, "Mail: c=y b=X A=z"},
        {SortingContent, "Mail: c=y b=X A=z"}, {DateCreated, "Mail: c=y b=X A=z"},  {Abbreviation, "Mail: A=z b=X c=y"},
    };
    for (const auto& [by, order] : steps) {
        editor.sort(by);
        EXPECT_THAT(library(), ElementsAre(order));
    }
}

TEST_F(LibraryEditorTest, SortsByDatesWithMissingOnesFirst) {
    const auto group = addGroup(u"Mail", {u"a=1", u"b=2", u"c=3"});
    world.loop.advance(10);
    group->items()[0]->updateLastTimeUsed();
    editor.sort(SortBy::LastTimeUsed);
    EXPECT_THAT(library(), ElementsAre("Mail: b=2 c=3 a=1"));
    editor.sort(SortBy::LastTimeUsed);
    EXPECT_THAT(library(), ElementsAre("Mail: a=1 b=2 c=3"));
}

TEST_F(LibraryEditorTest, SortsGroupsByTheNumbersInTheirNames) {
    for (const char16_t* name : {u"List 10", u"list 9", u"Alpha"}) addGroup(name, {});
    editor.sortGroups();
    EXPECT_THAT(library(), ElementsAre("Alpha:", "list 9:", "List 10:"));
}

// ---- Moving and deleting ----

TEST_F(LibraryEditorTest, MovesToThePlaceThatWasPointedAt) {
    struct Case {
        std::vector<std::size_t> moved;
        std::size_t at;
        std::string order;
    };
    const std::vector<Case> cases{
        {{0}, 2, "Mail: b= a= c= d="},    {{3}, 0, "Mail: d= a= b= c="},     {{1, 2}, 1, "Mail: a= b= c= d="},
        {{0, 3}, 2, "Mail: b= a= d= c="}, {{0, 1}, 99, "Mail: c= d= a= b="},
    };
    const auto group = addGroup(u"Mail", {u"a=", u"b=", u"c=", u"d="});
    for (const auto& [moved, at, order] : cases) {
        LibraryEditor::Snippets snippets;
        for (const std::size_t place : moved) snippets.push_back(group->items()[place]);
        const std::size_t before = done.size();
        editor.moveSnippets(snippets, group, at);
        EXPECT_THAT(library(), ElementsAre(order));
        if (done.size() > before) editor.undo(done.back());
        EXPECT_THAT(library(), ElementsAre("Mail: a= b= c= d="));
    }
}

TEST_F(LibraryEditorTest, MovesBetweenGroups) {
    const auto mail = addGroup(u"Mail", {u"a=1", u"b=2"});
    const auto work = addGroup(u"Work", {u"c=3"}, u";");
    const auto a = mail->items()[0];
    editor.moveSnippets({a, work->items()[0]}, work, 1);
    EXPECT_THAT(library(), ElementsAre("Mail: b=2", "Work: a=1 c=3"));
    EXPECT_EQ(a->abbreviationWithPrefix(), u";a");
    editor.undo(done.back());
    EXPECT_EQ(a->parentGroup(), mail);
    EXPECT_THAT(library(), ElementsAre("Mail: a=1 b=2", "Work: c=3"));
}

TEST_F(LibraryEditorTest, TellsNothingOfWhatChangesNothing) {
    const auto mail = addGroup(u"Mail", {u"a=1"});
    const auto a = mail->items()[0];
    struct Observer {
        void changed(LibraryEvent& /*event*/) { ++count; }
        int count = 0;
    } observer;
    const auto subscription = machine.manager->didChangeDataEvent.addObserver(&observer, &Observer::changed);
    editor.setLabel(a, u"");
    editor.setNote(a, std::nullopt);
    editor.setSnippetAbbreviation(a, u"a");
    editor.setContent(a, AttributedString(u"1"));
    editor.setName(mail, u"Mail");
    editor.moveGroups({mail}, 1);
    editor.remove({});
    EXPECT_EQ(observer.count, 0);
    EXPECT_THAT(done, IsEmpty());
    editor.setNote(a, u"note");
    EXPECT_EQ(observer.count, 1);
    EXPECT_EQ(done.size(), 1U);
}

// ---- Undo ----

TEST_F(LibraryEditorTest, UndoLeavesAloneWhatOthersChangedMeanwhile) {
    const auto a = addGroup(u"Mail", {u"a=1"})->items()[0];
    editor.setLabel(a, u"label");
    world.loop.advance(5);
    a->updateLastTimeUsed();
    a->setNote(u"a note of another window");
    const auto used = a->lastTimeUsed();
    editor.undo(done.back());
    EXPECT_EQ(a->label(), std::nullopt);
    EXPECT_EQ(a->lastTimeUsed(), used);
    EXPECT_EQ(a->note(), u"a note of another window");
}

TEST_F(LibraryEditorTest, ChangesOfOneFieldJoin) {
    const auto group = addGroup(u"Mail", {u"a=1", u"b=2"});
    const auto a = group->items()[0];
    const std::string before = bytes();
    for (const char16_t* text : {u"x", u"xy", u"xyz"}) editor.setContent(a, AttributedString(text));
    editor.setLabel(a, u"label");
    editor.setContent(group->items()[1], AttributedString(u"z"));
    LibraryChange& first = done.front();
    EXPECT_TRUE(first.absorb(done[1]));
    EXPECT_TRUE(first.absorb(done[2]));
    EXPECT_FALSE(first.absorb(done[3]));
    EXPECT_FALSE(first.absorb(done[4]));
    editor.undo(done[4]);
    editor.undo(done[3]);
    editor.undo(first);
    EXPECT_EQ(bytes(), before);
}

TEST_F(LibraryEditorTest, AnImportIsOneChange) {
    addGroup(u"Mail", {u"a=1"});
    const auto system = addGroup(u"System's Symbol And Text Substitutions", {u"old=1"});
    ImportedLibrary imported;
    for (const char16_t* name : {u"Mail", u"System's Symbol And Text Substitutions"}) {
        imported.groups.push_back(SnippetGroup::make());
        imported.groups.back()->setName(name);
        imported.groups.back()->addItem(std::make_shared<Snippet>(u"new", u"2"));
    }
    editor.import(imported);
    EXPECT_THAT(library(), ElementsAre("Mail: a=1", "System's Symbol And Text Substitutions: new=2", "Mail: new=2"));
    ASSERT_EQ(done.size(), 1U);
    editor.undo(done.back());
    EXPECT_THAT(library(), ElementsAre("Mail: a=1", "System's Symbol And Text Substitutions: old=1"));
}

// ---- Others ----

TEST_F(LibraryEditorTest, ResetsTheCaseOfAGroup) {
    const auto group = addGroup(u"Mail", {u"a=1", u"b=2"});
    group->setCaseSensitivity(CaseSensitivity::CaseSensitive);
    editor.resetSnippetCaseSensitivity(group, CaseSensitivity::IgnoreCase);
    for (const auto& snippet : group->items()) EXPECT_EQ(snippet->caseSensitivity(), CaseSensitivity::IgnoreCase);
    EXPECT_EQ(group->caseSensitivity(), CaseSensitivity::CaseSensitive);
    editor.undo(done.back());
    for (const auto& snippet : group->items()) EXPECT_EQ(snippet->caseSensitivity(), CaseSensitivity::CaseSensitive);
}

TEST_F(LibraryEditorTest, ContentOfOtherKindsHasNoAttributes) {
    const auto a = addGroup(u"Mail", {u"a=1"})->items()[0];
    auto bold = std::make_shared<TextAttributes>();
    bold->font = FontAttribute{u"Helvetica", 12, true, false};
    const AttributedString rich(u"bold", bold);
    editor.setContent(a, rich);
    EXPECT_EQ(a->richTextContent(), AttributedString(u"bold"));
    editor.setContentType(a, ContentType::RichText);
    editor.setContent(a, rich);
    EXPECT_EQ(a->richTextContent(), rich);
    editor.setContentType(a, ContentType::PlainText);
    EXPECT_EQ(a->richTextContent(), AttributedString(u"bold"));
    editor.undo(done.back());
    EXPECT_EQ(a->richTextContent(), rich);
}

TEST(DictionaryGroupTest, TakesLinesInPairs) {
    struct Case {
        std::string text;
        std::vector<std::string> pairs;
    };
    const std::vector<Case> cases{
        {"teh\nthe\nadn\nand\nlast", {"D: teh=the adn=and"}},
        {"teh\nthe\n", {"D: teh=the"}},
        {"", {"D:"}},
    };
    for (const auto& [text, pairs] : cases) {
        const auto group = dictionaryGroup(u"D", text, CaseSensitivity::IgnoreCase);
        EXPECT_EQ(test::described({group}), pairs) << text;
        EXPECT_EQ(group->expandTrigger(), ExpandTrigger::DelimiterKept);
        EXPECT_EQ(group->caseSensitivity(), CaseSensitivity::IgnoreCase);
        EXPECT_FALSE(group->suggestAbbreviations() || group->showInMenuBar());
        for (const auto& snippet : group->items()) {
            EXPECT_EQ(snippet->caseSensitivity(), CaseSensitivity::IgnoreCaseAndAdapt);
        }
    }
}

TEST_F(LibraryEditorTest, FindsWhereASnippetIsUsed) {
    const auto inner = addGroup(u"Inner", {u"sig=Jane", u"other=x"}, u";")->items()[0];
    const std::u16string byUuid =
        u"uuid=【snippet:whatever uuid:" + fromUtf8(toUtf8(inner->uuid()->toString())) + u"】";
    const auto outer = addGroup(u"Outer", {u"a=Dear 【snippet:;sig】", u"b=【snippet:sig】 【snippet:other】", byUuid,
                                           u"c=【snippet:other】", u"d=snippet:;sig】", u"e=【snippet:;sig"});
    const LibraryEditor::Snippets expected(outer->items().begin(), outer->items().begin() + 3);
    EXPECT_EQ(snippetsThatInclude(*inner, editor.groups()), expected);
}

}  // namespace
}  // namespace plume

// Random edits, of which all that are undone give the first bytes again, and all that are done again the last ones.
#include <gtest/gtest.h>

#include <algorithm>
#include <random>

#include "tests/app/editing/EditedMachine.h"

namespace plume {
namespace {

class Storm : public test::EditedMachine {
  public:
    explicit Storm(unsigned seed) : random_(seed) {
        addGroup(u"Mail", {u"a=1", u"b=2", u"a=1"}, u";");
        addGroup(u"Work", {u"a=1", u"c=3"});
        addGroup(u"Empty", {});
    }

    void editOnce() {
        constexpr std::size_t Edits = 15;
        switch (below(Edits)) {
            case 0:
                return withSnippet([&](auto& s) { editor.setSnippetAbbreviation(s, text()); });
            case 1:
                return withSnippet([&](auto& s) { editor.setLabel(s, text()); });
            case 2:
                return withSnippet([&](auto& s) { editor.setNote(s, text()); });
            case 3:
                return withSnippet([&](auto& s) { editor.setContent(s, rich()); });
            case 4:
                return withSnippet([&](auto& s) { editor.setContentType(s, static_cast<ContentType>(below(4))); });
            case 5:
                return editor.setCaseSensitivity(some().snippets, static_cast<CaseSensitivity>(below(3)));
            case 6:
                return withGroup([&](auto& g) { editor.setName(g, text()); });
            case 7:
                return withGroup([&](auto& g) {
                    editor.changeSettings(g, [&](SnippetGroup& group) { group.setAbbreviationPrefix(text()); });
                });
            case 8:
                return withGroup([&](auto& g) { editor.insertSnippets(made(), g, below(9)); });
            case 9:
                return editor.insertGroups({SnippetGroup::make()}, below(9));
            case 10:
                return editor.remove(below(4) == 0 ? some() : LibrarySelection{{}, some().snippets});
            case 11:
                return withGroup([&](auto& g) { editor.moveSnippets(some().snippets, g, below(9)); });
            case 12:
                return editor.moveGroups(some().groups, below(9));
            case 13:
                static_cast<void>(editor.duplicate(below(4) == 0 ? some() : LibrarySelection()));
                return;
            default:
                return reorder();
        }
    }

  private:
    std::size_t below(std::size_t end) { return std::uniform_int_distribution<std::size_t>(0, end - 1)(random_); }
    std::u16string text() { return std::u16string(below(3), static_cast<char16_t>(u'a' + below(3))); }
    AttributedString rich() {
        auto attributes = std::make_shared<TextAttributes>();
        attributes->font = FontAttribute{u"Helvetica", 12, below(2) == 0, false};
        return AttributedString(text(), attributes);
    }
    LibraryEditor::Snippets made() {
        return {std::make_shared<Snippet>(text(), text()), std::make_shared<Snippet>(text(), text())};
    }
    LibrarySelection some() {
        LibrarySelection selection;
        for (const auto& group : editor.groups()) {
            if (below(4) == 0) selection.groups.push_back(group);
            for (const auto& snippet : group->items()) {
                if (below(4) == 0) selection.snippets.push_back(snippet);
            }
        }
        return selection;
    }
    template <typename Edit>
    void withGroup(Edit edit) {
        if (editor.groups().empty()) return;
        const auto group = editor.groups()[below(editor.groups().size())];
        edit(group);
    }
    template <typename Edit>
    void withSnippet(Edit edit) {
        withGroup([&](const auto& group) {
            if (group->items().empty()) return;
            const auto snippet = group->items()[below(group->items().size())];
            edit(snippet);
        });
    }
    void reorder() {
        if (below(3) == 0) return editor.sortGroups();
        if (below(3) == 0) return editor.deleteDuplicatedSnippets(editor.duplicatedSnippets());
        editor.sort(static_cast<SortBy>(below(6)));
    }

    std::mt19937 random_;
};

TEST(UndoStormTest, EverythingCanBeUndoneAndDoneAgain) {
    constexpr unsigned Storms = 12;
    constexpr int Edits = 80;
    for (unsigned seed = 0; seed < Storms; ++seed) {
        SCOPED_TRACE(seed);
        Storm storm(seed);
        std::vector<std::string> states{storm.bytes()};
        for (int i = 0; i < Edits; ++i) {
            const std::size_t before = storm.done.size();
            storm.editOnce();
            storm.world.loop.advance(0.01);
            if (storm.done.size() > before) states.push_back(storm.bytes());
        }
        ASSERT_EQ(states.size(), storm.done.size() + 1);
        for (std::size_t i = storm.done.size(); i-- > 0;) {
            storm.editor.undo(storm.done[i]);
            ASSERT_TRUE(storm.bytes() == states[i]) << "undone: " << static_cast<int>(storm.done[i].kind);
        }
        for (std::size_t i = 0; i < storm.done.size(); ++i) {
            storm.editor.redo(storm.done[i]);
            ASSERT_TRUE(storm.bytes() == states[i + 1]) << "done again: " << static_cast<int>(storm.done[i].kind);
        }
    }
}

}  // namespace
}  // namespace plume

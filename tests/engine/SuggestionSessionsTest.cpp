// Random sessions with the list at the caret, held against a naive account of its rules: what is shown, what is
// selected, what the buffer holds, and what stands in the program.
#include <gtest/gtest.h>

#include <random>

#include "Foundation/Strings.h"
#include "tests/engine/EngineDesk.h"
#include "tests/engine/MatcherSupport.h"

namespace plume {
namespace {

using Entries = std::vector<SnippetMatcher::Match>;

// The rules, key by key. What is found is not its business.
class NaiveSession {
  public:
    NaiveSession(const AutoText::Groups& groups, bool suggestsByItself)
        : groups_(groups), suggestsByItself_(suggestsByItself) {
        matcher_.setSnippetGroups(groups);
    }

    void typeKey(char16_t key) {
        const std::size_t digit = key == u'0' ? 9 : static_cast<std::size_t>(key - u'1');
        if (key >= u'0' && key <= u'9' && visible && digit <= entries.size()) return send(digit);
        if (key == u'\r' && visible) return send(selected);
        const Entries matches = plume::typeKey(matcher_, letters, std::u16string(1, key));
        letters += key;
        screen += key == u'\r' ? u'\n' : key;
        if (matches.size() == 1) return deliver(matches[0]);
        if (matches.size() > 1) return offer(matches);
        if (isSelecting_) {
            hide();
        } else {
            refresh();
        }
        isWaiting_ = suggestsByItself_;
    }

    void backspace() {
        if (!screen.empty()) screen.pop_back();
        if (letters.empty()) return;
        letters.pop_back();
        refresh();
        isWaiting_ = suggestsByItself_;
    }

    void suggest() {
        entries = whatLettersMayBecome();
        if (!entries.empty()) show();
    }

    void escape() {
        if (visible) {
            hide();
        } else {
            clear();
        }
    }

    void arrow(bool down) {
        if (!visible) return clear();
        if (down && selected + 1 < shown) ++selected;
        if (!down && selected > 0) --selected;
    }

    void clear() {
        letters.clear();
        isWaiting_ = false;
        if (visible) hide();
    }

    void send(std::size_t index) {
        if (index >= entries.size()) return hide();
        deliver(entries[index]);
    }

    void pause() {
        if (!std::exchange(isWaiting_, false) || visible || isSelecting_) return;
        const Entries found = whatLettersMayBecome();
        for (const auto& [snippet, typed] : found) {
            if (typed.size() < 2 + (typed[0] == u';' ? 1U : 0U)) continue;
            entries = found;
            return show();
        }
    }

    std::u16string letters;
    std::u16string screen;
    Entries entries;
    bool visible = false;
    std::size_t shown = 0;
    std::size_t selected = 0;

  private:
    Entries whatLettersMayBecome() const {
        SuggestionList list;
        matcher_.findSuggestions(letters, groups_, list);
        Entries found;
        for (std::size_t i = 0; i < list.size(); ++i) found.push_back({list.suggestions[i], list.suggestionFilters[i]});
        return found;
    }
    void show() {
        visible = true;
        shown = entries.size();
        selected = 0;
    }
    void hide() {
        visible = isSelecting_ = isWaiting_ = false;
        entries.clear();
    }
    void refresh() {
        if (!visible) return;
        suggest();
        if (entries.empty()) visible = false;
    }
    void offer(const Entries& matches) {
        hide();
        entries = matches;
        isSelecting_ = true;
        show();
    }
    void deliver(const SnippetMatcher::Match& match) {
        const auto [snippet, typed] = match;
        hide();
        screen.resize(screen.size() - typed.size());
        letters = *snippet->plainTextContent();
        screen += letters;
    }

    SnippetMatcher matcher_{testDelimiters()};
    AutoText::Groups groups_;
    bool suggestsByItself_;
    bool isSelecting_ = false;
    bool isWaiting_ = false;
};

void fillLibrary(EngineDesk& desk) {
    desk.add(u"abc", u"One");
    desk.add(u"bb", u"Two ");
    desk.add(u"bb", u"Three");
    desk.add(u"abcc", u"ca", ExpandTrigger::Never);
    desk.add({u"ab", u"a", u"cab", u"cabba"}, ExpandTrigger::Never)->setExpandAfter(ExpandAfter::Anything);
    desk.add({u"ab", u"a", u"ca"}, ExpandTrigger::Never)->setAbbreviationPrefix(u";");
}

class Session {
  public:
    explicit Session(unsigned seed) : random_(seed) {
        fillLibrary(desk_);
        const bool suggestsByItself = random_() % 2 == 0;
        desk_.engine.setSuggestsByItself(suggestsByItself);
        naive_.emplace(desk_.engine.snippetGroups(), suggestsByItself);
    }

    // One more thing that the user does; whether all is as it should be.
    bool goesOn() {
        act();
        return desk_.list.visible == naive_->visible && (!naive_->visible || desk_.list.selected == naive_->selected) &&
               (!naive_->visible || desk_.list.entries.size() == naive_->shown) && entries() == naive_->entries &&
               desk_.engine.letters() == naive_->letters && desk_.screen() == naive_->screen;
    }

    // What was done, and what came of it.
    std::string told() {
        return doings_ + "\nlist " + (desk_.list.visible ? "visible" : "hidden") + ", letters \"" +
               toUtf8(desk_.engine.letters()) + "\", screen \"" + toUtf8(desk_.screen()) + "\"; by the rules list " +
               (naive_->visible ? "visible" : "hidden") + ", letters \"" + toUtf8(naive_->letters) + "\", screen \"" +
               toUtf8(naive_->screen) + "\"";
    }

    bool hasList() const { return naive_->visible; }

  private:
    Entries entries() const {
        const SuggestionList& list = desk_.engine.suggestions();
        Entries all;
        for (std::size_t i = 0; i < list.size(); ++i) all.push_back({list.suggestions[i], list.suggestionFilters[i]});
        return all;
    }

    void act() {
        switch (random_() % 16) {
            case 0:
                return press(KeyCode::Delete, [&] { naive_->backspace(); });
            case 1:
            case 2:
                doings_ += " suggest";
                desk_.engine.suggestAbbreviations();
                return naive_->suggest();
            case 3:
                return press(KeyCode::Down, [&] { naive_->arrow(true); });
            case 4:
                // Without a list the caret would leave the end of the text.
                if (naive_->visible) press(KeyCode::Up, [&] { naive_->arrow(false); });
                return;
            case 5:
                return press(KeyCode::Escape, [&] { naive_->escape(); });
            case 6:
                doings_ += " click";
                desk_.clickAt(1, 1);
                return naive_->clear();
            case 7:
                return choose();
            case 8:
                doings_ += " pause";
                desk_.loop.advance(0.5);
                return naive_->pause();
            case 9:
                return type(u"1230\r"[random_() % 5]);
            default:
                return type(u"aaabbbcc; "[random_() % 10]);
        }
    }

    void type(char16_t key) {
        doings_ += " '" + toUtf8({&key, 1}) + "'";
        const char16_t typed = key == u'\r' ? u'\n' : key;
        desk_.type({&typed, 1});
        naive_->typeKey(key);
    }

    template <typename Effect>
    void press(KeyCode key, Effect&& effect) {
        doings_ += " " + std::to_string(static_cast<int>(key));
        desk_.desktop.pressAndRelease(key);
        effect();
    }

    void choose() {
        if (!naive_->visible) return;
        desk_.list.selected = random_() % naive_->shown;
        doings_ += " choose " + std::to_string(desk_.list.selected);
        naive_->selected = desk_.list.selected;
        desk_.list.click();
        naive_->send(naive_->selected);
    }

    std::mt19937 random_;
    EngineDesk desk_;
    std::optional<NaiveSession> naive_;
    std::string doings_;
};

TEST(SuggestionSessions, FollowTheRules) {
    constexpr unsigned Sessions = 500;
    constexpr int Doings = 60;
    int withList = 0;
    for (unsigned seed = 0; seed < Sessions; ++seed) {
        Session session(seed);
        for (int i = 0; i < Doings; ++i) {
            ASSERT_TRUE(session.goesOn()) << seed << ":" << session.told();
            withList += session.hasList() ? 1 : 0;
        }
    }
    EXPECT_GT(withList, Doings * int(Sessions) / 10) << "sessions in which nothing is shown try little";
}

}  // namespace
}  // namespace plume

// The suggestion list between the thread of the keys and the thread of its window, each of which runs when the test
// says so.
#include "app/SuggestionBridge.h"

#include <gtest/gtest.h>

#include <random>

#include "library/SnippetGroup.h"
#include "ports/simulated/SimulatedAccessibility.h"
#include "ports/simulated/SimulatedProcessManager.h"
#include "ports/simulated/SimulatedRunLoop.h"

namespace plume {
namespace {

class NotedSuggestions final : public SuggestionView {
  public:
    static constexpr Rectangle Frame{{10, 20}, {300, 200}};

    void setEvents(Events events) override { told = std::move(events); }
    void show(const SuggestionPage& shown, const CaretPlace& where) override {
        isShown = true;
        place = where;
        take(shown);
    }
    void update(const SuggestionPage& shown) override {
        ++updates;
        if (isShown) take(shown);
    }
    void hide() override { isShown = false; }

    Events told;
    bool isShown = false;
    int updates = 0;
    SuggestionPage page;
    std::vector<SuggestionPage> seen;  // all of them, oldest first
    CaretPlace place;

  private:
    void take(const SuggestionPage& shown) {
        page = shown;
        seen.push_back(shown);
        told.placed(Frame);
    }
};

// The same list as a person would describe it, with steps of one.
struct NaiveList {
    std::size_t size = 0;
    std::u16string name;  // of this list among those there were
    std::size_t first = 0;
    std::size_t selected = 0;
    bool isVisible = false;

    void select(std::size_t index) {
        selected = index;
        while (first > selected) --first;
        while (first + 10 <= selected) ++first;
    }
    void scroll(int rows) {
        for (; rows > 0 && first + 10 < size; --rows) ++first;
        for (; rows < 0 && size > 10 && first > 0; ++rows) --first;
    }
};

class SuggestionBridgeTest : public testing::Test {
  protected:
    SuggestionBridgeTest() {
        bridge.setSuggestionSelectedAction([this] {
            picked.push_back(bridge.selectedSuggestionIndex());
            bridge.close();
        });
        fill(0);
    }
    void settle() {
        constexpr int Rounds = 4;
        // The list follows a key in a hundredth of a second or so.
        constexpr double Moment = 0.02;
        for (int round = 0; round < Rounds; ++round) {
            tap.advance(Moment);
            main.runReady();
        }
    }
    void fill(std::size_t size) {
        ++lists;
        model.size = size;
        model.name = u"list " + fromUtf8(std::to_string(lists));
        model.first = model.selected = 0;
        list.clear();
        for (std::size_t i = 0; i < size; ++i) {
            auto snippet = std::make_shared<Snippet>(u"abbreviation", u"content");
            snippet->setLabel(model.name);
            list.append(snippet, u"abb");
        }
        bridge.setSnippets(list);
    }
    // Of a page that was seen some time.
    void clickOnce(std::size_t place) {
        if (view.seen.empty()) return;
        const SuggestionPage& page = view.seen.at(place % view.seen.size());
        if (page.rows.empty()) return;
        const std::size_t index = page.first + place % (page.rows.size() + 1);
        const bool counts = model.isVisible && page.rows.front().label == model.name && index < model.size;
        picked.clear();
        view.told.clicked(page.number, index);
        tap.runReady();
        EXPECT_EQ(picked, counts ? std::vector{index} : std::vector<std::size_t>());
        if (!counts) return;
        model.selected = index;
        model.isVisible = false;
    }
    void expectAlike() {
        EXPECT_EQ(bridge.windowVisible(), model.isVisible);
        EXPECT_EQ(bridge.selectedSuggestionIndex(), model.size > 0 ? model.selected : NotFound);
        EXPECT_TRUE(model.isVisible || bridge.windowFrame() == Rectangle());
    }
    void expectShown() {
        expectAlike();
        ASSERT_EQ(view.isShown, model.isVisible);
        if (!model.isVisible) return;
        EXPECT_EQ(bridge.windowFrame(), NotedSuggestions::Frame);
        EXPECT_EQ(view.page.first, model.first);
        EXPECT_EQ(view.page.total, model.size);
        EXPECT_EQ(view.page.rows.size(), std::min<std::size_t>(10, model.size));
        for (const SuggestionRow& row : view.page.rows) EXPECT_EQ(row.label, model.name);
    }

    int lists = 0;
    SuggestionList list;
    NaiveList model;
    std::vector<std::size_t> picked;
    SimulatedRunLoop tap;
    SimulatedRunLoop main;
    SimulatedAccessibility accessibility;
    SimulatedProcessManager processes;
    NotedSuggestions view;
    int moves = 0;  // of the keyboard to another window, as far as the list has noticed
    SuggestionBridge bridge{
        {[this]() -> SuggestionView& { return view; }, tap, main, accessibility, processes, [this] { ++moves; }}};
};

TEST_F(SuggestionBridgeTest, ShowsWhatIsInSightWhateverHappensInWhichOrder) {
    std::mt19937 random(20260131);  // NOLINT(cert-msc32-c,cert-msc51-cpp)
    const auto below = [&](std::size_t limit) { return random() % limit; };
    settle();
    constexpr int Steps = 20'000;
    for (int step = 0; step < Steps && !HasFailure(); ++step) {
        SCOPED_TRACE(step);
        switch (below(9)) {
            case 0:
                if (model.selected + 1 < model.size) model.select(model.selected + 1);
                bridge.nextSuggestion();
                break;
            case 1:
                if (model.selected > 0) model.select(model.selected - 1);
                bridge.previousSuggestion();
                break;
            case 2: {
                const int rows = static_cast<int>(below(25)) - 12;
                if (model.isVisible) model.scroll(rows);
                view.told.scrolled(rows);
                tap.runReady();
                break;
            }
            case 3:
                fill(below(4) == 0 ? below(3) : below(40));
                break;
            case 4:
                bridge.showWindowAtCaret();
                model.isVisible = true;
                break;
            case 5:
                bridge.close();
                model.isVisible = false;
                break;
            case 6:
                clickOnce(below(1000));
                break;
            case 7:
                // Only one of the threads gets on.
                below(2) == 0 ? tap.runReady() : main.runReady();
                break;
            default:
                settle();
                expectShown();
                EXPECT_TRUE(!model.isVisible || view.page.selected == model.selected);
        }
        expectAlike();
    }
    EXPECT_GT(view.seen.size(), 1000U);
}

TEST_F(SuggestionBridgeTest, DescribesItsRows) {
    const auto group = SnippetGroup::make();
    group->setAbbreviationPrefix(u";");
    list.clear();
    for (int i = 0; i < 11; ++i) list.append(std::make_shared<Snippet>(u"sig", u" \nKind regards\nAnn"), u";s");
    for (const auto& snippet : list.suggestions) group->addItem(snippet);
    list.suggestions[0]->setLabel(u"Farewell");
    list.suggestions[1] = std::make_shared<Snippet>(std::nullopt, std::nullopt);
    bridge.setSnippetSelectorKeyModifier(3);
    bridge.setSnippets(list);
    bridge.showWindowAtCaret();
    settle();
    ASSERT_EQ(view.page.rows.size(), 10U);
    EXPECT_EQ(view.page.selectorKeyModifier, 3);
    EXPECT_EQ(view.page.rows[0], (SuggestionRow{u";sig", 2, u"Farewell", u"Kind regards\u2009…", u'1'}));
    EXPECT_EQ(view.page.rows[1], (SuggestionRow{u"", 2, u"", u"", u'2'}));
    EXPECT_EQ(view.page.rows[9].digit, u'0');
    for (int i = 0; i < 10; ++i) bridge.nextSuggestion();
    settle();
    EXPECT_EQ(view.page.rows[9].digit, u'\0') << "digits pick of the first ten alone";
    EXPECT_EQ(view.page.rows[8].digit, u'0');
}

TEST_F(SuggestionBridgeTest, TellsTheWindowOnceOfAllThatAKeyChanges) {
    fill(20);
    bridge.showWindowAtCaret();
    settle();
    for (int i = 0; i < 5; ++i) bridge.nextSuggestion();
    settle();
    EXPECT_EQ(view.updates, 1);
    EXPECT_EQ(view.page.selected, 5U);
}

TEST_F(SuggestionBridgeTest, NoticesThatAnotherWindowHasTheKeyboard) {
    fill(3);
    processes.setFrontProcess(processes.launch(u"editor"));
    bridge.showWindowAtCaret();
    settle();
    tap.advance(1);
    EXPECT_EQ(moves, 0);
    processes.setFrontProcess(processes.launch(u"mailer"));
    tap.advance(0.2);
    EXPECT_EQ(moves, 1);
    bridge.close();
    processes.setFrontProcess(std::nullopt);
    tap.advance(1);
    EXPECT_EQ(moves, 1);
}

TEST(SuggestionBridge, MayGoBeforeItsEventsArrive) {
    SimulatedRunLoop tap;
    SimulatedRunLoop main;
    const SimulatedAccessibility accessibility;
    const SimulatedProcessManager processes;
    NotedSuggestions view;
    SuggestionList list;
    list.append(std::make_shared<Snippet>(u"a", u"b"), u"a");
    auto bridge = std::make_unique<SuggestionBridge>(SuggestionBridge::Dependencies{
        [&]() -> SuggestionView& { return view; }, tap, main, accessibility, processes, [] {}});
    bridge->setSnippets(list);
    bridge->showWindowAtCaret();
    tap.runReady();
    main.runReady();
    ASSERT_TRUE(view.isShown);
    view.told.clicked(view.page.number, 0);
    view.told.scrolled(1);
    bridge = nullptr;
    tap.runReady();
    main.runReady();
    EXPECT_FALSE(view.isShown);
    EXPECT_FALSE(view.told.clicked);
}

}  // namespace
}  // namespace plume

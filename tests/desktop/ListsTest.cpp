// The suggestion list and quick search on a whole desktop: where they stand, what they leave alone, and where that
// which is chosen goes.
#include <cstdlib>
#include <random>
#include <sstream>
#include <thread>

#include "testing/rig/Screenshot.h"
#include "testing/rig/XcbReply.h"
#include "tests/desktop/ApplicationDesktop.h"

namespace plume::rig {

namespace {

constexpr const char* Letters = R"json([
  { "name": "Letters", "expandTrigger": 1, "items": [
      { "abbreviation": "sig", "content": "Kind regards,\nJo", "label": "Signature" },
      { "abbreviation": "sigw", "content": "Best, Jo from work", "label": "Signature, work" },
      { "abbreviation": "sir", "content": "Dear Sir or Madam," },
      { "abbreviation": "btw", "content": "by the way" } ] },
  { "name": "Places", "expandTrigger": 3, "items": [
      { "abbreviation": "home", "content": "12 Hill Road", "label": "Address at home" },
      { "abbreviation": "cafe", "content": "Café Central, Herrengasse 14", "label": "Where we meet" } ] }
])json";

constexpr const char* SuggestKey = "120";  // F2
constexpr const char* SearchKey = "99";    // F3

std::string nameOf(WindowManager manager) {
    switch (manager) {
        case WindowManager::Openbox:
            return "openbox";
        case WindowManager::OpenboxFollowingPointer:
            return "openboxFollowingPointer";
        case WindowManager::Xfwm4:
            break;
    }
    return "xfwm4";
}

class ListsTest : public ApplicationDesktop, public testing::WithParamInterface<WindowManager> {
  protected:
    ListsTest() : ApplicationDesktop(GetParam()) {}

    void SetUp() override {
        ApplicationDesktop::SetUp();
        keepLibrary(Letters);
        command({"settings", "suggestAbbreviationsHotKey", SuggestKey});
        command({"settings", "quickSearchHotKey", SearchKey});
    }

    void open(TargetKind kind) {
        target_ = rig_.startTarget(kind);
        pointAt(*target_);
        expectSoon(*target_, "x btw ", "x by the way ");
        target_->clear();
    }
    void pointAt(const TargetProgram& target) {
        const XClient::Place place = rig_.client().placeOf(target.window());
        rig_.pointer().moveTo(place.x + place.width - 20, place.y + place.height - 20);
        rig_.pointer().sync();
    }
    void typeAndSee(const std::string& text) {
        const std::string before = target_->text();
        rig_.keyboard().type(text);
        ASSERT_EQ(target_->awaitText(before + text), before + text) << log();
    }

    // Where a list of Plume of this name is; nothing when it is not shown.
    std::optional<Rectangle> shown(const std::string& name) { return reader().place(plume_->process().pid(), name); }
    bool comes(const std::string& name) {
        return waitUntil([&] { return shown(name).has_value(); }, Bound);
    }
    bool goes(const std::string& name) {
        return waitUntil([&] { return !shown(name).has_value(); }, Bound);
    }
    bool isTargetInFront() { return rig_.client().activeWindow() == target_->window(); }
    void expectText(const std::string& expected) { EXPECT_EQ(target_->awaitText(expected), expected) << log(); }
    // Its one window that is shown.
    Rectangle windowOfPlume() {
        XClient& client = rig_.client();
        auto* connection = client.connection();
        const auto tree = own(xcb_query_tree_reply(connection, xcb_query_tree(connection, client.root()), nullptr));
        std::vector<xcb_window_t> windows(xcb_query_tree_children(tree.get()),
                                          xcb_query_tree_children(tree.get()) + tree->children_len);
        for (const xcb_window_t managed : client.managedWindows()) windows.push_back(managed);
        for (const xcb_window_t window : windows) {
            const auto cookie = xcb_get_window_attributes(connection, window);
            const auto attributes = own(xcb_get_window_attributes_reply(connection, cookie, nullptr));
            const bool isShown = attributes && attributes->map_state == XCB_MAP_STATE_VIEWABLE;
            if (!isShown || !client.property(window, "WM_CLASS").starts_with("plume")) continue;
            const XClient::Place place = client.placeOf(window);
            return {{static_cast<double>(place.x), static_cast<double>(place.y)},
                    {static_cast<double>(place.width), static_cast<double>(place.height)}};
        }
        return {};
    }
    // For people who look at it: into the folder that the environment names.
    void picture(const std::string& name) {
        const char* const folder = std::getenv("PLUME_SCREENSHOTS");
        if (folder) writeScreenshot(rig_.client(), std::filesystem::path(folder) / (name + ".png"));
    }

    static constexpr const char* List = "Suggested snippets";
    static constexpr const char* Search = "Found snippets";
    std::unique_ptr<TargetProgram> target_;
};

constexpr TargetKind Kinds[] = {TargetKind::GtkTextView, TargetKind::QtTextEdit, TargetKind::Xterm};

TEST_P(ListsTest, SuggestionsStandInFrontOfTheProgramAndFollowWhatIsTyped) {
    start();
    for (const TargetKind kind : Kinds) {
        SCOPED_TRACE(nameOf(kind));
        open(kind);
        typeAndSee("hello si");
        rig_.keyboard().tap(Key::F2);
        ASSERT_TRUE(comes(List)) << log();
        picture("list-" + nameOf(kind) + "-" + nameOf(GetParam()));
        EXPECT_TRUE(isTargetInFront()) << "the list takes no focus";
        typeAndSee("g");
        rig_.keyboard().tap(Key::Down);
        rig_.keyboard().tap(Key::Return);
        expectText("hello Best, Jo from work");
        EXPECT_TRUE(goes(List));

        // Each way out leaves the text alone.
        target_->clear();
        for (const bool byClick : {false, true}) {
            typeAndSee(" si");
            rig_.keyboard().tap(Key::F2);
            ASSERT_TRUE(comes(List)) << log();
            if (byClick) {
                const XClient::Place place = rig_.client().placeOf(target_->window());
                rig_.click(place.x + place.width - 10, place.y + 5);
            } else {
                rig_.keyboard().tap(Key::Escape);
            }
            EXPECT_TRUE(goes(List)) << byClick;
        }
        expectText(" si si");
        target_ = nullptr;
    }
}

TEST_P(ListsTest, SuggestionsStandAtTheCaret) {
    start();
    open(TargetKind::GtkTextView);
    typeAndSee("hello si");
    rig_.keyboard().tap(Key::F2);
    ASSERT_TRUE(comes(List)) << log();
    const XClient::Place window = rig_.client().placeOf(target_->window());
    const Rectangle list = *shown(List);
    EXPECT_GT(list.origin.x, window.x + 20) << "behind what was typed";
    EXPECT_LT(list.origin.x, window.x + 120);
    EXPECT_GT(list.origin.y, window.y + 10) << "below the line";
    EXPECT_LT(list.origin.y, window.y + 50);

    // Clicked by its second row, and by the wheel nothing falls apart.
    rig_.pointer().moveTo(static_cast<int>(list.origin.x) + 30, static_cast<int>(list.origin.y) + 33);
    rig_.pointer().press(5);
    rig_.pointer().release(5);
    rig_.click(static_cast<int>(list.origin.x) + 30, static_cast<int>(list.origin.y) + 33);
    expectText("hello Best, Jo from work");
}

TEST_P(ListsTest, SuggestionsCloseWhenAnotherWindowComes) {
    start();
    open(TargetKind::GtkTextView);
    typeAndSee("si");
    rig_.keyboard().tap(Key::F2);
    ASSERT_TRUE(comes(List)) << log();
    target_->showPassword(true);
    EXPECT_TRUE(goes(List)) << log();
}

TEST_P(ListsTest, SuggestionsComeByThemselvesWhereThatIsWanted) {
    command({"settings", "SuggestAutomatically", "true"});
    start();
    open(TargetKind::GtkTextView);
    typeAndSee("s");
    typeAndSee("i");
    ASSERT_TRUE(comes(List)) << log();
    rig_.keyboard().tap(Key::Return);
    expectText("Kind regards,\nJo");
}

TEST_P(ListsTest, SearchSendsIntoTheProgramThatHadTheKeyboard) {
    start();
    for (const TargetKind kind : Kinds) {
        SCOPED_TRACE(nameOf(kind));
        open(kind);
        typeAndSee("at ");
        rig_.keyboard().tap(Key::F3);
        // What follows at once is for the window that comes.
        rig_.keyboard().type("hil");
        ASSERT_TRUE(comes(Search)) << log();
        EXPECT_TRUE(comesToFront("Quick Search"));
        EXPECT_TRUE(
            waitUntil([&] { return reader().text(plume_->process().pid(), "Search snippets") == "hil"; }, Bound));
        picture("search-" + nameOf(kind) + "-" + nameOf(GetParam()));
        rig_.keyboard().tap(Key::Return);
        // Faster than anybody types.
        std::this_thread::sleep_for(Milliseconds(15));
        rig_.keyboard().type("!");
        expectText("at 12 Hill Road!");
        EXPECT_TRUE(goes(Search));
        EXPECT_TRUE(isTargetInFront());
        target_ = nullptr;
    }
}

TEST_P(ListsTest, SearchGivesTheKeyboardBackHoweverItEnds) {
    start();
    open(TargetKind::GtkTextView);
    typeAndSee("a");
    const auto openSearch = [&] {
        rig_.keyboard().tap(Key::F3);
        ASSERT_TRUE(comes(Search)) << log();
        ASSERT_TRUE(comesToFront("Quick Search")) << log();
    };
    openSearch();
    rig_.keyboard().tap(Key::Escape);
    EXPECT_TRUE(goes(Search)) << log();
    EXPECT_TRUE(waitUntil([&] { return isTargetInFront(); }, Bound));
    typeAndSee("b");

    openSearch();
    const XClient::Place window = rig_.client().placeOf(target_->window());
    rig_.click(window.x + 10, window.y + window.height - 10);
    EXPECT_TRUE(goes(Search)) << log();
    EXPECT_TRUE(waitUntil([&] { return isTargetInFront(); }, Bound));

    openSearch();
    rig_.keyboard().type("cafe");
    rig_.keyboard().chord({Key::LeftControl}, Key::Return);
    EXPECT_TRUE(goes(Search)) << log();
    EXPECT_TRUE(waitUntil([&] { return isTargetInFront(); }, Bound));
    target_->clear();
    rig_.keyboard().chord({Key::LeftControl}, U'v');
    expectText("Café Central, Herrengasse 14");

    target_->clear();
    command({"quick-search"});
    ASSERT_TRUE(comesToFront("Quick Search")) << log();
    rig_.keyboard().type("signat");
    rig_.keyboard().type("2");
    expectText("Best, Jo from work");
}

TEST_P(ListsTest, SearchOpensWhatIsToBeEdited) {
    start();
    open(TargetKind::GtkTextView);
    rig_.keyboard().tap(Key::F3);
    ASSERT_TRUE(comesToFront("Quick Search")) << log();
    rig_.keyboard().type("btw");
    rig_.keyboard().chord({Key::LeftControl}, U'e');
    ASSERT_TRUE(comesToFront("Snippets")) << log();
    std::this_thread::sleep_for(Milliseconds(300));
    ASSERT_TRUE(hasFocus("Snippets")) << "the program took the keyboard back";
    rig_.keyboard().chord({Key::LeftControl}, U'a');
    rig_.keyboard().type("byw");
    rig_.keyboard().chord({Key::LeftControl}, U'w');
    EXPECT_TRUE(waitUntil([&] { return !hasFocus("Snippets"); }, Bound));
    target_->activate();
    expectSoon(*target_, "x byw ", "x by the way ");
}

TEST_P(ListsTest, SearchSaysWhyItDoesNotSend) {
    start();
    open(TargetKind::GtkTextView);
    const auto other = rig_.startTarget(TargetKind::QtTextEdit);
    target_->activate();
    pointAt(*target_);
    expectSoon(*target_, "x btw ", "x by the way ");
    rig_.keyboard().tap(Key::F3);
    ASSERT_TRUE(comesToFront("Quick Search")) << log();
    rig_.keyboard().type("hill");
    target_ = nullptr;  // its program ends
    rig_.keyboard().tap(Key::Return);
    EXPECT_TRUE(waitUntil([&] { return contains(log(), "The snippet was not sent"); }, Bound)) << log();
    EXPECT_EQ(other->text(), "") << "it went into another window";
}

// A storm of windows that come and go while snippets are sent: each arrives where it was asked for, or nowhere. How
// many, the environment may say.
TEST_P(ListsTest, SearchSendsNothingIntoAWrongWindow) {
    enum class Disturbance : std::uint8_t { BeforeReturn, AtReturn, AfterReturn, None };
    start();
    open(TargetKind::GtkTextView);
    const auto other = rig_.startTarget(TargetKind::QtTextEdit);
    std::mt19937 random(7);  // NOLINT(cert-msc32-c,cert-msc51-cpp)
    const char* const wanted = std::getenv("PLUME_SENDS");
    const int sends = wanted ? std::atoi(wanted) : 12;
    for (int send = 0; send < sends; ++send) {
        target_->activate();
        pointAt(*target_);
        target_->clear();
        rig_.keyboard().tap(Key::F3);
        ASSERT_TRUE(comesToFront("Quick Search")) << log();
        rig_.keyboard().type("hill");
        const auto disturbance = static_cast<Disturbance>(random() % 4);
        if (disturbance == Disturbance::BeforeReturn) other->showPassword(true);
        rig_.keyboard().tap(Key::Return);
        if (disturbance == Disturbance::AtReturn) other->showPassword(true);
        std::this_thread::sleep_for(Milliseconds(random() % 8));
        if (disturbance == Disturbance::AfterReturn) other->showPassword(true);
        const std::string got = target_->awaitText("12 Hill Road", Milliseconds(1'300));
        const bool mayFail = disturbance != Disturbance::None && got.empty();
        EXPECT_TRUE(mayFail || got == "12 Hill Road") << got << ", send " << send << log();
        EXPECT_EQ(other->text(), "") << "send " << send;
        other->showPassword(false);
        other->clear();
    }
}

// Two screens side by side, and windows drawn at twice their size.
TEST_P(ListsTest, ListsStandOnTheScreenOfTheCaretAtTwiceTheSizeToo) {
    constexpr int Middle = 640;
    constexpr int Height = 800;
    for (const char* const monitor : {"left 640/170x800/210+0+0 DUMMY0", "right 640/170x800/210+640+0 none"}) {
        std::istringstream words(monitor);
        std::vector<std::string> arguments{"xrandr", "--setmonitor"};
        for (std::string word; words >> word;) arguments.push_back(word);
        ASSERT_EQ(rig_.session().start(arguments, "x11-xserver-utils")->waitForExit(Bound), 0);
    }
    for (const char* const scale : {"1", "2"}) {
        SCOPED_TRACE(scale);
        start({std::string("QT_SCALE_FACTOR=") + scale});
        open(TargetKind::GtkTextView);
        for (const bool isRight : {false, true}) {
            SCOPED_TRACE(isRight);
            const std::uint32_t place[] = {isRight ? 900U : 100U, 600U, 300U, 120U};
            xcb_configure_window(
                rig_.client().connection(), target_->window(),
                XCB_CONFIG_WINDOW_X | XCB_CONFIG_WINDOW_Y | XCB_CONFIG_WINDOW_WIDTH | XCB_CONFIG_WINDOW_HEIGHT, place);
            xcb_flush(rig_.client().connection());
            ASSERT_TRUE(
                waitUntil([&] { return (rig_.client().placeOf(target_->window()).x >= Middle) == isRight; }, Bound));
            target_->clear();
            typeAndSee("a si");
            for (const auto& [key, list] : {std::pair(Key::F2, List), std::pair(Key::F3, Search)}) {
                rig_.keyboard().tap(key);
                ASSERT_TRUE(comes(list)) << log();
                picture(std::string("screens-") + scale + (isRight ? "-right-" : "-left-") + list);
                const double left = isRight ? Middle : 0;
                const auto isOnScreen = [&](const Rectangle& at) {
                    return at.size.width > 0 && at.origin.x >= left && at.origin.x + at.size.width <= left + Middle &&
                           at.origin.y + at.size.height <= Height;
                };
                // A window manager may move it once more.
                EXPECT_TRUE(waitUntil([&] { return isOnScreen(windowOfPlume()); }, Milliseconds(1'000)))
                    << list << " is at " << windowOfPlume().origin.x;
                rig_.keyboard().tap(Key::Escape);
                ASSERT_TRUE(goes(list)) << log();
            }
        }
        target_ = nullptr;
        plume_ = nullptr;
    }
}

INSTANTIATE_TEST_SUITE_P(WindowManagers, ListsTest,
                         testing::Values(WindowManager::Openbox, WindowManager::OpenboxFollowingPointer,
                                         WindowManager::Xfwm4),
                         [](const auto& manager) { return nameOf(manager.param); });

}  // namespace

}  // namespace plume::rig

// Forms on a whole desktop, drawn as pages and as plain windows: what is typed into them, where their text goes, and
// what becomes of it when something goes wrong.
#include <csignal>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <random>
#include <string>
#include <thread>

#include "testing/rig/Screenshot.h"
#include "tests/desktop/ApplicationDesktop.h"

namespace plume::rig {

namespace {

constexpr const char* Letters = R"json([
  { "name": "Letters", "abbreviationPrefix": ";", "expandAfter": 2, "expandTrigger": 0, "items": [
      { "abbreviation": "dear", "label": "A letter",
        "content": "Dear 【field:Name】,\nthank you for 【field:What value:\"your help\"】.\nYours, 【field:Name】" },
      { "abbreviation": "all", "label": "Every kind",
        "content": "【field:One】|【field:Lines type:1】|【field:Size type:2 value:\"S\nM\nL\"】|【field:net type:3 value:2】|【field:gross type:3 value:net*2】|【field:Maybe value:yes optional:0】|【field:Fixed value:rock readonly】" },
      { "abbreviation": "evil", "label": "<b>Evil</b>",
        "content": "<script>document.title='x'</script>【field:\"<img src=x onerror=alert(1)>\" value:\"</span><script>alert(2)</script>\"】&amp;" },
      { "abbreviation": "sig", "content": "Kind regards, Jo" } ] }
])json";

enum class Drawing : std::uint8_t { Page, Plain };

class FormTest : public ApplicationDesktop, public testing::WithParamInterface<Drawing> {
  protected:
    void SetUp() override {
        ApplicationDesktop::SetUp();
        keepLibrary(Letters);
        if (GetParam() == Drawing::Plain) command({"settings", "PlainForms", "true"});
    }

    void open(TargetKind kind) {
        target_ = rig_.startTarget(kind);
        expectSoon(*target_, "x ;sig", "x Kind regards, Jo");
        target_->clear();
    }
    void type(const std::string& text) { rig_.keyboard().type(text); }
    void tap(Key key) { rig_.keyboard().tap(key); }
    void acceptAnywhere() { rig_.keyboard().chord({Key::LeftControl}, Key::Return); }
    void expectText(const std::string& expected) { EXPECT_EQ(target_->awaitText(expected), expected) << log(); }
    // What stands in a field of the form that has the keyboard; nothing while it cannot be read.
    std::optional<std::string> filled(const std::string& title, const std::string& field) {
        if (!hasFocus(title)) return std::nullopt;
        const pid_t drawing = formProgram();
        const auto page = drawing != 0 ? reader().text(drawing, field) : std::nullopt;
        return page ? page : reader().text(plume_->process().pid(), field);
    }
    // The form is there, and what was typed for it has arrived.
    bool becomesFilled(const std::string& title, const std::string& field, const std::string& text) {
        return waitUntil([&] { return filled(title, field) == text; }, Bound);
    }
    bool isTargetInFront() { return rig_.client().activeWindow() == target_->window(); }
    // For people who look at it: into the folder that the environment names.
    void picture(const std::string& name) {
        const char* const folder = std::getenv("PLUME_SCREENSHOTS");
        if (!folder) return;
        std::this_thread::sleep_for(Milliseconds(300));
        const auto file = std::filesystem::path(folder) / (name + "-" + nameOfDrawing() + ".png");
        if (!target_) return writeScreenshot(rig_.client(), file);
        // With what is around it.
        const XClient::Place place = rig_.client().placeOf(target_->window());
        writeScreenshot(rig_.client(), file, {place.x - 20, place.y - 30, place.width + 160, place.height + 50});
    }
    static std::string nameOfDrawing() { return GetParam() == Drawing::Page ? "page" : "plain"; }

    // The program that draws pages; 0 when none runs.
    pid_t formProgram() const {
        for (const auto& entry : std::filesystem::directory_iterator("/proc")) {
            std::ifstream file(entry.path() / "stat");
            std::string number;
            std::string name;
            std::string state;
            pid_t parent = 0;
            if (file >> number >> name >> state >> parent && name == "(plume-form)" &&
                parent == plume_->process().pid()) {
                return std::stoi(number);
            }
        }
        return 0;
    }

    std::unique_ptr<TargetProgram> target_;
};

TEST_P(FormTest, TakesWhatIsTypedBehindTheAbbreviationAndSendsTheText) {
    start();
    for (const TargetKind kind : {TargetKind::GtkTextView, TargetKind::QtTextEdit, TargetKind::Xterm}) {
        SCOPED_TRACE(nameOf(kind));
        open(kind);
        // Without a pause, as somebody types who knows the form.
        type("x ;dearAda");
        ASSERT_TRUE(comesToFront("A letter")) << log();
        EXPECT_EQ(target_->text(), "x ");
        tap(Key::Tab);
        type("your letter");
        picture("form-" + nameOf(kind));
        tap(Key::Return);
        std::this_thread::sleep_for(Milliseconds(15));
        type("!");
        expectText("x Dear Ada,\nthank you for your letter.\nYours, Ada!");
        EXPECT_TRUE(isTargetInFront());
        target_ = nullptr;
    }
}

TEST_P(FormTest, HasEveryKindOfField) {
    start();
    open(TargetKind::GtkTextView);
    type(";all");
    ASSERT_TRUE(comesToFront("Every kind")) << log();
    type("one");
    tap(Key::Tab);
    type("two");
    tap(Key::Return);
    type("three");
    tap(Key::Tab);
    tap(Key::Down);
    tap(Key::Tab);
    rig_.keyboard().chord({Key::LeftControl}, U'a');
    type("21");
    rig_.keyboard().chord({Key::LeftAlt}, U'm');
    picture("kinds");
    acceptAnywhere();
    expectText("one|two\nthree|M|21|42|yes|rock");
}

TEST_P(FormTest, SendsNothingWhenItIsCancelled) {
    start();
    open(TargetKind::QtTextEdit);
    type("x ;dearAda");
    ASSERT_TRUE(comesToFront("A letter")) << log();
    tap(Key::Escape);
    EXPECT_TRUE(waitUntil([&] { return isTargetInFront(); }, Bound));
    type("y");
    expectText("x y");
}

TEST_P(FormTest, SendsIntoItsOwnProgramWhereverTheUserWasMeanwhile) {
    start();
    open(TargetKind::GtkTextView);
    const auto other = rig_.startTarget(TargetKind::QtTextEdit);
    target_->activate();
    expectSoon(*target_, "x ;sig", "x Kind regards, Jo");
    target_->clear();
    type(";dearAda");
    ASSERT_TRUE(becomesFilled("A letter", "Name", "Ada")) << log();
    const xcb_window_t form = rig_.client().activeWindow();
    other->activate();
    type("a note");
    EXPECT_EQ(other->awaitText("a note"), "a note");
    rig_.client().activate(form);
    ASSERT_TRUE(becomesFilled("A letter", "Name", "Ada")) << log();
    tap(Key::End);
    type(" L");
    tap(Key::Return);
    expectText("Dear Ada L,\nthank you for your help.\nYours, Ada L");
    EXPECT_EQ(other->text(), "a note");
}

TEST_P(FormTest, KeepsTheTextWhenItsProgramIsGone) {
    start();
    open(TargetKind::GtkTextView);
    const auto other = rig_.startTarget(TargetKind::QtTextEdit);
    target_->activate();
    expectSoon(*target_, "x ;sig", "x Kind regards, Jo");
    type(";dearAda");
    ASSERT_TRUE(becomesFilled("A letter", "Name", "Ada")) << log();
    target_ = nullptr;  // its program ends
    tap(Key::Return);
    const pid_t plume = plume_->process().pid();
    ASSERT_TRUE(waitUntil([&] { return reader().place(plume, "Try Again").has_value(); }, Bound)) << log();
    picture("unsent");
    const xcb_window_t owner = rig_.client().selectionOwner("CLIPBOARD");
    ASSERT_TRUE(click("Copy"));
    ASSERT_TRUE(comesToFront("Text Not Inserted")) << "who clicks on it is there";
    // Until then the window may still be taking the focus that the click has brought.
    ASSERT_TRUE(waitUntil([&] { return rig_.client().selectionOwner("CLIPBOARD") != owner; }, Bound)) << log();
    other->activate();
    rig_.keyboard().chord({Key::LeftControl}, U'v');
    const std::string letter = "Dear Ada,\nthank you for your help.\nYours, Ada";
    EXPECT_EQ(other->awaitText(letter), letter);
}

TEST_P(FormTest, ShowsMarkupAsText) {
    start();
    open(TargetKind::GtkTextView);
    type(";evil");
    ASSERT_TRUE(comesToFront("<b>Evil</b>")) << log();
    picture("evil");
    tap(Key::End);
    type("<u>");
    tap(Key::Return);
    expectText("<script>document.title='x'</script></span><script>alert(2)</script><u>&amp;");
}

TEST_P(FormTest, SeveralStandBesideEachOther) {
    start();
    open(TargetKind::GtkTextView);
    type(";dearAda");
    ASSERT_TRUE(becomesFilled("A letter", "Name", "Ada")) << log();
    const xcb_window_t letter = rig_.client().activeWindow();
    target_->activate();
    expectSoon(*target_, ";sig", "Kind regards, Jo");
    target_->clear();
    type(";allone");
    ASSERT_TRUE(becomesFilled("Every kind", "One", "one")) << log();
    rig_.client().activate(letter);
    ASSERT_TRUE(becomesFilled("A letter", "Name", "Ada")) << log();
    tap(Key::Return);
    expectText("Dear Ada,\nthank you for your help.\nYours, Ada");
}

TEST_P(FormTest, GoesWithPlumeAndSendsNothing) {
    start();
    open(TargetKind::GtkTextView);
    type(";dearAda");
    ASSERT_TRUE(becomesFilled("A letter", "Name", "Ada")) << log();
    const pid_t drawing = formProgram();
    EXPECT_EQ(drawing != 0, GetParam() == Drawing::Page);
    plume_ = nullptr;
    EXPECT_TRUE(waitUntil([&] { return isTargetInFront(); }, Bound));
    if (drawing != 0) {
        EXPECT_TRUE(waitUntil([&] { return kill(drawing, 0) != 0; }, Bound));
    }
    type("y");
    expectText("y");
}

// Whenever the program that draws dies, the text arrives once and whole, or the form comes back with what had been
// typed into it. What was on its way into the dead program is lost with it. How often, the environment may say.
TEST_P(FormTest, ComesBackWithWhatWasTypedWhenItsProgramDies) {
    if (GetParam() == Drawing::Plain) GTEST_SKIP() << "there is none";
    const std::string name = "Ada";
    const std::string letter = "Dear Ada,\nthank you for your help.\nYours, Ada";
    start();
    open(TargetKind::GtkTextView);
    std::mt19937 random(11);  // NOLINT(cert-msc32-c,cert-msc51-cpp)
    const char* const wanted = std::getenv("PLUME_KILLS");
    const int kills = wanted ? std::atoi(wanted) : 4;
    for (int round = 0; round < kills; ++round) {
        SCOPED_TRACE(round);
        target_->activate();
        target_->clear();
        type(";dear" + name);
        std::this_thread::sleep_for(Milliseconds(random() % 900));
        const bool isAccepted = random() % 2 == 0;
        if (isAccepted) tap(Key::Return);
        std::this_thread::sleep_for(Milliseconds(random() % 12));
        const pid_t killed = formProgram();
        if (killed != 0) kill(killed, SIGKILL);
        // The form is back with the whole name, or a Return that was on its way has sent the text.
        const auto goesOn = [&] {
            return target_->text() == letter || (formProgram() != killed && filled("A letter", "Name") == name);
        };
        if (!waitUntil(goesOn, Milliseconds(2'500)) && target_->text() != letter) {
            const auto left = filled("A letter", "Name");
            ASSERT_TRUE(left && name.starts_with(*left)) << left.value_or("no form") << target_->text() << log();
            tap(Key::End);
            type(name.substr(left->size()));
        }
        // Another Return is for the form alone.
        if (isAccepted) waitUntil([&] { return target_->text() == letter; }, Milliseconds(1'000));
        if (target_->text() != letter) tap(Key::Return);
        expectText(letter);
    }
}

INSTANTIATE_TEST_SUITE_P(Drawings, FormTest, testing::Values(Drawing::Page, Drawing::Plain),
                         [](const auto& drawing) { return drawing.param == Drawing::Page ? "Page" : "Plain"; });

}  // namespace

}  // namespace plume::rig

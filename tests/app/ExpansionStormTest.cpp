// A storm of edits on the main thread beside a storm of typing on the one that hears the keys, for ThreadSanitizer to
// watch; afterwards both libraries say the same, and what is typed expands to what was edited last.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <atomic>
#include <random>
#include <thread>

#include "app/Expansion.h"
#include "library/SettingsFile.h"
#include "ports/posix/PollRunLoop.h"
#include "ports/posix/PosixProcessLauncher.h"
#include "ports/simulated/SimulatedDesktop.h"
#include "tests/support/RunUntil.h"

namespace plume {

namespace {

class CountingListener final : public ExpansionListener {
  public:
    void enabledChanged(bool /*enabled*/) override {}
    void snippetUsed(const Uuid& /*snippet*/) override { ++used; }
    void hotKeyPressed(HotKeyForWindow /*hotKey*/) override {}
    void secureInputChanged() override {}
    void keyboardTapGivenUp() override {}
    void reported(const std::string& sentence) override { reports.push_back(sentence); }

    int used = 0;
    std::vector<std::string> reports;
};

std::vector<std::u16string> contentsOf(const SnippetGroups& groups) {
    std::vector<std::u16string> contents;
    for (const auto& group : groups) {
        contents.push_back(group->name().value_or(u""));
        for (const auto& snippet : group->items()) {
            contents.push_back(snippet->abbreviation().value_or(u"") + u"=" +
                               snippet->plainTextContent().value_or(u""));
        }
    }
    return contents;
}

class ExpansionStorm : public testing::Test {
  public:
    ExpansionStorm(const ExpansionStorm&) = delete;
    ExpansionStorm& operator=(const ExpansionStorm&) = delete;

  protected:
    ExpansionStorm() {
        desktop_.activate(u"org.example.editor");
        groups_.push_back(SnippetGroup::make());
        groups_.front()->setExpandAfter(ExpandAfter::Anything);
        for (int i = 0; i < 200; ++i) {
            groups_.front()->addItem(std::make_shared<Snippet>(u";" + number(i) + u";", u"first"));
        }
        expansion_.begin(feed_.changesTo(groups_), settings(true));
        expansion_.start();
        tapThread_ = std::thread([this] { tapLoop_.run(); });
    }
    ~ExpansionStorm() override {
        expansion_.end();
        tapLoop_.perform([this] { tapLoop_.stop(); });
        tapThread_.join();
    }

    static std::u16string number(int i) {
        const std::string digits = std::to_string(i);
        return {digits.begin(), digits.end()};
    }
    static PropertyList::Dictionary settings(bool clicks) {
        return {{"IsEnabled", true}, {"ListenMouseDownEvents", clicks}};
    }

    // On the other thread, again and again until it is told to end.
    void type() {
        if (ends_) return;
        const std::u16string abbreviation = u";" + number(typed_++ % 200) + u";";
        for (const char16_t character : abbreviation) desktop_.typeCharacter({&character, 1});
        desktop_.runLoop().runReady();
        again_ = tapLoop_.performAfterDelay(0, [this] { type(); });
    }
    void edit(std::mt19937& random) {
        auto& items = groups_.front()->items();
        switch (random() % 4) {
            case 0:
                groups_.front()->addItem(std::make_shared<Snippet>(u";new" + number(++added_) + u";", u"added"));
                break;
            case 1:
                if (items.size() > 100) groups_.front()->removeItem(items[random() % items.size()]);
                break;
            case 2:
                groups_.front()->setName(u"named " + number(added_));
                break;
            default:
                items[random() % items.size()]->setPlainTextContent(u"edited " + number(++added_));
        }
        if (auto update = feed_.changesTo(groups_)) expansion_.setLibrary(*std::move(update));
        if (random() % 16 == 0) expansion_.loadPreferences(settings(random() % 2 == 0));
        if (random() % 16 == 0) {
            expansion_.recentDecisions([this](const auto& decisions) { decided_ += decisions.size(); });
        }
    }

    PollRunLoop mainLoop_;
    PollRunLoop tapLoop_;
    SimulatedDesktop desktop_;
    PosixProcessLauncher launcher_;
    CountingListener listener_;
    SnippetGroups groups_;
    LibraryFeed feed_;
    std::atomic<bool> ends_ = false;
    Timer again_;    // of the other thread
    int typed_ = 0;  // the same
    int added_ = 0;
    std::size_t decided_ = 0;
    Expansion expansion_{
        {.ports = {desktop_.keyboardTap(), desktop_.mouseTap(), desktop_.poster(), desktop_.pasteboard(),
                   desktop_.processManager(), desktop_.inputSources(), desktop_.accessibility(), desktop_.secureInput(),
                   desktop_.systemHotKeys(), desktop_.sounds(), desktop_.notices(), launcher_, tapLoop_, mainLoop_},
         .applications = nullptr,
         .log = [](const std::string&) {},
         .listener = listener_,
         .hasWindows = true}};
    std::thread tapThread_;
};

}  // namespace

TEST_F(ExpansionStorm, BothThreadsSayTheSameInTheEnd) {
    std::mt19937 random(7);  // NOLINT(cert-msc32-c,cert-msc51-cpp): the same storm each time
    tapLoop_.perform([this] { type(); });
    constexpr int Edits = 3000;
    for (int i = 0; i < Edits; ++i) edit(random);
    ASSERT_TRUE(test::runUntil(mainLoop_, [this] { return listener_.used > 0 && decided_ > 0; }));
    ends_ = true;

    groups_.front()->items().front()->setAbbreviation(u";last;");
    groups_.front()->items().front()->setPlainTextContent(u"edited last");
    if (auto update = feed_.changesTo(groups_)) expansion_.setLibrary(*std::move(update));
    std::optional<std::vector<std::u16string>> theirs;
    std::u16string field;
    expansion_.ask([&](AutoText& engine) {
        again_.cancel();
        auto contents = contentsOf(engine.snippetGroups());
        for (const char16_t character : std::u16string_view(u" ;last;")) desktop_.typeCharacter({&character, 1});
        mainLoop_.perform([&theirs, contents = std::move(contents)] { theirs = contents; });
    });
    ASSERT_TRUE(test::runUntil(mainLoop_, [&] { return theirs.has_value(); }));
    EXPECT_EQ(*theirs, contentsOf(groups_));
    ASSERT_TRUE(test::runUntil(mainLoop_, [&] {
        expansion_.ask(
            [&](AutoText&) { mainLoop_.perform([&field, text = desktop_.front()->field().text()] { field = text; }); });
        return field.ends_with(u"edited last");
    })) << "what was typed last did not expand";
    EXPECT_THAT(listener_.reports, testing::IsEmpty());
}

}  // namespace plume

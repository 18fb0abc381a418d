// The application on a simulated desktop, with windows and an icon that only take notes: what menus, hot keys, settings
// and files bring about, in the windows and for who types.
#include "app/AppDelegate.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <map>

#include "library/LibraryFile.h"
#include "ports/posix/PosixProcessLauncher.h"
#include "ports/simulated/SimulatedDesktop.h"
#include "tests/library/LibraryMachine.h"

namespace plume {

namespace {

using test::Machine;
using test::SharedWorld;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

class NotedWindows final : public ApplicationWindows {
  public:
    void showMacrosWindow(bool /*expandAll*/) override { shown.emplace_back("main"); }
    void showSnippet(const std::shared_ptr<Snippet>& snippet) override {
        shown.push_back("edit " + toUtf8(snippet->abbreviation().value_or(u"")));
    }
    void showNewSnippetWindow(const std::u16string& content) override {
        shown.push_back("new snippet: " + toUtf8(content));
    }
    void showPreferencesWindow(const std::string& page) override { shown.push_back("preferences " + page); }
    void showAboutWindow() override { shown.emplace_back("about"); }
    void showDiagnosticWindow(const std::u16string& report) override { diagnostics = toUtf8(report); }
    void showReportsWindow() override { shown.emplace_back("reports"); }
    void showDecisionsWindow() override { shown.emplace_back("decisions"); }
    void showWelcomeWindow() override { shown.emplace_back("welcome"); }
    void showRestoreWindow() override { shown.emplace_back("restore"); }
    void showPrompt(const Error& missing, std::function<Result<void>()> checkAgain,
                    std::function<void()> closed) override {
        shown.push_back("prompt: " + missing.message);
        check = std::move(checkAgain);
        promptClosed = std::move(closed);
    }
    void askForFileUse(const Path& file, std::function<void(FileUse)> answer) override {
        shown.push_back("use of " + file.filename().string());
        answerFileUse = std::move(answer);
    }
    void askForFile(std::function<void(const Path&)> chosen) override { chosen("/shared/chosen.json"); }
    void askWhereToExport(std::function<void(const Path&)> chosen) override { chosen(exportTo); }
    void askForFirstSync(const std::string& folderName, std::function<void(int)> answer) override {
        shown.push_back("first sync with " + folderName);
        answerFirstSync = std::move(answer);
    }
    void tell(const std::u16string& message, const std::u16string& details) override {
        shown.push_back(toUtf8(message) + " " + toUtf8(details));
    }
    bool hasVisibleWindow() const override { return false; }
    void bringAllToFront() override {}
    void commitEdits() override {}

    Path exportTo;
    std::vector<std::string> shown;
    std::string diagnostics;
    std::function<Result<void>()> check;
    std::function<void()> promptClosed;
    std::function<void(FileUse)> answerFileUse;
    std::function<void(int)> answerFirstSync;
};

struct Icon {
    bool isUp = false;
    Status status;
};

class NotedIcon final : public StatusItem {
  public:
    explicit NotedIcon(Icon& icon) : icon_(icon) { icon_.isUp = true; }
    ~NotedIcon() override { icon_.isUp = false; }
    void setStatus(const Status& status) override { icon_.status = status; }
    bool isVisible() const override { return true; }

  private:
    Icon& icon_;
};

// A search window that its user does everything with.
class NotedSearch final : public QuickSearchView {
  public:
    void setEvents(Events events) override { told = std::move(events); }
    void show(const QuickSearchOpening& /*opening*/) override { isVisible = true; }
    void close() override { isVisible = false; }

    Events told;
    bool isVisible = false;
};

class RunningApplicationTest : public testing::Test {
  public:
    RunningApplicationTest(const RunningApplicationTest&) = delete;
    RunningApplicationTest& operator=(const RunningApplicationTest&) = delete;

  protected:
    RunningApplicationTest() { desktop_.activate(u"org.example.editor"); }
    ~RunningApplicationTest() override {
        delegate_.applicationWillTerminate();
        // The main loop runs no more by then.
        desktop_.runLoop().runReady();
    }

    // An empty library that is not the first one.
    void start() {
        Machine earlier(world_, "one", disk_);
        earlier.load();
        earlier.add(u"old");
        ASSERT_TRUE(earlier.manager->saveData());
        machine_.load();
        machine_.manager->snippetGroups().clear();
        launch();
    }
    void launch() {
        delegate_.applicationDidFinishLaunching([this]() -> Result<void> {
            ++loaded_;
            return {};
        });
        settle();
    }
    // Both threads have done what they were asked for.
    void settle() {
        constexpr int Rounds = 6;
        for (int i = 0; i < Rounds; ++i) {
            world_.loop.runReady();
            desktop_.runLoop().runReady();
        }
    }
    void pass(double seconds) {
        world_.loop.advance(seconds);
        desktop_.runLoop().advance(seconds);
        settle();
    }
    std::u16string typed(std::u16string_view text) {
        for (const char16_t character : text) desktop_.typeCharacter({&character, 1});
        pass(1);
        return desktop_.front()->field().text();
    }

    SharedWorld world_;
    Machine::Disk disk_ = std::make_shared<SimulatedLibraryStorage::Disk>();
    Machine machine_{world_, "one", disk_};
    SimulatedDesktop desktop_;
    PosixProcessLauncher launcher_;
    NotedWindows windows_;
    ReportLog reports_;
    Icon icon_;
    std::vector<std::string> log_;
    int loaded_ = 0;
    bool ended_ = false;
    SnippetUses uses_{machine_.settings};
    NotedSearch search_;
    AppDelegate delegate_{{.mainLoop = world_.loop,
                           .settings = machine_.settings,
                           .dataManager = *machine_.manager,
                           .windows = windows_,
                           .reports = reports_,
                           .suggestionView = {},
                           .quickSearchView = [this]() -> QuickSearchView& { return search_; },
                           .formView = {},
                           .uses = uses_,
                           .ports = {desktop_.keyboardTap(), desktop_.mouseTap(), desktop_.poster(),
                                     desktop_.pasteboard(), desktop_.processManager(), desktop_.inputSources(),
                                     desktop_.accessibility(), desktop_.secureInput(), desktop_.systemHotKeys(),
                                     desktop_.sounds(), desktop_.notices(), launcher_, desktop_.runLoop(), world_.loop},
                           .applications = nullptr,
                           .log = [this](const std::string& line) { log_.push_back(line); },
                           .makeStatusItem = [this] { return std::make_unique<NotedIcon>(icon_); },
                           .terminate = [this] { ended_ = true; },
                           .version = "1.2",
                           .systemVersion = "Example 3"}};
};

}  // namespace

TEST_F(RunningApplicationTest, ChangesOfTheLibraryAreInForceAtTheNextKey) {
    start();
    machine_.add(u";sig", u"Kind regards");
    settle();
    EXPECT_EQ(typed(u";sig"), u"Kind regards");
    machine_.manager->snippetGroups().front()->items().front()->setPlainTextContent(u"Yours, Ann");
    machine_.manager->notifyDataChanged();
    settle();
    EXPECT_EQ(typed(u" ;sig"), u"Kind regards Yours, Ann");
}

// Without a new version of the library, which every other machine would have to take over.
TEST_F(RunningApplicationTest, KeepsWhenASnippetWasUsed) {
    start();
    const auto snippet = machine_.add(u";sig", u"Regards");
    settle();
    const auto version = machine_.manager->library().versionUUIDString;
    const auto before = snippet->lastTimeUsed();
    pass(1);
    typed(u";sig");
    const auto used = snippet->lastTimeUsed();
    EXPECT_GT(used, before);
    EXPECT_EQ(machine_.manager->library().versionUUIDString, version);
    pass(60);
    Machine later(world_, "one", disk_);
    later.load();
    EXPECT_EQ(later.manager->snippetGroups().front()->items().front()->lastTimeUsed(), used);
}

TEST_F(RunningApplicationTest, SwitchesExpansionFromMenuHotKeyAndSettingsAlike) {
    machine_.settings.set("switchHotKey", std::int64_t{8589934630});  // Control+J
    start();
    machine_.add(u";a", u"x");
    settle();
    EXPECT_TRUE(icon_.status.isEnabled);
    delegate_.onEnabledItemClick();
    settle();
    EXPECT_FALSE(icon_.status.isEnabled);
    EXPECT_FALSE(machine_.settings.boolForKey("IsEnabled"));
    EXPECT_EQ(typed(u";a"), u";a");

    desktop_.pressAndRelease(KeyCode::J, KeyModifier::Control);
    settle();
    EXPECT_TRUE(icon_.status.isEnabled);
    EXPECT_TRUE(machine_.settings.boolForKey("IsEnabled"));
    EXPECT_EQ(typed(u";a"), u";ax");

    machine_.settings.set("IsEnabled", false);
    settle();
    EXPECT_FALSE(icon_.status.isEnabled);
    EXPECT_EQ(typed(u";a"), u";ax;a");
}

// Whoever switches expansion on types at once, while the setting is still being written.
TEST_F(RunningApplicationTest, KeepsWhatWasTypedWhenASettingChanges) {
    start();
    machine_.add(u";sig", u"Regards");
    settle();
    EXPECT_EQ(typed(u";si"), u";si");
    machine_.settings.set("PlayFeedbackSound", false);
    settle();
    EXPECT_EQ(typed(u"g"), u"Regards");
}

TEST_F(RunningApplicationTest, ShowsTheIconAsTheSettingSays) {
    machine_.settings.set("ShowStatusIcon", false);
    start();
    EXPECT_FALSE(icon_.isUp);
    machine_.settings.set("ShowStatusIcon", true);
    EXPECT_TRUE(icon_.isUp);
    machine_.settings.set("ShowStatusIcon", false);
    EXPECT_FALSE(icon_.isUp);
}

TEST_F(RunningApplicationTest, TellsOfSecureInput) {
    start();
    EXPECT_EQ(delegate_.secureInputStatus(), u"Secure Input is not enabled");
    desktop_.secureInput().setEnabled(true);
    pass(4);
    EXPECT_TRUE(icon_.status.secureInput);
    EXPECT_THAT(toUtf8(icon_.status.secureInputStatus), HasSubstr("Secure Input is enabled (by "));
    desktop_.secureInput().setEnabled(false);
    pass(4);
    EXPECT_FALSE(icon_.status.secureInput);
}

TEST_F(RunningApplicationTest, SendsAChosenSnippetOnceNoMenuHoldsTheKeyboard) {
    start();
    const auto snippet = machine_.add(u";sig", u"Regards");
    desktop_.secureInput().setEnabled(true);
    delegate_.sendSnippetDirectly(snippet);
    pass(0.1);
    EXPECT_EQ(desktop_.front()->field().text(), u"");
    desktop_.secureInput().setEnabled(false);
    pass(0.1);
    EXPECT_EQ(desktop_.front()->field().text(), u"Regards");

    desktop_.secureInput().setEnabled(true);
    delegate_.sendSnippetDirectly(snippet);
    pass(2);
    EXPECT_EQ(desktop_.front()->field().text(), u"Regards");
    EXPECT_THAT(reports_.reports().back().sentence, HasSubstr("not sent"));
}

TEST_F(RunningApplicationTest, ShowsTheMainWindowAtItsHotKey) {
    start();
    machine_.settings.set("openMainWindowHotKey", std::int64_t{8589934630});  // Control+J
    settle();
    desktop_.pressAndRelease(KeyCode::J, KeyModifier::Control);
    settle();
    EXPECT_THAT(windows_.shown, ElementsAre("main"));
}

TEST_F(RunningApplicationTest, MakesSnippetsFromTheClipboardAndTheSelection) {
    machine_.settings.set("makeSnippetFromClipboardHotKey", std::int64_t{8589934630});  // Control+J
    start();
    desktop_.pasteboard().copyFromProgram(u"copied");
    desktop_.pressAndRelease(KeyCode::J, KeyModifier::Control);
    settle();
    EXPECT_THAT(windows_.shown, ElementsAre("new snippet: copied"));
    desktop_.front()->setText(u"chosen");
    desktop_.front()->select({0, 6});
    delegate_.makeSnippetFromSelection();
    pass(0.4);
    EXPECT_EQ(windows_.shown.size(), 1U);
    pass(0.2);
    EXPECT_EQ(windows_.shown.back(), "new snippet: chosen");
}

TEST_F(RunningApplicationTest, PromptsForWhatIsMissingAndGoesOnWhenThatIsClosed) {
    desktop_.keyboardTap().setMissing("the keyboard cannot be heard");
    machine_.load();
    launch();
    EXPECT_THAT(windows_.shown, ElementsAre("prompt: the keyboard cannot be heard"));
    EXPECT_EQ(loaded_, 0);
    EXPECT_FALSE(windows_.check());
    desktop_.keyboardTap().setMissing(std::nullopt);
    EXPECT_TRUE(windows_.check());
    windows_.promptClosed();
    settle();
    EXPECT_EQ(loaded_, 1);
    EXPECT_TRUE(delegate_.uiLoaded());
    EXPECT_EQ(windows_.shown.back(), "welcome") << "the library was made at this start";
}

TEST_F(RunningApplicationTest, EndsWhenTheLibraryCannotBeOpened) {
    delegate_.applicationDidFinishLaunching([]() -> Result<void> { return Error{"it is a folder"}; });
    settle();
    EXPECT_THAT(windows_.shown, ElementsAre(HasSubstr("it is a folder")));
    EXPECT_TRUE(ended_);
    EXPECT_FALSE(delegate_.uiLoaded());
}

TEST_F(RunningApplicationTest, OpensAFileThatCameDuringTheStartAfterIt) {
    static_cast<void>(world_.files.createFolder("/shared"));
    static_cast<void>(world_.files.write("/shared/chosen.json",
                                         R"([{"name": "Brought", "items": [{"abbreviation": "b", "content": "c"}]}])"));
    delegate_.applicationOpenFile("/shared/first.json");
    delegate_.applicationOpenFile("/shared/chosen.json");
    EXPECT_THAT(windows_.shown, IsEmpty());
    start();
    EXPECT_THAT(windows_.shown, ElementsAre("use of chosen.json"));
    windows_.answerFileUse(ApplicationWindows::FileUse::Nothing);
    EXPECT_THAT(machine_.library(), IsEmpty());
    delegate_.openDocument();
    windows_.answerFileUse(ApplicationWindows::FileUse::Import);
    EXPECT_THAT(machine_.library(), ElementsAre("Brought: b=c"));
    EXPECT_EQ(windows_.shown.back(), "main");
    delegate_.openFile("/shared/missing.json");
    windows_.answerFileUse(ApplicationWindows::FileUse::Restore);
    EXPECT_THAT(windows_.shown.back(), HasSubstr("missing.json"));
    EXPECT_THAT(machine_.library(), ElementsAre("Brought: b=c"));
}

TEST_F(RunningApplicationTest, ExportsTheLibraryByTheEndingOfTheFile) {
    start();
    machine_.add(u";sig", u"Kind regards");
    ASSERT_TRUE(world_.files.createFolder("/shared"));
    for (const char* path : {"/shared/all.json", "/shared/all.plume", "/shared/all.csv"}) {
        windows_.exportTo = path;
        delegate_.saveDocumentTo();
        ASSERT_TRUE(world_.files.exists(path)) << path;
    }
    EXPECT_THAT(windows_.shown, IsEmpty());
    const auto groups = LibraryFile::read(world_.files.read("/shared/all.json").value(), "all.json");
    ASSERT_TRUE(groups) << groups.error().message;
    EXPECT_EQ(groups.value().front()->items().front()->plainTextContent(), u"Kind regards");

    windows_.exportTo = "/shared/all.txt";
    delegate_.saveDocumentTo();
    EXPECT_FALSE(world_.files.exists("/shared/all.txt"));
    EXPECT_THAT(windows_.shown, ElementsAre(HasSubstr("/shared/all.txt")));
}

TEST_F(RunningApplicationTest, HearsNothingWhileTheMachineSleeps) {
    start();
    machine_.add(u";a", u"x");
    settle();
    typed(u";");
    delegate_.workspaceWillSleep();
    settle();
    EXPECT_FALSE(desktop_.keyboardTap().exists());
    delegate_.workspaceDidWake();
    settle();
    EXPECT_EQ(typed(u"a"), u";a") << "what was typed before the sleep counts no more";
    EXPECT_EQ(typed(u" ;a"), u";a x");
}

TEST_F(RunningApplicationTest, RecordsAHotKeyThatNobodyElseHears) {
    machine_.settings.set("switchHotKey", std::int64_t{8589934630});  // Control+J
    start();
    std::vector<GeneralHotKey> heard;
    delegate_.expansion().beginRecordingHotKey([&](const GeneralHotKey& hotKey) { heard.push_back(hotKey); });
    settle();
    desktop_.pressAndRelease(KeyCode::J, KeyModifier::Control);
    desktop_.pressCombination(KeyModifier::Control | KeyModifier::Option, std::nullopt);
    settle();
    EXPECT_THAT(heard, ElementsAre(GeneralHotKey{KeyModifier::Control, KeyCode::J},
                                   GeneralHotKey{KeyModifier::Control | KeyModifier::Option, KeyCode::None}));
    EXPECT_TRUE(icon_.status.isEnabled);
    EXPECT_EQ(desktop_.front()->field().text(), u"");
    delegate_.expansion().endRecordingHotKey();
    settle();
    desktop_.pressAndRelease(KeyCode::J, KeyModifier::Control);
    settle();
    EXPECT_FALSE(icon_.status.isEnabled);
    EXPECT_EQ(heard.size(), 2U);
    EXPECT_EQ(delegate_.expansion().keyName(KeyCode::F5), u"F5");
}

TEST_F(RunningApplicationTest, DiagnosesWithoutAnyContent) {
    start();
    machine_.add(u";secret", u"hidden text");
    delegate_.diagnostic();
    settle();
    EXPECT_THAT(windows_.diagnostics,
                HasSubstr("Plume version: 1.2\nSystem version: Example 3\n\nPlume is enabled.\n"));
    EXPECT_THAT(windows_.diagnostics, testing::Not(HasSubstr("secret")));
    EXPECT_THAT(windows_.diagnostics, testing::Not(HasSubstr("hidden")));
}

TEST_F(RunningApplicationTest, ReportsOnceWhatIsSaidAgainAndAgain) {
    desktop_.processManager().setEventTaps({{true, {7, u"org.example.tap", u"Tapper", std::nullopt}}});
    start();
    ASSERT_EQ(reports_.reports().size(), 1U);
    EXPECT_THAT(reports_.reports().front().sentence, HasSubstr("Tapper takes keys, too"));
    for (int i = 0; i < 3; ++i) delegate_.report("The script failed.");
    EXPECT_EQ(reports_.reports().back().count, 3U);
    ASSERT_EQ(desktop_.notices().shown().size(), 1U);
    desktop_.notices().press("Plume", "Show Reports");
    EXPECT_EQ(windows_.shown.back(), "reports");
}

TEST_F(RunningApplicationTest, SendsNothingForASnippetThatIsGone) {
    start();
    const auto snippet = machine_.add(u";sig", u"Regards");
    delegate_.sendSnippetDirectly(snippet);
    machine_.manager->snippetGroups().front()->removeItem(snippet);
    pass(0.1);
    EXPECT_EQ(desktop_.front()->field().text(), u"");
}

TEST_F(RunningApplicationTest, OpensTheSnippetThatWasUsedLast) {
    machine_.settings.set("OpenLastUsedSnippetHotKey", std::int64_t{8589934630});  // Control+J
    start();
    machine_.add(u";one", u"1");
    const auto two = machine_.add(u";two", u"2");
    settle();
    const auto press = [this] {
        desktop_.pressAndRelease(KeyCode::J, KeyModifier::Control);
        settle();
        return windows_.shown.empty() ? std::string() : windows_.shown.back();
    };
    EXPECT_EQ(press(), "main") << "none was used in this run";
    typed(u";one ;two ");
    EXPECT_EQ(press(), "edit ;two");
    machine_.manager->snippetGroups().front()->removeItem(two);
    machine_.manager->notifyDataChanged();
    EXPECT_EQ(press(), "main");
}

TEST_F(RunningApplicationTest, CountsUsesAndForgetsThoseOfSnippetsThatAreGone) {
    start();
    const auto one = machine_.add(u";one", u"1");
    const auto two = machine_.add(u";two", u"2");
    settle();
    typed(u";one ;one ;two ");
    EXPECT_GT(uses_.weight(*one->uuid(), currentDate()), uses_.weight(*two->uuid(), currentDate()));
    machine_.manager->snippetGroups().front()->removeItem(two);
    machine_.manager->notifyDataChanged();
    settle();
    typed(u";one ");
    pass(60);
    const SnippetUses later(machine_.settings);
    EXPECT_EQ(later.weight(*one->uuid(), currentDate()), 1);
    EXPECT_EQ(later.weight(*two->uuid(), currentDate()), 0);
}

TEST_F(RunningApplicationTest, SendsWhatWasFoundIntoTheProgramBefore) {
    start();
    const auto snippet = machine_.add(u";sig", u"Regards");
    const auto other = machine_.add(u";other", u"Other");
    settle();
    const auto own = SimulatedProcessManager::windowOf(desktop_.processManager().currentProcess());
    const auto open = [&] {
        delegate_.quickSearch();
        settle();
        ASSERT_TRUE(search_.isVisible);
        search_.told.shown(own);
        pass(0.1);
        ASSERT_EQ(desktop_.processManager().frontWindow(), own);
    };
    open();
    delegate_.setFoundSnippets({snippet});
    settle();
    search_.isVisible = false;
    delegate_.sendFoundSnippet(snippet);
    pass(1);
    EXPECT_EQ(desktop_.front()->field().text(), u"Regards");

    // A download has put an equal one into its place.
    open();
    auto& group = *machine_.manager->snippetGroups().front();
    const auto newer = std::make_shared<Snippet>(*other->uuid());
    newer->setAbbreviation(u";other");
    newer->setPlainTextContent(u", Ann");
    group.removeItem(other);
    group.addItem(newer);
    machine_.manager->notifyDataChanged();
    delegate_.sendFoundSnippet(other);
    pass(1);
    EXPECT_EQ(desktop_.front()->field().text(), u"Regards, Ann");

    open();
    group.removeItem(snippet);
    delegate_.sendFoundSnippet(snippet);
    pass(1);
    EXPECT_EQ(desktop_.front()->field().text(), u"Regards, Ann");
    EXPECT_THAT(reports_.reports().back().sentence, HasSubstr("no longer in your library"));
}

TEST_F(RunningApplicationTest, SavesWhatWasChangedLastWhenItEnds) {
    start();
    machine_.add(u";late", u"kept");
    delegate_.applicationWillTerminate();
    Machine later(world_, "one", disk_);
    later.load();
    EXPECT_THAT(later.library(), ElementsAre("Mine: ;late=kept"));
    EXPECT_FALSE(icon_.isUp);
}

}  // namespace plume

// The application: starts up in order, gives settings to whom they concern, keeps the icon, the windows, the library
// and the thread that hears the keys in step, and does what menus, hot keys and other programs ask for.
//
// Owned by whoever puts the application together; belongs to the main thread. The library and its changes are the
// DataManager's, what is heard and sent is the Expansion's.
#pragma once

#include <filesystem>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "Foundation/Result.h"
#include "app/ApplicationWindows.h"
#include "app/Expansion.h"
#include "app/ReportLog.h"
#include "app/StatusItem.h"
#include "library/DataManager.h"
#include "library/LibraryFeed.h"
#include "library/SnippetUses.h"
#include "platform/RunLoop.h"
#include "platform/UserDefaults.h"

namespace plume {

class AppDelegate final : private ExpansionListener {
  public:
    using Path = std::filesystem::path;

    // Nothing is owned; all of it outlives the delegate.
    struct Dependencies {
        RunLoop& mainLoop;
        WritableUserDefaults& settings;
        DataManager& dataManager;
        ApplicationWindows& windows;
        ReportLog& reports;
        // See Expansion.
        std::function<SuggestionView&()> suggestionView;
        std::function<QuickSearchView&()> quickSearchView;
        std::function<FormView&()> formView;
        SnippetUses& uses;
        Composition::Ports ports;
        std::shared_ptr<const ApplicationTable> applications;
        std::function<void(const std::string& line)> log;
        // Puts the icon up; the delegate's operations are what its menu does.
        std::function<std::unique_ptr<StatusItem>()> makeStatusItem;
        // Ends the program, soon.
        std::function<void()> terminate;
        std::string version;
        std::string systemVersion;
    };

    explicit AppDelegate(Dependencies dependencies);
    ~AppDelegate() override;
    AppDelegate(const AppDelegate&) = delete;
    AppDelegate& operator=(const AppDelegate&) = delete;

    // ---- From start to end ----
    // `loadLibrary` has the DataManager made and loaded, as soon as the desktop is known to let Plume hear the
    // keyboard, or the user knows that it does not; an error is told and ends the program.
    void applicationDidFinishLaunching(std::function<Result<void>()> loadLibrary);
    // Saves. What is heard from now on is not Plume's.
    void applicationWillTerminate();
    void applicationShouldHandleReopen();
    void workspaceWillSleep();
    void workspaceDidWake();

    // ---- Settings ----
    void loadPreferences();

    // ---- The library ----
    // What has changed in it holds from the next key on.
    void feedExpansion();

    // ---- Files ----
    // A file of another program or of a menu: asks whether to import it or to restore it.
    void openFile(const Path& file);
    // The same for a file that is handed to the program, perhaps while it still starts.
    void applicationOpenFile(const Path& file);
    void openDocument();
    void saveDocumentTo();

    // ---- Commands ----
    void onEnabledItemClick();
    void makeSnippetFromSelection();
    void makeSnippetFromClipboard();
    void newDocument();
    void editSnippet(const std::shared_ptr<Snippet>& snippet);
    void openLastUsedSnippet();
    void showMacrosWindow();
    void showPreferencesWindow(const std::string& page = {});
    void showAboutWindow();
    void showWelcomeWindow();
    void showRestoreWindow();
    void showReportsWindow();
    void showDecisionsWindow();
    void diagnostic();
    void undo() { expansion_.undo(); }
    void expandAtHotkey() { expansion_.expandAtHotkey(); }
    void suggestAbbreviations() { expansion_.suggestAbbreviations(); }
    void quickSearch() { expansion_.quickSearch(); }
    void searchSnippets() { expansion_.quickSearchAtTopRightCorner(); }
    void tryKeyboardAgain();
    // Into the program that has the keyboard, as soon as no menu holds it.
    void sendSnippetDirectly(const std::shared_ptr<Snippet>& snippet);
    // What was chosen in the quick-search window, which is gone: into the program that had the keyboard before it.
    void sendFoundSnippet(const std::shared_ptr<Snippet>& snippet);
    // What that window shows first.
    void setFoundSnippets(const std::vector<std::shared_ptr<Snippet>>& snippets);
    void terminate() { around_.terminate(); }

    // ---- What it tells ----
    std::u16string secureInputStatus() const;
    Status status() const;
    bool uiLoaded() const { return uiLoaded_; }
    // The icon is seen somewhere.
    bool statusItemIsVisible() const { return statusItem_ && statusItem_->isVisible(); }
    Expansion& expansion() { return expansion_; }
    // A sentence for the user, from whoever has no window of its own.
    void report(const std::string& sentence) { reported(sentence); }

    // ---- What the DataManager asks ----
    void offerBackup(const std::optional<Path>& newestBackup);
    void askFirst(const std::string& folderName);

  private:
    void enabledChanged(bool enabled) override;
    void snippetUsed(const Uuid& snippet) override;
    void hotKeyPressed(HotKeyForWindow hotKey) override;
    void secureInputChanged() override;
    void keyboardTapGivenUp() override;
    void reported(const std::string& sentence) override;

    // The library is loaded, then everything that needs it begins.
    void finishLaunching();
    void initAutoTextAndUI();
    void observeLibrary();
    void observeSettings();
    void tellWhetherStarted();
    void tellConflicts(const std::vector<RunningApplication>& others);
    void beginLibraryUpkeep();
    PropertyList::Dictionary settings() const;
    void userDefaultsChanged(UserDefaultsChange& change);
    void libraryChanged(LibraryEvent& event);
    void keepUse();
    void refreshStatusItem();
    void updateStatusItem();
    void keepEnabled(bool enabled);
    void useFile(const Path& file, ApplicationWindows::FileUse use);
    void sendOnceKeyboardIsFree(const std::shared_ptr<Snippet>& snippet, int attemptsLeft);
    std::optional<Expansion::SnippetPlace> placeOf(const std::shared_ptr<Snippet>& snippet) const;
    std::shared_ptr<Snippet> snippetWithUuid(const Uuid& uuid) const;

    const Dependencies around_;
    Expansion expansion_;
    DataManager& manager_;
    ApplicationWindows& windows_;
    std::function<Result<void>()> loadLibrary_;
    LibraryFeed feed_;
    std::unique_ptr<StatusItem> statusItem_;
    std::optional<Uuid> lastUsedSnippet_;
    bool enabled_ = true;
    bool keyboardIsLost_ = false;
    bool uiLoaded_ = false;
    bool terminated_ = false;
    std::optional<Path> fileOpenedOnApplicationLaunching_;
    Timer start_;
    Timer feedTimer_;
    Timer useTimer_;
    Timer copyTimer_;
    Timer sendTimer_;
    Timer listenTimer_;
    std::vector<Subscription> observers_;
};

}  // namespace plume

#include "app/AppDelegate.h"

#include <algorithm>
#include <utility>

#include "Foundation/Strings.h"
#include "app/DiagnosticReport.h"
#include "library/KnownSettings.h"

namespace plume {

namespace {

// Seconds, all of these. Until a program has copied what it was told to copy.
constexpr double CopyDelay = 0.5;
// Uses come by the hundred, and nobody waits for them to be written down.
constexpr double UseDelay = 30;
// A menu that was just chosen from may hold the keyboard a moment longer.
constexpr double MenuPoll = 0.02;
constexpr int MenuPolls = 50;
// By itself the keyboard is tried again this long after it was given up; a moment more for that to be done.
constexpr double ListenAgainDelay = 61;

// Where windows stand, how large forms are, and what was used how often, is kept with the settings and sets nothing.
bool setsNothing(const std::string& key) {
    return key.starts_with("WindowPlace.") || key.starts_with("FieldsEditorSize ") || key == SnippetUses::Key;
}

}  // namespace

AppDelegate::AppDelegate(Dependencies dependencies)
    : around_(std::move(dependencies)),
      expansion_({.ports = around_.ports,
                  .applications = around_.applications,
                  .log = around_.log,
                  .listener = *this,
                  .hasWindows = true,
                  .suggestionView = around_.suggestionView,
                  .quickSearchView = around_.quickSearchView,
                  .formView = around_.formView}),
      manager_(around_.dataManager),
      windows_(around_.windows) {}

AppDelegate::~AppDelegate() = default;

// ---- From start to end ----

void AppDelegate::applicationDidFinishLaunching(std::function<Result<void>()> loadLibrary) {
    loadLibrary_ = std::move(loadLibrary);
    const Result<void> allowed = expansion_.testFunction();
    if (allowed) {
        start_ = around_.mainLoop.performAfterDelay(0, [this] { finishLaunching(); });
    } else {
        windows_.showPrompt(
            allowed.error(), [this] { return expansion_.testFunction(); }, [this] { finishLaunching(); });
    }
}

void AppDelegate::finishLaunching() {
    if (const auto loaded = loadLibrary_(); !loaded) {
        around_.log(loaded.error().message);
        windows_.tell(u"Your library cannot be opened.", fromUtf8(loaded.error().message));
        return around_.terminate();
    }
    initAutoTextAndUI();
}

void AppDelegate::initAutoTextAndUI() {
    expansion_.begin(feed_.changesTo(manager_.snippetGroups()), settings());
    observeLibrary();
    observeSettings();
    updateStatusItem();
    expansion_.start();
    if (manager_.emptyData()) windows_.showWelcomeWindow();
    beginLibraryUpkeep();
    uiLoaded_ = true;
    tellWhetherStarted();
    if (const auto file = std::exchange(fileOpenedOnApplicationLaunching_, std::nullopt)) openFile(*file);
}

// Behind everything that the start has asked of the other thread.
void AppDelegate::tellWhetherStarted() {
    expansion_.examine([this](const Expansion::Findings&) {
        expansion_.examine([this](const Expansion::Findings& findings) {
            if (!findings.evenTapCreated) return reported("Plume is not working: it cannot hear the keyboard.");
            tellConflicts(findings.tappingProcesses);
            std::size_t snippets = 0;
            for (const auto& group : manager_.snippetGroups()) snippets += group->items().size();
            around_.log("Plume is ready: " + std::to_string(snippets) + " snippets");
        });
    });
}

void AppDelegate::tellConflicts(const std::vector<RunningApplication>& others) {
    for (const RunningApplication& other : others) {
        const std::u16string name = other.localizedName ? *other.localizedName : other.bundleIdentifier.value_or(u"?");
        around_.reports.add(toUtf8(name) +
                            " takes keys, too. When letters get lost or come twice, end one of the two.");
    }
}

void AppDelegate::beginLibraryUpkeep() {
    manager_.sync().loadSyncPreferences(false);
    manager_.backups().startAutoBackupTimer();
}

void AppDelegate::applicationWillTerminate() {
    if (std::exchange(terminated_, true)) return;
    observers_.clear();
    for (Timer* timer : {&start_, &feedTimer_, &useTimer_, &copyTimer_, &sendTimer_, &listenTimer_}) timer->cancel();
    expansion_.end();
    statusItem_ = nullptr;
    windows_.commitEdits();
    if (const auto saved = manager_.saveRest(); !saved) around_.log(saved.error().message);
    if (const auto kept = around_.uses.write(); !kept) around_.log(kept.error().message);
}

void AppDelegate::applicationShouldHandleReopen() {
    windows_.hasVisibleWindow() ? windows_.bringAllToFront() : showMacrosWindow();
}

void AppDelegate::workspaceWillSleep() {
    expansion_.disableEvents();
}

void AppDelegate::workspaceDidWake() {
    expansion_.enableEvents();
}

// ---- Settings ----

PropertyList::Dictionary AppDelegate::settings() const {
    PropertyList::Dictionary values;
    for (const KnownSetting& setting : knownSettings()) {
        if (auto value = around_.settings.objectForKey(setting.name)) values.emplace(setting.name, *std::move(value));
    }
    return values;
}

void AppDelegate::loadPreferences() {
    expansion_.loadPreferences(settings());
    updateStatusItem();
}

void AppDelegate::observeSettings() {
    observers_.push_back(around_.settings.changedEvent.addObserver(this, &AppDelegate::userDefaultsChanged));
}

void AppDelegate::userDefaultsChanged(UserDefaultsChange& change) {
    if (manager_.sync().updatingPreferences()) return;
    if (std::ranges::all_of(change.keys, setsNothing)) return;
    loadPreferences();
    // The settings window tells by itself, once the user has chosen, and is asked which library is to be kept.
    const bool syncChanged = change.byAnotherProcess && std::ranges::any_of(change.keys, LibrarySync::isFolderSetting);
    if (syncChanged) manager_.sync().loadSyncPreferences(false);
}

void AppDelegate::updateStatusItem() {
    enabled_ = around_.settings.boolForKey("IsEnabled");
    const bool shows = around_.settings.boolForKey("ShowStatusIcon");
    if (shows && !statusItem_) statusItem_ = around_.makeStatusItem();
    if (!shows) statusItem_ = nullptr;
    refreshStatusItem();
}

void AppDelegate::refreshStatusItem() {
    if (statusItem_) statusItem_->setStatus(status());
}

// ---- The library ----

void AppDelegate::observeLibrary() {
    for (auto* event : {&manager_.didChangeDataEvent, &manager_.didImportDataEvent, &manager_.didSyncDataEvent}) {
        observers_.push_back(event->addObserver(this, &AppDelegate::libraryChanged));
    }
}

// What changes in one turn of the loop goes together.
void AppDelegate::libraryChanged(LibraryEvent& /*event*/) {
    if (feedTimer_) return;
    feedTimer_ = around_.mainLoop.performAfterDelay(0, [this] { feedExpansion(); });
}

void AppDelegate::feedExpansion() {
    feedTimer_.cancel();
    if (auto update = feed_.changesTo(manager_.snippetGroups())) expansion_.setLibrary(*std::move(update));
}

void AppDelegate::snippetUsed(const Uuid& snippet) {
    if (const auto used = snippetWithUuid(snippet)) used->updateLastTimeUsed();
    around_.uses.note(snippet, currentDate());
    lastUsedSnippet_ = snippet;
    if (!useTimer_) useTimer_ = around_.mainLoop.performAfterDelay(UseDelay, [this] { keepUse(); });
}

// Without a new version of the library: other machines have no need to hear of it.
void AppDelegate::keepUse() {
    useTimer_.cancel();
    if (const auto kept = manager_.writeJournal(); !kept) reported(kept.error().message);
    around_.uses.dropAllBut(manager_.snippetGroups());
    if (const auto kept = around_.uses.write(); !kept) reported(kept.error().message);
}

std::shared_ptr<Snippet> AppDelegate::snippetWithUuid(const Uuid& uuid) const {
    for (const auto& group : manager_.snippetGroups()) {
        const auto found = std::ranges::find(group->items(), std::optional(uuid), &Snippet::uuid);
        if (found != group->items().end()) return *found;
    }
    return nullptr;
}

void AppDelegate::offerBackup(const std::optional<Path>& newestBackup) {
    if (!newestBackup) return reported("The library was damaged, and there is no backup of it.");
    const std::string sentence = "The library was damaged. The newest backup is " + newestBackup->filename().string() +
                                 ". What could not be read is kept beside it.";
    const auto restore = [this, backup = *newestBackup] {
        const auto restored = manager_.restoreFile(backup);
        if (!restored) reported(restored.error().message);
    };
    around_.reports.add(sentence, {.label = "Restore", .run = restore});
    around_.ports.notices.show({"The library was damaged", sentence, {{"Restore", restore}}});
}

void AppDelegate::askFirst(const std::string& folderName) {
    windows_.askForFirstSync(folderName, [this](int returnCode) { manager_.sync().initalSyncSheetDidEnd(returnCode); });
}

// ---- Files ----

void AppDelegate::applicationOpenFile(const Path& file) {
    if (uiLoaded_) return openFile(file);
    fileOpenedOnApplicationLaunching_ = file;
}

void AppDelegate::openFile(const Path& file) {
    windows_.askForFileUse(file, [this, file](ApplicationWindows::FileUse use) { useFile(file, use); });
}

void AppDelegate::openDocument() {
    windows_.askForFile([this](const Path& file) { openFile(file); });
}

void AppDelegate::useFile(const Path& file, ApplicationWindows::FileUse use) {
    if (use == ApplicationWindows::FileUse::Nothing) return;
    const bool restores = use == ApplicationWindows::FileUse::Restore;
    const auto remarks = restores ? manager_.restoreFromFile(file) : manager_.importDataFromFile(file);
    if (!remarks) {
        const std::u16string message =
            restores ? u"The file could not be restored." : u"The file could not be imported.";
        return windows_.tell(message, fromUtf8(remarks.error().message));
    }
    for (const std::string& remark : remarks.value()) around_.reports.add(file.filename().string() + ": " + remark);
    manager_.notifyDataChanged();
    showMacrosWindow();
}

void AppDelegate::saveDocumentTo() {
    windows_.askWhereToExport([this](const Path& file) {
        const auto written = manager_.backupToFile(file);
        if (!written) windows_.tell(u"The library could not be exported.", fromUtf8(written.error().message));
    });
}

// ---- Commands ----

void AppDelegate::keepEnabled(bool enabled) {
    enabled_ = enabled;
    refreshStatusItem();
    // Raises a change, which gives the setting to everybody again.
    const auto kept = around_.settings.setObject("IsEnabled", enabled);
    if (!kept) reported(kept.error().message);
}

void AppDelegate::onEnabledItemClick() {
    expansion_.setEnabled(!enabled_);
    keepEnabled(!enabled_);
}

void AppDelegate::enabledChanged(bool enabled) {
    keepEnabled(enabled);
}

void AppDelegate::hotKeyPressed(HotKeyForWindow hotKey) {
    switch (hotKey) {
        case HotKeyForWindow::MakeSnippetFromClipboard:
            return makeSnippetFromClipboard();
        case HotKeyForWindow::MakeSnippetFromSelection:
            return makeSnippetFromSelection();
        case HotKeyForWindow::OpenMainWindow:
            return showMacrosWindow();
        case HotKeyForWindow::OpenLastUsedSnippet:
            return openLastUsedSnippet();
    }
}

void AppDelegate::makeSnippetFromSelection() {
    expansion_.sendCopyCommand();
    copyTimer_ = around_.mainLoop.performAfterDelay(CopyDelay, [this] { makeSnippetFromClipboard(); });
}

void AppDelegate::makeSnippetFromClipboard() {
    expansion_.readClipboard(
        [this](const std::optional<std::u16string>& text) { windows_.showNewSnippetWindow(text.value_or(u"")); });
}

void AppDelegate::newDocument() {
    windows_.showNewSnippetWindow({});
}

void AppDelegate::editSnippet(const std::shared_ptr<Snippet>& snippet) {
    windows_.showSnippet(snippet);
}

// Of this run; without one the snippets are shown.
void AppDelegate::openLastUsedSnippet() {
    const auto snippet = lastUsedSnippet_ ? snippetWithUuid(*lastUsedSnippet_) : nullptr;
    snippet ? editSnippet(snippet) : showMacrosWindow();
}

void AppDelegate::showMacrosWindow() {
    windows_.showMacrosWindow(false);
}

void AppDelegate::showPreferencesWindow(const std::string& page) {
    windows_.showPreferencesWindow(page);
}

void AppDelegate::showAboutWindow() {
    windows_.showAboutWindow();
}

void AppDelegate::showWelcomeWindow() {
    windows_.showWelcomeWindow();
}

void AppDelegate::showRestoreWindow() {
    windows_.showRestoreWindow();
}

void AppDelegate::showReportsWindow() {
    windows_.showReportsWindow();
}

void AppDelegate::showDecisionsWindow() {
    windows_.showDecisionsWindow();
}

void AppDelegate::diagnostic() {
    expansion_.examine([this](const Expansion::Findings& findings) {
        windows_.showDiagnosticWindow(
            diagnosticReport({.version = fromUtf8(around_.version),
                              .systemVersion = fromUtf8(around_.systemVersion),
                              .isEnabled = enabled_,
                              .hasEventTap = findings.evenTapCreated,
                              .foregroundProgram = findings.foregroundProgram,
                              .secureInputIsOn = expansion_.secureInput(),
                              .secureInputApplication = expansion_.lastAppEnabledSecureInput(),
                              .otherEventTaps = findings.tappingProcesses}));
    });
}

void AppDelegate::sendSnippetDirectly(const std::shared_ptr<Snippet>& snippet) {
    sendTimer_ = around_.mainLoop.performAfterDelay(0, [this, snippet] { sendOnceKeyboardIsFree(snippet, MenuPolls); });
}

void AppDelegate::sendOnceKeyboardIsFree(const std::shared_ptr<Snippet>& snippet, int attemptsLeft) {
    if (expansion_.keyboardIsHeld()) {
        if (attemptsLeft == 0) {
            return reported(
                "The snippet was not sent: another program holds the keyboard, or a password is asked for.");
        }
        sendTimer_ = around_.mainLoop.performAfterDelay(
            MenuPoll, [this, snippet, attemptsLeft] { sendOnceKeyboardIsFree(snippet, attemptsLeft - 1); });
        return;
    }
    // Places are those of the library that the other thread has.
    feedExpansion();
    if (const auto place = placeOf(snippet)) expansion_.sendSnippetDirectly(*place);
}

std::optional<Expansion::SnippetPlace> AppDelegate::placeOf(const std::shared_ptr<Snippet>& snippet) const {
    const SnippetGroups& groups = manager_.snippetGroups();
    // A download may have put an equal one into its place.
    const auto isIt = [&](const std::shared_ptr<Snippet>& each) {
        return each == snippet || (snippet->uuid() && each->uuid() == snippet->uuid());
    };
    for (std::size_t group = 0; group < groups.size(); ++group) {
        const auto& items = groups[group]->items();
        const auto found = std::ranges::find_if(items, isIt);
        if (found == items.end()) continue;
        return Expansion::SnippetPlace{group, static_cast<std::size_t>(found - items.begin())};
    }
    return std::nullopt;
}

void AppDelegate::sendFoundSnippet(const std::shared_ptr<Snippet>& snippet) {
    feedExpansion();
    expansion_.sendFoundSnippet(placeOf(snippet));
}

void AppDelegate::setFoundSnippets(const std::vector<std::shared_ptr<Snippet>>& snippets) {
    // At every key of a search: the library is gone through only where a change of it is still to be told.
    if (feedTimer_) feedExpansion();
    std::vector<std::optional<Expansion::SnippetPlace>> places;
    places.reserve(snippets.size());
    for (const auto& snippet : snippets) places.push_back(placeOf(snippet));
    expansion_.setFoundSnippets(std::move(places));
}

// ---- The keyboard ----

void AppDelegate::secureInputChanged() {
    refreshStatusItem();
}

std::u16string AppDelegate::secureInputStatus() const {
    return plume::secureInputStatus(expansion_.secureInput(), expansion_.lastAppEnabledSecureInput());
}

Status AppDelegate::status() const {
    return {.isEnabled = enabled_,
            .secureInput = expansion_.secureInput(),
            .secureInputStatus = secureInputStatus(),
            .keyboardIsLost = keyboardIsLost_};
}

void AppDelegate::keyboardTapGivenUp() {
    keyboardIsLost_ = true;
    refreshStatusItem();
    const std::string sentence =
        "Listening to the keyboard was ended three times within a minute, because Plume did not answer in time. It is "
        "tried again in a minute.";
    const auto listenAgain = [this] { tryKeyboardAgain(); };
    around_.reports.add(sentence, {.label = "Listen now", .run = listenAgain});
    around_.ports.notices.show({"Plume does not listen", sentence, {{"Listen now", listenAgain}}});
    listenTimer_ = around_.mainLoop.performAfterDelay(ListenAgainDelay, [this] {
        keyboardIsLost_ = false;
        refreshStatusItem();
    });
}

void AppDelegate::tryKeyboardAgain() {
    listenTimer_.cancel();
    keyboardIsLost_ = false;
    expansion_.tryTapAgain();
    refreshStatusItem();
}

void AppDelegate::reported(const std::string& sentence) {
    around_.log(sentence);
    around_.reports.add(sentence);
    // What is said again and again within a minute is counted there, and shown once.
    if (around_.reports.reports().back().count > 1) return;
    around_.ports.notices.show({"Plume", sentence, {{"Show Reports", [this] { showReportsWindow(); }}}});
}

}  // namespace plume

#include "app/cli/ApplicationServices.h"

#include <algorithm>
#include <cstdlib>
#include <numeric>
#include <optional>
#include <utility>

#include "Foundation/Strings.h"
#include "app/cli/Files.h"
#include "app/linux/LinuxApplications.h"
#include "import/Importers.h"
#include "ports/x11/windows/DesktopFiles.h"

namespace plume {

namespace {

constexpr std::size_t TrialsShown = 3;

std::string builtInRows() {
    const auto text = readWholeFile(dataFolder() / "applications.json");
    return text ? text.value() : std::string(compiledInApplications());
}

std::vector<std::string> soundNames(const Files& files) {
    std::vector<std::string> names;
    const auto listed = files.list(soundFolder());
    if (!listed) return names;
    for (const Files::Entry& entry : listed.value()) {
        const std::filesystem::path file = entry.name;
        if (!entry.isFolder && file.extension() == ".wav") names.push_back(file.stem().string());
    }
    std::ranges::sort(names);
    return names;
}

std::vector<InstalledProgram> installedPrograms() {
    std::vector<InstalledProgram> programs;
    for (const DesktopFile& file : DesktopFiles::ofEnvironment()->shown()) {
        programs.push_back({fromUtf8(file.identifier), fromUtf8(file.name), file.icon});
    }
    return programs;
}

// False when an abbreviation expands without one; nothing when a space does not make it expand.
std::optional<bool> expandsAfterSpace(const SnippetGroup& group) {
    switch (group.expandTrigger()) {
        case ExpandTrigger::Immediately:
            return false;
        case ExpandTrigger::DelimiterKept:
        case ExpandTrigger::DelimiterSwallowed:
            if (group.delimiters().value_or(AutoText::defaultDelimiters()).contains(u' ')) return true;
            return std::nullopt;
        case ExpandTrigger::Never:
        case ExpandTrigger::HotKey:
            break;
    }
    return std::nullopt;
}

// The first snippets that do the same on every machine and fit into a line.
std::vector<WelcomeServices::Trial> trialsIn(const SnippetGroups& groups) {
    std::vector<WelcomeServices::Trial> trials;
    constexpr std::size_t Longest = 60;
    for (const auto& group : groups) {
        const auto needsDelimiter = expandsAfterSpace(*group);
        if (!needsDelimiter) continue;
        for (const auto& snippet : group->items()) {
            if (trials.size() == TrialsShown) return trials;
            const auto abbreviation = snippet->abbreviationWithPrefix();
            const auto content = snippet->plainTextContent();
            const bool isPlain = snippet->contentType() == ContentType::PlainText && snippet->isSimpleSnippet();
            if (!isPlain || !abbreviation || abbreviation->empty() || !content || content->empty()) continue;
            if (content->size() > Longest || content->find(u'\n') != std::u16string::npos) continue;
            trials.push_back({*abbreviation, *content, *needsDelimiter});
        }
    }
    return trials;
}

}  // namespace

StatusMenuServices ApplicationServices::statusMenu() const {
    AppDelegate& delegate = around_.delegate;
    DataManager& manager = around_.library.manager();
    StatusMenuServices services;
    services.groups = [&manager]() -> const SnippetGroups& { return manager.snippetGroups(); };
    services.sendSnippetDirectly = [&delegate](const std::shared_ptr<Snippet>& snippet) {
        delegate.sendSnippetDirectly(snippet);
    };
    services.fontSizeDelta = [this] { return around_.library.settings().integerForKey("FontSizeDelta"); };
    services.toggleEnabled = [&delegate] { delegate.onEnabledItemClick(); };
    services.tryKeyboardAgain = [&delegate] { delegate.tryKeyboardAgain(); };
    services.newSnippet = [&delegate] { delegate.newDocument(); };
    services.makeSnippetFromClipboard = [&delegate] { delegate.makeSnippetFromClipboard(); };
    services.makeSnippetFromSelection = [&delegate] { delegate.makeSnippetFromSelection(); };
    services.showMacrosWindow = [&delegate] { delegate.showMacrosWindow(); };
    services.searchSnippets = [&delegate] { delegate.searchSnippets(); };
    services.showPreferences = [&delegate] { delegate.showPreferencesWindow(); };
    services.showReports = [&delegate] { delegate.showReportsWindow(); };
    services.showDecisions = [&delegate] { delegate.showDecisionsWindow(); };
    services.showDiagnostics = [&delegate] { delegate.diagnostic(); };
    services.importFile = [&delegate] { delegate.openDocument(); };
    services.exportLibrary = [&delegate] { delegate.saveDocumentTo(); };
    services.restore = [&delegate] { delegate.showRestoreWindow(); };
    services.showWelcome = [&delegate] { delegate.showWelcomeWindow(); };
    services.showAbout = [&delegate] { delegate.showAboutWindow(); };
    services.quit = [&delegate] { delegate.terminate(); };
    return services;
}

ProgramServices ApplicationServices::programs() const {
    Expansion& expansion = around_.delegate.expansion();
    return {.runningPrograms = [&expansion](auto told) { expansion.runningPrograms(std::move(told)); },
            .nextFrontProgram = [&expansion](auto told) { expansion.nextFrontProgram(std::move(told)); },
            .installedPrograms = installedPrograms};
}

PreferencesServices ApplicationServices::preferences() {
    AppDelegate& delegate = around_.delegate;
    Expansion& expansion = delegate.expansion();
    DataManager& manager = around_.library.manager();
    return {.settings = around_.library.settings(),
            .dataManager = manager,
            .beginRecordingHotKey = [&expansion](auto pressed) { expansion.beginRecordingHotKey(std::move(pressed)); },
            .endRecordingHotKey = [&expansion] { expansion.endRecordingHotKey(); },
            .tryHotKey = [&expansion](const GeneralHotKey& hotKey,
                                      auto told) { expansion.tryHotKey(hotKey, std::move(told)); },
            .keyName = [&expansion](KeyCode key) { return expansion.keyName(key); },
            .programs = programs(),
            .builtInApplicationRows = builtInRows(),
            .startsAtLogin = [this] { return autostart_.isOn(); },
            .setStartsAtLogin = [this](bool starts) { return autostart_.set(starts); },
            .soundNames = soundNames(around_.files),
            .playSound = [this](const std::string& name) { around_.sounds.playOrBeep(name); },
            .importFile = [&delegate] { delegate.openDocument(); },
            .exportLibrary = [&delegate] { delegate.saveDocumentTo(); },
            .restore = [&delegate] { delegate.showRestoreWindow(); },
            .syncSettingsChanged = [&manager] { manager.sync().loadSyncPreferences(true); },
            .showDiagnostics = [&delegate] { delegate.diagnostic(); },
            .forgetSnippetUses = [this] { return around_.uses.forget(); }};
}

DecisionsWindow::Services ApplicationServices::decisions() const {
    Expansion& expansion = around_.delegate.expansion();
    return {.ask = [&expansion](auto told) { expansion.recentDecisions(std::move(told)); },
            .forget = [&expansion] { expansion.ask([](AutoText& engine) { engine.forgetDecisions(); }); }};
}

QuickSearchServices ApplicationServices::quickSearch() {
    AppDelegate& delegate = around_.delegate;
    DataManager& manager = around_.library.manager();
    return {.groups = [&manager]() -> const SnippetGroups& { return manager.snippetGroups(); },
            .settings = around_.library.settings(),
            .uses = &around_.uses,
            .send = [&delegate](const std::shared_ptr<Snippet>& snippet) { delegate.sendFoundSnippet(snippet); },
            .edit = [&delegate](const std::shared_ptr<Snippet>& snippet) { delegate.editSnippet(snippet); },
            .setFirstRows = [&delegate](const auto& snippets) { delegate.setFoundSnippets(snippets); },
            .readClipboard = [&delegate](auto told) { delegate.expansion().readClipboard(std::move(told)); }};
}

ScriptRunServices ApplicationServices::scripts() {
    return {.loop = around_.mainLoop,
            .groups = {},
            .readClipboard = {},
            .inBackground = [this](std::function<void()> work,
                                   std::function<void()> done) { trials_.begin(std::move(work), std::move(done)); },
            .makeRunner = [this] { return makeTrialRunner(trialLauncher_, {}); }};
}

EditorServices ApplicationServices::editor() {
    AppDelegate& delegate = around_.delegate;
    Expansion& expansion = delegate.expansion();
    ChipFormServices placeholders;
    placeholders.readClipboard = [&expansion](auto told) { expansion.readClipboard(std::move(told)); };
    placeholders.keyName = [&expansion](KeyCode key) { return expansion.keyName(key); };
    placeholders.beginRecordingKey = [&expansion](auto pressed) { expansion.beginRecordingHotKey(std::move(pressed)); };
    placeholders.endRecordingKey = [&expansion] { expansion.endRecordingHotKey(); };
    return {.dataManager = around_.library.manager(),
            .settings = around_.library.settings(),
            .files = around_.files,
            .resources = dataFolder(),
            .placeholders = std::move(placeholders),
            .scripts = scripts(),
            .programs = programs(),
            .inputSources = {},
            .askForFile = {},
            .inBackground = [this](std::function<void()> work,
                                   std::function<void()> done) { imports_.begin(std::move(work), std::move(done)); },
            .setExpandsInOwnWindows = [&expansion](bool expands) { expansion.setExpandsInOwnWindows(expands); },
            .showPreferences = [&delegate] { delegate.showPreferencesWindow(); },
            .quit = [&delegate] { delegate.terminate(); }};
}

WelcomeServices ApplicationServices::welcome() {
    WelcomeServices services;
    services.trials = trialsIn(around_.library.manager().snippetGroups());
    const std::filesystem::path configuration = configurationFolder().parent_path();
    for (const auto& [name, folder] : {std::pair(u"espanso", "espanso"), std::pair(u"AutoKey", "autokey/data")}) {
        if (around_.files.isFolder(configuration / folder)) {
            services.foundLibraries.push_back({name, configuration / folder});
        }
    }
    services.import = [this](const WelcomeServices::FoundLibrary& found, const auto& told) {
        told(importFound(found.path));
    };
    services.hasIcon = [&delegate = around_.delegate] { return delegate.statusItemIsVisible(); };
    services.startsAtLogin = [this] { return autostart_.isOn(); };
    services.setStartsAtLogin = [this](bool starts) { return autostart_.set(starts); };
    services.setExpandsInOwnWindows = [&expansion = around_.delegate.expansion()](bool expands) {
        expansion.setExpandsInOwnWindows(expands);
    };
    return services;
}

Result<std::string> ApplicationServices::importFound(const std::filesystem::path& path) {
    DataManager& manager = around_.library.manager();
    const std::size_t before = manager.snippetGroups().size();
    const auto remarks = manager.importDataFromFile(path);
    if (!remarks) return remarks.error();
    for (const std::string& remark : remarks.value()) around_.delegate.report(remark);
    manager.notifyDataChanged();
    std::size_t snippets = 0;
    for (std::size_t i = before; i < manager.snippetGroups().size(); ++i) {
        snippets += manager.snippetGroups()[i]->items().size();
    }
    return (snippets == 1 ? tr("1 snippet was imported.")
                          : tr("%n snippets were imported.", "", static_cast<int>(snippets)))
        .toStdString();
}

}  // namespace plume

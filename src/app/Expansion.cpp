#include "app/Expansion.h"

#include <string>
#include <utility>

#include "Foundation/CharacterSet.h"
#include "Foundation/Strings.h"

namespace plume {

namespace {

constexpr double FrontPoll = 0.1;  // seconds
constexpr int FrontPolls = 200;
// Besides the one that the program itself registers.
constexpr SystemHotKeys::Id TriedHotKeyId = 1000;

std::shared_ptr<Snippet> snippetAt(const SnippetGroups& groups, const Expansion::SnippetPlace& place) {
    if (place.group >= groups.size() || place.item >= groups[place.group]->items().size()) return nullptr;
    return groups[place.group]->items()[place.item];
}

}  // namespace

Expansion::Expansion(Dependencies dependencies) : around_(std::move(dependencies)) {}

Expansion::~Expansion() = default;

void Expansion::onTap(std::function<void(Composition&)> call) {
    around_.ports.tapLoop.perform([this, call = std::move(call)] {
        if (tap_.composition) call(*tap_.composition);
    });
}

Composition::Environment Expansion::environment() {
    Composition::Environment environment{.settings = tap_.settings, .report = {}, .log = around_.log};
    environment.report = [this](const std::string& sentence) {
        onMain([this, sentence] { around_.listener.reported(sentence); });
    };
    environment.applications = around_.applications;
    environment.enabledChanged = [this](bool enabled) {
        onMain([this, enabled] { around_.listener.enabledChanged(enabled); });
    };
    environment.snippetUsed = [this](const Snippet& snippet) {
        if (const auto& uuid = snippet.uuid()) onMain([this, used = *uuid] { around_.listener.snippetUsed(used); });
    };
    if (around_.hasWindows) {
        environment.hotKeyForWindow = [this](HotKeyForWindow hotKey) {
            onMain([this, hotKey] { around_.listener.hotKeyPressed(hotKey); });
        };
    }
    addLists(environment);
    if (around_.formView) {
        environment.makeFieldsEditor = [this](std::shared_ptr<SnippetExpandedContent> content,
                                              FieldsEditor::Target& target) {
            return makeForm(std::move(content), target);
        };
    }
    return environment;
}

std::unique_ptr<FieldsEditor> Expansion::makeForm(std::shared_ptr<SnippetExpandedContent> content,
                                                  FieldsEditor::Target& target) {
    const Composition::Ports& ports = around_.ports;
    return std::make_unique<FormBridge>(
        ++tap_.newestForm, std::move(content), target,
        FormBridge::Dependencies{around_.formView, ports.tapLoop, ports.mainLoop, ports.accessibility,
                                 ports.processManager, tap_.composition->inputService()});
}

void Expansion::addLists(Composition::Environment& environment) {
    if (around_.suggestionView) {
        environment.makeSuggestionController = [this] {
            const Composition::Ports& ports = around_.ports;
            return std::make_unique<SuggestionBridge>(SuggestionBridge::Dependencies{
                around_.suggestionView, ports.tapLoop, ports.mainLoop, ports.accessibility, ports.processManager,
                [this] { tap_.composition->engine().clear(); }});
        };
    }
    if (around_.quickSearchView) environment.makeQuickSearchController = [this] { return makeQuickSearch(); };
}

std::unique_ptr<QuickSearchController> Expansion::makeQuickSearch() {
    const Composition::Ports& ports = around_.ports;
    auto bridge = std::make_unique<QuickSearchBridge>(QuickSearchBridge::Dependencies{
        .view = around_.quickSearchView,
        .tapLoop = ports.tapLoop,
        .mainLoop = ports.mainLoop,
        .accessibility = ports.accessibility,
        .processManager = ports.processManager,
        .holdUserKeys = [this](double seconds) { return tap_.composition->inputService().holdUserKeys(seconds); },
        .typedQuery = [this] { return typedQuery(); },
        .report =
            [this](const std::string& sentence) {
                onMain([this, sentence] { around_.listener.reported(sentence); });
            }});
    tap_.quickSearch = bridge.get();
    MacInputService& service = tap_.composition->inputService();
    tap_.searchKeys = service.keyDownEvent.addObserver(bridge.get(), &QuickSearchBridge::keyPressed);
    tap_.searchShortcuts =
        service.unregisteredHotKeyPressedEvent.addObserver(bridge.get(), &QuickSearchBridge::shortcutPressed);
    return bridge;
}

// The word that was begun, unless it is so long that nobody searches for it.
std::u16string Expansion::typedQuery() const {
    constexpr std::size_t Longest = 40;
    if (!tap_.settings.boolForKey("SnippetQuickSearchBeginsWithTyped")) return {};
    const std::u16string& letters = tap_.composition->engine().letters();
    std::size_t start = letters.size();
    while (start > 0 && !CharacterSet::whitespacesAndNewlines().contains(letters[start - 1])) --start;
    return letters.size() - start <= Longest ? letters.substr(start) : std::u16string();
}

void Expansion::begin(std::optional<LibraryUpdate> library, PropertyList::Dictionary settings) {
    const auto shared = library ? std::make_shared<LibraryUpdate>(*std::move(library)) : nullptr;
    around_.ports.tapLoop.perform([this, shared, settings = std::move(settings)] { make(shared.get(), settings); });
}

void Expansion::make(LibraryUpdate* library, const PropertyList::Dictionary& settings) {
    tap_.settings.registerDefaults(settings);
    if (library) tap_.library.apply(*library);
    tap_.composition = std::make_unique<Composition>(around_.ports, environment());
    tap_.composition->setSnippetGroups(tap_.library.groups());
    tap_.composition->loadPreferences();
    onMain([this, service = &tap_.composition->inputService()] { observe(*service); });
    tellKeyNames(tap_.composition->inputService());
}

void Expansion::tellKeyNames(const MacInputService& service) {
    std::map<KeyCode, std::u16string> names;
    constexpr std::uint16_t KeyCodes = 128;
    for (std::uint16_t code = 0; code < KeyCodes; ++code) {
        const auto key = static_cast<KeyCode>(code);
        if (auto name = service.keyCodeTransformer().transformedValue(key)) names.emplace(key, *std::move(name));
    }
    onMain([this, names = std::move(names)] { keyNames_ = names; });
}

std::u16string Expansion::keyName(KeyCode key) const {
    const auto found = keyNames_.find(key);
    return found == keyNames_.end() ? fromUtf8(std::to_string(static_cast<int>(key))) : found->second;
}

void Expansion::observe(MacInputService& service) {
    service_ = &service;
    secureInputObserver_ = service.secureInputChangedEvent.addObserver(this, &Expansion::secureInputChanged);
    givenUpObserver_ = service.keyboardTapGivenUpEvent.addObserver(this, &Expansion::keyboardTapGivenUp);
}

void Expansion::secureInputChanged(MacInputService& service) {
    ask([isOn = service.secureInput()](AutoText& engine) { engine.noteSecureInput(isOn); });
    around_.listener.secureInputChanged();
}

void Expansion::keyboardTapGivenUp(KeyboardTapGivenUp& /*event*/) {
    around_.listener.keyboardTapGivenUp();
}

void Expansion::start() {
    onTap([](Composition& composition) { composition.start(); });
}

void Expansion::end() {
    if (service_) service_->stopCheckingSecureInput();
    service_ = nullptr;
    secureInputObserver_.end();
    givenUpObserver_.end();
    around_.ports.tapLoop.perform([this] {
        tap_.frontWait.cancel();
        tap_.quickSearch = nullptr;
        tap_.searchKeys.end();
        tap_.searchShortcuts.end();
        tap_.composition = nullptr;
    });
}

void Expansion::setLibrary(LibraryUpdate update) {
    onTap([this, update = std::make_shared<LibraryUpdate>(std::move(update))](Composition& composition) mutable {
        tap_.library.apply(*update);
        composition.setSnippetGroups(tap_.library.groups());
        // What went out is freed where nobody waits for a key.
        onMain([freed = std::move(update)] {});
    });
}

void Expansion::loadPreferences(PropertyList::Dictionary settings) {
    onTap([this, settings = std::move(settings)](Composition& composition) {
        tap_.settings.registerDefaults(settings);
        composition.loadPreferences();
        composition.registerHotKeys();
    });
}

void Expansion::setEnabled(bool enabled) {
    onTap([enabled](Composition& composition) { composition.engine().setEnabled(enabled); });
}

void Expansion::enableEvents() {
    onTap([](Composition& composition) { composition.inputService().enableEvents(); });
}

void Expansion::disableEvents() {
    onTap([](Composition& composition) {
        composition.engine().clear();
        composition.stop();
    });
}

void Expansion::tryTapAgain() {
    onTap([](Composition& composition) { composition.inputService().tryTapAgain(); });
}

void Expansion::sendSnippetDirectly(SnippetPlace place) {
    onTap([this, place](Composition& composition) {
        if (const auto snippet = snippetAt(tap_.library.groups(), place)) {
            composition.engine().sendSnippetDirectly(snippet);
        }
    });
}

void Expansion::sendCopyCommand() {
    onTap([](Composition& composition) {
        composition.inputService().refreshContextInputSetting();
        composition.inputService().sendCopyCommand();
    });
}

void Expansion::undo() {
    onTap([](Composition& composition) { composition.engine().undo(true); });
}

void Expansion::expandAtHotkey() {
    onTap([](Composition& composition) { composition.engine().expandAtHotkey(); });
}

void Expansion::suggestAbbreviations() {
    onTap([](Composition& composition) { composition.engine().suggestAbbreviations(); });
}

void Expansion::quickSearch() {
    onTap([](Composition& composition) { composition.engine().quickSearch(); });
}

void Expansion::quickSearchAtTopRightCorner() {
    onTap([](Composition& composition) { composition.engine().quickSearchAtTopRightCorner(); });
}

void Expansion::sendFoundSnippet(std::optional<SnippetPlace> place) {
    onTap([this, place](Composition&) {
        if (tap_.quickSearch) tap_.quickSearch->choose(place ? snippetAt(tap_.library.groups(), *place) : nullptr);
    });
}

void Expansion::setFoundSnippets(std::vector<std::optional<SnippetPlace>> places) {
    onTap([this, places = std::move(places)](Composition&) {
        if (!tap_.quickSearch) return;
        std::vector<std::shared_ptr<Snippet>> rows;
        rows.reserve(places.size());
        for (const auto& place : places) rows.push_back(place ? snippetAt(tap_.library.groups(), *place) : nullptr);
        tap_.quickSearch->setFirstRows(std::move(rows));
    });
}

void Expansion::beginRecordingHotKey(std::function<void(const GeneralHotKey&)> pressed) {
    onTap([this, pressed = std::move(pressed)](Composition& composition) {
        // The layout may have changed since the start.
        tellKeyNames(composition.inputService());
        composition.unregisterHotKeys();
        composition.inputService().setHotKeyRecorder(
            [this, pressed](const GeneralHotKey& hotKey) { onMain([pressed, hotKey] { pressed(hotKey); }); });
    });
}

void Expansion::endRecordingHotKey() {
    onTap([](Composition& composition) {
        composition.inputService().setHotKeyRecorder({});
        composition.registerHotKeys();
    });
}

void Expansion::tryHotKey(const GeneralHotKey& hotKey, std::function<void(const Result<void>&)> told) {
    onTap([this, hotKey, told = std::move(told)](Composition& composition) {
        MacInputService& service = composition.inputService();
        const Result<void> registered = service.registerSystemHotKey(TriedHotKeyId, hotKey, [] {});
        // An empty hot key takes its place away again.
        static_cast<void>(service.registerSystemHotKey(TriedHotKeyId, {}, [] {}));
        onMain([told, registered] { told(registered); });
    });
}

void Expansion::examine(std::function<void(const Findings&)> told) {
    onTap([this, told = std::move(told)](Composition& composition) {
        const ProcessManager& processes = around_.ports.processManager;
        Findings findings;
        findings.evenTapCreated = composition.inputService().evenTapCreated();
        findings.tappingProcesses = composition.inputService().tappingProcesses();
        const auto front = processes.frontProcess();
        if (front) findings.foregroundProgram = processes.runningApplication(*front);
        onMain([told, findings] { told(findings); });
    });
}

void Expansion::readClipboard(std::function<void(const std::optional<std::u16string>&)> told) {
    onTap([this, told = std::move(told)](Composition& composition) {
        onMain([told, text = composition.inputService().userPasteboard().string()] { told(text); });
    });
}

void Expansion::runningPrograms(std::function<void(const std::vector<RunningApplication>&)> told) {
    onTap([this, told = std::move(told)](Composition&) {
        onMain([told, programs = around_.ports.processManager.runningApplications()] { told(programs); });
    });
}

void Expansion::nextFrontProgram(std::function<void(const std::optional<RunningApplication>&)> told) {
    onTap([this, told = std::move(told)](Composition&) { waitForFront(told, FrontPolls); });
}

void Expansion::waitForFront(const WhenFront& told, int attemptsLeft) {
    const ProcessManager& processes = around_.ports.processManager;
    const auto front = processes.frontProcess();
    const bool isOther = front && *front != processes.currentProcess();
    const auto program = isOther ? processes.runningApplication(*front) : std::nullopt;
    if (program || attemptsLeft == 0) return onMain([told, program] { told(program); });
    tap_.frontWait = around_.ports.tapLoop.performAfterDelay(
        FrontPoll, [this, told, attemptsLeft] { waitForFront(told, attemptsLeft - 1); });
}

void Expansion::recentDecisions(std::function<void(std::vector<MatchDecision>)> told) {
    onTap([this, told = std::move(told)](Composition& composition) {
        onMain([told, decisions = composition.engine().recentDecisions()] { told(decisions); });
    });
}

void Expansion::ask(std::function<void(AutoText& engine)> question) {
    onTap([question = std::move(question)](Composition& composition) { question(composition.engine()); });
}

void Expansion::setExpandsInOwnWindows(bool expands) {
    onTap([expands](Composition& composition) { composition.inputService().setExpandsInOwnWindows(expands); });
}

bool Expansion::secureInput() const {
    return service_ && service_->secureInput();
}

std::optional<std::u16string> Expansion::lastAppEnabledSecureInput() const {
    return service_ ? service_->lastAppEnabledSecureInput() : std::nullopt;
}

}  // namespace plume

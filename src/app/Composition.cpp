#include "app/Composition.h"

#include <utility>

#include "Foundation/Strings.h"

namespace plume {

namespace {

// A JSON object of rows.
constexpr const char* OwnApplications = "CustomApplicationSettings";

std::vector<std::u16string> lines(const UserDefaults& settings, std::string_view key) {
    const auto text = settings.stringForKey(key);
    return text ? split(*text, u'\n') : std::vector<std::u16string>();
}

std::vector<std::u16string> list(const UserDefaults& settings, std::string_view key) {
    return settings.stringArrayForKey(key).value_or(std::vector<std::u16string>());
}

void applyTo(AutoCorrection& corrector, const UserDefaults& settings) {
    PLFunctionAvailability& availability = corrector.autoCorrectAvailability();
    availability.availability = settings.integerForKey("AutoCorrectIn");
    availability.applications = settings.stringArrayForKey("AutoCorrectApplications");
    availability.inputMethodsOption = settings.integerForKey("AutoCorrectInputMethodsOption");
    availability.inputMethods = settings.stringArrayForKey("AutoCorrectInputMethods");
    corrector.setCapitalizeNewSentences(settings.boolForKey("CapitalizeNewSentences"));
    corrector.setCorrectDoubleCapitals(settings.boolForKey("CorrectDoubleCapitals"));
    corrector.setCapitalizationExcludedAbbreviations(lines(settings, "CapitalizationExcludedAbbreviations"));
    corrector.setDoubleCapitalsCorrectionExclusion(lines(settings, "DoubleCapitalsCorrectionExclusion"));
}

void applyTo(MacInputService& service, const UserDefaults& settings) {
    DeliveryPreferences& delivery = service.preferences();
    delivery.useClipboard = settings.boolForKey("UseClipboard");
    delivery.useClipboardIn = settings.integerForKey("UseClipboardIn");
    delivery.useClipboardApplications = list(settings, "UseClipboardApplications");
    service.setRestoreClipboardDelay(settings.doubleForKey("RestoreClipboardDelay"));
    // The service keeps a byte of it: larger numbers wrap around.
    delivery.longTextLength = static_cast<std::int8_t>(settings.integerForKey("LongTextLength"));
    delivery.useClipboardForLongText = settings.boolForKey("UseClipboardForLongText");
    delivery.restoreClipboard = settings.boolForKey("RestoreClipboard");
    service.setListenMouseDownEvents(settings.boolForKey("ListenMouseDownEvents"));
    service.setListenAtAnnotatedSession(settings.boolForKey("ListenAtAnnotatedSession"));
}

}  // namespace

Composition::Composition(const Ports& ports, Environment environment)
    : ports_(ports),
      environment_(std::move(environment)),
      identifiers_(ports_.processManager),
      scriptRunner_(ports_.processLauncher, environment_.report) {
    makeParts();
}

void Composition::makeParts() {
    inputService_ = std::make_unique<MacInputService>(MacInputService::Dependencies{
        ports_.keyboardTap, ports_.mouseTap, ports_.poster, ports_.pasteboard, ports_.processManager,
        ports_.inputSources, ports_.accessibility, ports_.secureInput, ports_.systemHotKeys, identifiers_,
        ports_.tapLoop, ports_.mainLoop, environment_.log, environment_.vmHelper});
    if (environment_.applications) inputService_->setApplicationTable(environment_.applications);

    ContentEnvironment content;
    content.timeZone = environment_.timeZone;
    content.locale = environment_.locale;
    content.pasteboard = &inputService_->userPasteboard();
    content.report = environment_.report;
    parser_ = std::make_unique<SnippetParser>(std::move(content));

    engine_ = std::make_unique<AutoText>(AutoText::Dependencies{
        .inputService = *inputService_,
        .bundleIdentifierResolver = identifiers_,
        .inputSources = ports_.inputSources,
        .accessibility = ports_.accessibility,
        .userDefaults = environment_.settings,
        .snippetParser = *parser_,
        .scriptRunner = scriptRunner_,
        .sounds = ports_.sounds,
        .report = environment_.report,
        .makeFieldsEditor = environment_.makeFieldsEditor,
        .makeSuggestionController = environment_.makeSuggestionController,
        .makeQuickSearchController = environment_.makeQuickSearchController,
        .snippetUsed = environment_.snippetUsed,
    });

    hotKeys_ = std::make_unique<HotKeyDispatch>(*inputService_, hotKeyActions());
}

// What would show a window that is not there is left out: the keys are for the programs then.
HotKeyDispatch::Actions Composition::hotKeyActions() {
    HotKeyDispatch::Actions actions{.switchEnabled =
                                        [this] {
                                            engine_->setEnabled(!engine_->enabled());
                                            if (environment_.enabledChanged)
                                                environment_.enabledChanged(engine_->enabled());
                                            ports_.sounds.playOrBeep("Pop");
                                        },
                                    .clear = [this] { engine_->clear(); },
                                    .undo = [this](bool withTrigger) { return engine_->undo(withTrigger); },
                                    .expand = [this] { engine_->expandAtHotkey(); }};
    if (environment_.makeSuggestionController) {
        actions.suggestAbbreviations = [this] { engine_->suggestAbbreviations(); };
    }
    if (environment_.makeQuickSearchController) actions.quickSearch = [this] { engine_->quickSearch(); };
    if (const auto& toWindow = environment_.hotKeyForWindow) {
        actions.makeSnippetFromClipboard = [&toWindow] { toWindow(HotKeyForWindow::MakeSnippetFromClipboard); };
        actions.makeSnippetFromSelection = [&toWindow] { toWindow(HotKeyForWindow::MakeSnippetFromSelection); };
        actions.openMainWindow = [&toWindow] { toWindow(HotKeyForWindow::OpenMainWindow); };
        actions.openLastUsedSnippet = [&toWindow] { toWindow(HotKeyForWindow::OpenLastUsedSnippet); };
    }
    return actions;
}

Composition::~Composition() {
    scriptRunner_.stop();
    stop();
}

void Composition::loadPreferences() {
    const UserDefaults& settings = environment_.settings;
    // Only a switch takes away what was typed so far: settings come back here when the user is typing on.
    const bool isEnabled = settings.boolForKey("IsEnabled");
    if (isEnabled != engine_->enabled()) engine_->setEnabled(isEnabled);
    applyTo(engine_->correction(), settings);
    engine_->sender().setPlayFeedbackSound(settings.boolForKey("PlayFeedbackSound"));
    engine_->sender().setFeedbackSound(toUtf8(settings.stringForKey("FeedbackSound").value_or(u"")));
    engine_->setSuggestsByItself(settings.boolForKey("SuggestAutomatically"));
    engine_->setSnippetSelectorKeyModifier(settings.integerForKey("SnippetSelectorKeyModifier"));
    engine_->setSnippetAdaptToAbbreviationCaseOption(settings.integerForKey("SnippetAdaptToAbbreviationCaseOption"));
    applyTo(*inputService_, settings);
    const std::string rows = toUtf8(settings.stringForKey(OwnApplications).value_or(u""));
    if (const auto read = inputService_->setOwnApplicationRows(rows, OwnApplications); !read) {
        environment_.report(read.error().message);
    }
}

void Composition::registerHotKeys() {
    if (const Result<void> registered = hotKeys_->registerHotKeys(environment_.settings); !registered) {
        environment_.report(registered.error().message);
    }
}

void Composition::start() {
    registerHotKeys();
    for (const std::string_view name : hotKeys_->hotKeysWithoutAction(environment_.settings)) {
        environment_.log("What the hot key " + std::string(name) + " is for is not there yet: its keys pass.");
    }
    checkConflicts();
    inputService_->enableEvents();
}

// Two programs that answer the same abbreviation, or take the keyboard, are in each other's way.
void Composition::checkConflicts() {
    const auto orNothing = [](const std::optional<std::u16string>& text) { return toUtf8(text.value_or(u"")); };
    for (const RunningApplication& other : inputService_->tappingProcesses()) {
        environment_.log("processIdentifier " + std::to_string(other.processIdentifier) + ", localizedName " +
                         orNothing(other.localizedName) + ", bundleIdentifier " + orNothing(other.bundleIdentifier) +
                         ", executableURL " + orNothing(other.executableURL));
    }
}

void Composition::stop() {
    inputService_->disableEvents();
}

}  // namespace plume

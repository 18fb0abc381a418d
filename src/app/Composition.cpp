#include "app/Composition.h"

#include <utility>

#include "Foundation/Strings.h"
#include "app/Windowless.h"

namespace plume {

namespace {

const NoSuggestions NothingToSuggest;

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

template <typename Factory>
Factory orElse(const Factory& given, Factory fallback) {
    return given ? given : fallback;
}

}  // namespace

Composition::Composition(const Ports& ports, Dependencies dependencies)
    : ports_(ports),
      dependencies_(std::move(dependencies)),
      identifiers_(ports_.processManager),
      scriptRunner_(ports_.processLauncher, dependencies_.report) {
    makeParts();
}

void Composition::makeParts() {
    inputService_ = std::make_unique<MacInputService>(MacInputService::Dependencies{
        ports_.keyboardTap, ports_.mouseTap, ports_.poster, ports_.pasteboard, ports_.processManager,
        ports_.inputSources, ports_.accessibility, ports_.secureInput, ports_.systemHotKeys, identifiers_,
        ports_.tapLoop, ports_.mainLoop, dependencies_.log, dependencies_.vmHelper});

    ContentEnvironment environment;
    environment.timeZone = dependencies_.timeZone;
    environment.locale = dependencies_.locale;
    environment.pasteboard = &inputService_->userPasteboard();
    environment.report = dependencies_.report;
    parser_ = std::make_unique<SnippetParser>(std::move(environment));

    sender_ = std::make_unique<SendingPipeline>(SendingPipeline::Dependencies{
        *inputService_, *parser_, scriptRunner_, &ports_.sounds,
        orElse(dependencies_.makeFieldsEditor, windowlessFieldsEditors(dependencies_.report)), dependencies_.report});
    corrector_ = std::make_unique<AutoCorrection>(AutoCorrection::Dependencies{
        *inputService_, identifiers_, ports_.inputSources, ports_.accessibility, *sender_});

    const SuggestionSource* source = dependencies_.suggestionSource;
    using ListFactory = std::function<std::unique_ptr<SuggestionController>()>;
    using SearchFactory = std::function<std::unique_ptr<QuickSearchController>()>;
    engine_ = std::make_unique<AutoText>(AutoText::Dependencies{
        *inputService_, identifiers_, ports_.inputSources, dependencies_.settings, *sender_,
        source ? *source : NothingToSuggest, corrector_.get(),
        orElse<ListFactory>(dependencies_.makeSuggestionController, &makeWindowlessSuggestionController),
        orElse<SearchFactory>(dependencies_.makeQuickSearchController, &makeWindowlessQuickSearchController)});

    hotKeys_ = std::make_unique<HotKeyDispatch>(
        *inputService_, HotKeyDispatch::Actions{[this] {
                                                    engine_->setEnabled(!engine_->enabled());
                                                    if (dependencies_.enabledChanged)
                                                        dependencies_.enabledChanged(engine_->enabled());
                                                    ports_.sounds.play("Pop");
                                                },
                                                [this] { engine_->suggestAbbreviations(); },
                                                [this] { engine_->quickSearch(); }, [this] { engine_->clear(); },
                                                [this](bool withTrigger) { return engine_->undo(withTrigger); },
                                                [this] { engine_->expandAtHotkey(); }});
}

Composition::~Composition() {
    scriptRunner_.stop();
    stop();
}

void Composition::loadPreferences() {
    const UserDefaults& settings = dependencies_.settings;
    engine_->setEnabled(settings.boolForKey("IsEnabled"));
    applyTo(*corrector_, settings);
    sender_->setPlayFeedbackSound(settings.boolForKey("PlayFeedbackSound"));
    sender_->setFeedbackSound(toUtf8(settings.stringForKey("FeedbackSound").value_or(u"")));
    engine_->setSnippetSelectorKeyModifier(settings.integerForKey("SnippetSelectorKeyModifier"));
    applyTo(*inputService_, settings);
}

void Composition::start() {
    if (const Result<void> registered = hotKeys_->registerHotKeys(dependencies_.settings); !registered) {
        dependencies_.report(registered.error().message);
    }
    inputService_->enableEvents();
}

void Composition::stop() {
    inputService_->disableEvents();
}

}  // namespace plume

// The engine's construction and lifetime, what resets the buffer, and where keys go.
#include "engine/AutoText.h"

#include <algorithm>
#include <iterator>
#include <utility>

namespace plume {

namespace {

// More than is typed between two resets as a rule, so that the buffer seldom grows inside the key callback.
constexpr std::size_t UsualBufferLength = 4096;

bool contains(const Rectangle& frame, double x, double y) {
    return x >= frame.origin.x && x < frame.origin.x + frame.size.width && y >= frame.origin.y &&
           y < frame.origin.y + frame.size.height;
}

}  // namespace

AutoText::AutoText(Dependencies dependencies)
    : dependencies_(std::move(dependencies)),
      matcher_(defaultDelimiters()),
      snippetAdaptToAbbreviationCaseOption_(
          dependencies_.userDefaults.integerForKey("SnippetAdaptToAbbreviationCaseOption")),
      correction_(dependencies_.inputService, dependencies_.accessibility),
      sender_({dependencies_.inputService, dependencies_.snippetParser, dependencies_.scriptRunner,
               dependencies_.sounds, dependencies_.accessibility, letters_, dependencies_.makeFieldsEditor,
               dependencies_.report, dependencies_.snippetUsed},
              [this](const SnippetSender::Sent& sent) { follow(sent); }) {
    letters_.reserve(UsualBufferLength);
    refusals_.reserve(DecisionLog::Capacity);
    MacInputService& service = dependencies_.inputService;
    subscriptions_ = {
        service.keyDownEvent.addObserver(this, &AutoText::onSystemInputServiceKeyDown),
        service.inputContextChangedEvent.addObserver(this, &AutoText::onSystemInputServiceInputContextChanged),
        service.mouseDownEvent.addObserver(this, &AutoText::onSystemInputServiceMouseDown),
        service.unregisteredHotKeyPressedEvent.addObserver(this,
                                                           &AutoText::onSystemInputServiceUnregisteredHotKeyPressed)};
}

const CharacterSet& AutoText::defaultDelimiters() {
    static const CharacterSet set =
        CharacterSet::withCharacters(u" \t\r\u0003.!?,;:-\"'(){}[]/\\&+*=<>\u00AB\u00BB%^#_@$`|~");
    return set;
}

void AutoText::setEnabled(bool enabled) {
    enabled_ = enabled;
    noteSwitch();
    clear();
}

void AutoText::setSnippetGroups(Groups groups) {
    snippetGroups_ = std::move(groups);
    matcher_.setSnippetGroups(snippetGroups_);
    if (snippetQuickSearchController_) snippetQuickSearchController_->setSnippetGroups(snippetGroups_);
}

void AutoText::setSnippetSelectorKeyModifier(std::int64_t modifier) {
    snippetSelectorKeyModifier_ = modifier;
    if (snippetSuggestionController_) snippetSuggestionController_->setSnippetSelectorKeyModifier(modifier);
    if (snippetQuickSearchController_) snippetQuickSearchController_->setSnippetSelectorKeyModifier(modifier);
}

void AutoText::clear() {
    letters_.reset();
    pauseWatch_.cancel();
    if (snippetSuggestionWindowVisible()) hideSnippetSuggestion();
    if (snippetQuickSearchWindowVisible()) snippetQuickSearchController_->close();
}

void AutoText::onSystemInputServiceInputContextChanged(InputContextChange& /*change*/) {
    // The search window takes the keyboard itself: that is no reason to close it.
    const bool isSearched = snippetQuickSearchWindowVisible() && dependencies_.inputService.isSameProcess();
    isSearched ? letters_.reset() : clear();
}

void AutoText::onSystemInputServiceMouseDown(ZDMouseEventArgs& event) {
    const bool insideList = snippetSuggestionWindowVisible()
                                ? contains(snippetSuggestionController_->windowFrame(), event.x, event.y)
                                : snippetQuickSearchWindowVisible() &&
                                      contains(snippetQuickSearchController_->windowFrame(), event.x, event.y);
    if (!insideList) clear();
}

void AutoText::expandAtHotkey() {
    if (dependencies_.inputService.isSameProcess() || snippetQuickSearchWindowVisible()) return;
    std::vector<Match> matches = findSnippetsInLetters(letters(), 0, letters());
    if (matches.size() == 1) {
        hideSnippetSuggestion();
        sendMatch(matches[0], SnippetTrigger::HotKey);
    } else if (!matches.empty()) {
        offerMatches(std::move(matches));
    }
}

std::vector<AutoText::Match> AutoText::findSnippetsInLetters(std::u16string_view letters, char16_t trigger,
                                                             std::u16string_view lettersWithoutSeparator) {
    std::vector<Match> matches =
        matcher_.findSnippetsInLetters(letters, trigger, lettersWithoutSeparator, lastKeyDestination(), refusals_);
    if (!refusals_.empty()) noteRefusals();
    return matches;
}

AutoText::Groups AutoText::filteredGroupsByApplication() const {
    const std::optional<std::u16string>& application = lastKeyDestination().bundleIdentifier();
    Groups admitted;
    std::copy_if(snippetGroups_.begin(), snippetGroups_.end(), std::back_inserter(admitted),
                 [&](const auto& group) { return group->availability().admitsApplication(application); });
    return admitted;
}

KeyDestination AutoText::lastKeyDestination() const {
    return {dependencies_.bundleIdentifierResolver, dependencies_.inputSources,
            dependencies_.inputService.lastProcessReceivedKeyEvent()};
}

bool AutoText::sendSnippet(const std::shared_ptr<Snippet>& snippet, const std::optional<std::u16string>& abbreviation,
                           SnippetTriggers snippetTrigger) {
    const auto sent = send(snippet, abbreviation, snippetTrigger);
    return sent && sent->swallowsKey;
}

bool AutoText::sendMatch(const Match& match, SnippetTriggers snippetTrigger) {
    const auto sent = send(match.first, match.second, snippetTrigger);
    noteMatch(sent ? MatchDecision::Outcome::Expanded : MatchDecision::Outcome::Failed, match.first);
    return sent && sent->swallowsKey;
}

std::optional<SnippetSender::Sent> AutoText::send(const std::shared_ptr<Snippet>& snippet,
                                                  const std::optional<std::u16string>& abbreviation,
                                                  SnippetTriggers snippetTrigger) {
    clear();
    auto sent =
        sender_.send({snippet, abbreviation, snippetTrigger, snippetGroups_, snippetAdaptToAbbreviationCaseOption_,
                      dependencies_.inputService.lastKeyString(), dependencies_.inputService.lastKeyIsDelivered()});
    if (sent) follow(*sent);
    return sent;
}

void AutoText::sendSnippetDirectly(const std::shared_ptr<Snippet>& snippet) {
    sendSnippet(snippet, std::nullopt, SnippetTrigger::Direct);
}

bool AutoText::undo(bool withTrigger) {
    if (!undoInfo_) return false;
    follow(sender_.undo(*undoInfo_, withTrigger));
    return true;
}

void AutoText::follow(const SnippetSender::Sent& sent) {
    if (sent.letters) letters_.reset(*sent.letters);
    undoInfo_ = sent.undo;
}

}  // namespace plume

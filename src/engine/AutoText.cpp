// The engine's construction and lifetime, what resets the buffer, and where keys go.
#include "engine/AutoText.h"

#include <algorithm>
#include <iterator>
#include <utility>

#include "content/PLOutput.h"

namespace plume {

namespace {

// More than is typed between two resets as a rule, so that the buffer seldom grows inside the key callback.
constexpr std::size_t UsualBufferLength = 4096;

bool contains(const Rectangle& frame, double x, double y) {
    return x >= frame.origin.x && x < frame.origin.x + frame.size.width && y >= frame.origin.y &&
           y < frame.origin.y + frame.size.height;
}

}  // namespace

// Where the last key went.
class AutoText::LastKeyContext final : public MatchContext {
  public:
    explicit LastKeyContext(const Surroundings& surroundings) : surroundings_(surroundings) {}

    const std::optional<std::u16string>& bundleIdentifier() const override {
        return surroundings_.bundleIdentifierResolver.getBundleIdentifier(
            surroundings_.inputService.lastProcessReceivedKeyEvent());
    }
    const std::optional<std::u16string>& inputSourceIdentifier() const override {
        return surroundings_.inputSources.currentInputSourceIdentifier();
    }

  private:
    const Surroundings& surroundings_;
};

AutoText::AutoText(Surroundings surroundings)
    : surroundings_(std::move(surroundings)),
      matcher_(defaultDelimiters()),
      snippetAdaptToAbbreviationCaseOption_(
          surroundings_.userDefaults.integerForKey("SnippetAdaptToAbbreviationCaseOption")) {
    letters_.reserve(UsualBufferLength);
    InputService& service = surroundings_.inputService;
    service.keyDownEvent.addObserver(this, &AutoText::onSystemInputServiceKeyDown);
    service.inputContextChangedEvent.addObserver(this, &AutoText::onSystemInputServiceInputContextChanged);
    service.mouseDownEvent.addObserver(this, &AutoText::onSystemInputServiceMouseDown);
    service.unregisteredHotKeyPressedEvent.addObserver(this, &AutoText::onSystemInputServiceUnregisteredHotKeyPressed);
}

AutoText::~AutoText() {
    InputService& service = surroundings_.inputService;
    service.keyDownEvent.removeObservers(this);
    service.inputContextChangedEvent.removeObservers(this);
    service.mouseDownEvent.removeObservers(this);
    service.unregisteredHotKeyPressedEvent.removeObservers(this);
    service.runLoop().cancel(scheduledList_);
    service.runLoop().cancel(scheduledSuggestion_);
}

const CharacterSet& AutoText::defaultDelimiters() {
    static const CharacterSet set =
        CharacterSet::withCharacters(u" \t\r\u0003.!?,;:-\"'(){}[]/\\&+*=<>\u00AB\u00BB%^#_@$`|~");
    return set;
}

void AutoText::setEnabled(bool enabled) {
    enabled_ = enabled;
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
    letters_.clear();
    if (snippetSuggestionWindowVisible()) hideSnippetSuggestion();
    if (snippetQuickSearchWindowVisible()) snippetQuickSearchController_->close();
}

void AutoText::onSystemInputServiceInputContextChanged(InputContextChange& /*change*/) {
    clear();
}

void AutoText::onSystemInputServiceMouseDown(ZDMouseEventArgs& event) {
    const bool insideList = snippetSuggestionWindowVisible()
                                ? contains(snippetSuggestionController_->windowFrame(), event.x, event.y)
                                : snippetQuickSearchWindowVisible() &&
                                      contains(snippetQuickSearchController_->windowFrame(), event.x, event.y);
    if (!insideList) clear();
}

void AutoText::expandAtHotkey() {
    if (surroundings_.inputService.isSameProcess() || snippetQuickSearchWindowVisible()) return;
    std::vector<Match> matches = findSnippetsInLetters(letters_, 0, letters_);
    if (matches.size() == 1) {
        hideSnippetSuggestion();
        surroundings_.sender.sendSnippet(*this, matches[0].first, matches[0].second, SnippetTrigger::HotKey);
    } else if (!matches.empty()) {
        offerMatches(std::move(matches));
    }
}

std::vector<AutoText::Match> AutoText::findSnippetsInLetters(std::u16string_view letters, char16_t trigger,
                                                             std::u16string_view lettersWithoutSeparator) const {
    return matcher_.findSnippetsInLetters(letters, trigger, lettersWithoutSeparator, LastKeyContext(surroundings_));
}

AutoText::Groups AutoText::filteredGroupsByApplication() const {
    const std::optional<std::u16string>& application = LastKeyContext(surroundings_).bundleIdentifier();
    Groups admitted;
    std::copy_if(snippetGroups_.begin(), snippetGroups_.end(), std::back_inserter(admitted),
                 [&](const auto& group) { return group->availability().admitsApplication(application); });
    return admitted;
}

void AutoText::sendSnippetDirectly(const std::shared_ptr<Snippet>& snippet) {
    surroundings_.sender.sendSnippet(*this, snippet, std::nullopt, SnippetTrigger::Direct);
}

}  // namespace plume

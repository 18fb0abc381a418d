#include "tests/engine/EngineDesk.h"

#include <utility>

#include "Foundation/Strings.h"

namespace plume {

namespace {

class RecordedList final : public SuggestionController {
  public:
    explicit RecordedList(ListWindow& window) : window_(window) { ++window_.made; }

    void setSnippets(const SuggestionList& list) override {
        list_ = &list;
        reloadData();
    }
    void setSuggestionSelectedAction(std::function<void()> action) override { window_.click = std::move(action); }
    void setSnippetSelectorKeyModifier(std::int64_t modifier) override { window_.modifier = modifier; }
    void reloadData() override {
        window_.entries.clear();
        for (const auto& snippet : list_->suggestions) window_.entries.push_back(*snippet->abbreviation());
        window_.selected = 0;
    }
    void refreshHeight() override { ++window_.heights; }
    void showWindowAtCaret() override {
        window_.visible = true;
        ++window_.shownAtCaret;
    }
    void close() override { window_.visible = false; }
    void nextSuggestion() override {
        if (window_.selected + 1 < window_.entries.size()) ++window_.selected;
    }
    void previousSuggestion() override {
        if (window_.selected > 0) --window_.selected;
    }
    std::size_t selectedSuggestionIndex() const override {
        return window_.entries.empty() ? NotFound : window_.selected;
    }
    bool windowVisible() const override { return window_.visible; }
    Rectangle windowFrame() const override { return window_.frame; }

  private:
    ListWindow& window_;
    const SuggestionList* list_ = nullptr;
};

class RecordedSearch final : public QuickSearchController {
  public:
    explicit RecordedSearch(SearchWindow& window) : window_(window) { ++window_.made; }

    void setSnippetGroups(const AutoText::Groups& groups) override { window_.groupCount = groups.size(); }
    void setSnippetSelectedAction(std::function<void()> action) override { window_.choose = std::move(action); }
    void setSnippetSelectorKeyModifier(std::int64_t modifier) override { window_.modifier = modifier; }
    void showWindowAtCaret() override { show(false); }
    void showWindowAtTopRightCorner() override { show(true); }
    void close() override { window_.visible = false; }
    std::shared_ptr<Snippet> selectedSnippet() const override { return window_.selected; }
    const std::optional<std::u16string>& typedText() const override { return window_.typedText; }
    std::shared_ptr<Snippet> snippetAtIndex(std::size_t index) const override {
        return index < window_.results.size() ? window_.results[index] : nullptr;
    }
    bool windowVisible() const override { return window_.visible; }
    Rectangle windowFrame() const override { return window_.frame; }

  private:
    void show(bool atTopRightCorner) {
        window_.visible = true;
        window_.atTopRightCorner = atTopRightCorner;
    }
    SearchWindow& window_;
};

}  // namespace

TestForm::TestForm(std::shared_ptr<SnippetExpandedContent> content, Target& target, std::vector<TestForm*>& open)
    : content_(std::move(content)), target_(target), open_(open) {
    open_.push_back(this);
}

TestForm::~TestForm() {
    std::erase(open_, this);
}

std::optional<std::u16string> AnsweringRunner::run(std::u16string_view script, bool isAppleScript) {
    return answer((isAppleScript ? u"Apple's " : u"") + std::u16string(script));
}

EngineDesk::EngineDesk()
    : service({desktop.keyboardTap(), desktop.mouseTap(), desktop.poster(), desktop.pasteboard(),
               desktop.processManager(), desktop.inputSources(), desktop.accessibility(), desktop.secureInput(),
               desktop.systemHotKeys(), identifiers, loop, loop, [](const std::string&) {}}),
      owner(std::make_unique<AutoText>(dependencies())),
      engine(*owner) {
    desktop.activate(u"org.example.editor");
    service.setListenMouseDownEvents(true);
    service.enableEvents();
    loop.runReady();
    engine.setEnabled(true);
}

AutoText::Dependencies EngineDesk::dependencies() {
    return {.inputService = service,
            .bundleIdentifierResolver = identifiers,
            .inputSources = desktop.inputSources(),
            .accessibility = desktop.accessibility(),
            .userDefaults = defaults,
            .snippetParser = parser,
            .scriptRunner = runner,
            .sounds = desktop.sounds(),
            .report = [](const std::string& /*sentence*/) {},
            .makeFieldsEditor =
                [this](std::shared_ptr<SnippetExpandedContent> content, FieldsEditor::Target& target) {
                    return std::make_unique<TestForm>(std::move(content), target, forms);
                },
            .makeSuggestionController = [this] { return std::make_unique<RecordedList>(list); },
            .makeQuickSearchController = [this] { return std::make_unique<RecordedSearch>(search); }};
}

std::shared_ptr<SnippetGroup> EngineDesk::add(const std::vector<std::u16string>& abbreviations, ExpandTrigger trigger) {
    const auto group = SnippetGroup::make();
    group->setExpandTrigger(trigger);
    for (const std::u16string& abbreviation : abbreviations) {
        group->addItem(std::make_shared<Snippet>(abbreviation, u"content"));
    }
    AutoText::Groups groups = engine.snippetGroups();
    groups.push_back(group);
    engine.setSnippetGroups(groups);
    return group;
}

std::shared_ptr<Snippet> EngineDesk::add(std::u16string abbreviation, std::u16string content, ExpandTrigger trigger,
                                         ContentType type) {
    const std::shared_ptr<Snippet> snippet = add({std::move(abbreviation)}, trigger)->items()[0];
    snippet->setPlainTextContent(std::move(content));
    snippet->setContentType(type);
    return snippet;
}

void EngineDesk::type(std::u16string_view text) {
    for (const char16_t& character : text) {
        desktop.typeCharacter({&character, 1});
        loop.runReady();
    }
}

void EngineDesk::press(char16_t character, KeyModifiers modifiers) {
    desktop.pressAndRelease(SimulatedInputSources::strokeFor(character)->keyCode, modifiers);
}

void EngineDesk::clickAt(double x, double y) {
    desktop.poster().setPointerLocation({x, y});
    desktop.click();
}

void EngineDesk::suggest(std::u16string_view beginning) {
    type(beginning);
    engine.suggestAbbreviations();
}

void EngineDesk::settle() {
    loop.advance(1);
    while (engine.sender().hasPendingScripts()) {
        engine.sender().waitForScripts();
        loop.advance(1);
    }
}

}  // namespace plume

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
        read();
    }
    void setSuggestionSelectedAction(std::function<void()> action) override { window_.click = std::move(action); }
    void setSnippetSelectorKeyModifier(std::int64_t modifier) override { window_.modifier = modifier; }
    void reloadData() override { read(); }
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
    void read() {
        window_.entries.clear();
        for (const auto& snippet : list_->suggestions) window_.entries.push_back(*snippet->abbreviation());
        window_.selected = 0;
    }

    ListWindow& window_;
    const SuggestionList* list_ = nullptr;
};

class RecordedSearch final : public QuickSearchController {
  public:
    explicit RecordedSearch(SearchWindow& window) : window_(window) { ++window_.made; }

    void setSnippetGroups(const EngineState::Groups& groups) override { window_.groupCount = groups.size(); }
    void setSnippetSelectedAction(std::function<void()> action) override { window_.choose = std::move(action); }
    void setSnippetSelectorKeyModifier(std::int64_t modifier) override { window_.modifier = modifier; }
    void showWindowAtCaret() override { show(false); }
    void showWindowAtTopRightCorner() override { show(true); }
    void close() override { window_.visible = false; }
    std::shared_ptr<Snippet> selectedSnippet() const override { return window_.selected; }
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

std::unique_ptr<SuggestionController> makeRecordedList(ListWindow& window) {
    return std::make_unique<RecordedList>(window);
}

std::unique_ptr<QuickSearchController> makeRecordedSearch(SearchWindow& window) {
    return std::make_unique<RecordedSearch>(window);
}

bool RecordingSender::sendSnippet(EngineState& engine, const std::shared_ptr<Snippet>& snippet,
                                  const std::optional<std::u16string>& abbreviation, SnippetTriggers snippetTrigger) {
    sent.push_back({*snippet->abbreviation(), abbreviation, snippetTrigger, engine.letters(), *listVisible});
    engine.clear();
    engine.setLetters(lettersAfter);
    return swallows;
}

void RecordingCorrector::autoCorrect(EngineState& engine, ZDKeyEventArgs& event, std::u16string_view context) {
    asked.push_back({std::u16string(context), event.s.value_or(u""), engine.letters()});
    event.cancel = swallows;
}

void PrefixSuggestions::appendSuggestions(std::u16string_view letters, const EngineState::Groups& groups,
                                          SuggestionList& list) const {
    for (const auto& group : groups) {
        for (const auto& snippet : group->items()) {
            if (snippet->abbreviation()->starts_with(letters)) list.append(snippet, std::u16string(letters));
        }
    }
}

EngineDesk::EngineDesk()
    : editor(processes.launch(u"org.example.editor")),
      engine({service, resolver, sources, defaults, sender, suggestionSource, &corrector,
              [this] { return makeRecordedList(list); }, [this] { return makeRecordedSearch(search); }}) {
    sender.listVisible = &list.visible;
    processes.setFrontProcess(editor);
    engine.setEnabled(true);
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

void EngineDesk::openListOf(int count, const std::u16string& abbreviation) {
    add(std::vector<std::u16string>(static_cast<std::size_t>(count), abbreviation));
    service.typeText(abbreviation);
    loop.runReady();
}

bool EngineDesk::press(char16_t character, KeyModifiers modifiers) {
    return service.pressKey(SimulatedInputSources::strokeFor(character)->keyCode, modifiers);
}

}  // namespace plume

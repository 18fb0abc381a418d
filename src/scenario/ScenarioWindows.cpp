#include "scenario/ScenarioWindows.h"

#include <utility>

#include "Foundation/Strings.h"
#include "library/Snippet.h"

namespace plume {

namespace {

// Places where the pointer is not.
constexpr Rectangle ListFrame{{100, 100}, {200, 50}};
constexpr Rectangle SearchFrame{{400, 100}, {200, 50}};

class ListWindow final : public SuggestionController {
  public:
    explicit ListWindow(ScenarioList& window) : window_(window) {}

    void setSnippets(const SuggestionList& list) override {
        list_ = &list;
        reloadData();
    }
    void setSuggestionSelectedAction(std::function<void()> action) override { window_.clicked = std::move(action); }
    void setSnippetSelectorKeyModifier(std::int64_t /*modifier*/) override {}
    void reloadData() override {
        window_.entries.clear();
        for (const auto& snippet : list_->suggestions) {
            window_.entries.push_back(snippet->abbreviationWithPrefix().value_or(u""));
        }
        window_.selected = 0;
    }
    void refreshHeight() override {}
    void showWindowAtCaret() override { window_.visible = true; }
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
    Rectangle windowFrame() const override { return ListFrame; }

  private:
    ScenarioList& window_;
    const SuggestionList* list_ = nullptr;
};

// Opens and closes; nothing can be searched in a scenario.
class SearchWindow final : public QuickSearchController {
  public:
    void setSnippetGroups(const std::vector<std::shared_ptr<SnippetGroup>>& /*groups*/) override {}
    void setSnippetSelectedAction(std::function<void()> /*action*/) override {}
    void setSnippetSelectorKeyModifier(std::int64_t /*modifier*/) override {}
    void showWindowAtCaret() override { visible_ = true; }
    void showWindowAtTopRightCorner() override { visible_ = true; }
    void close() override { visible_ = false; }
    std::shared_ptr<Snippet> selectedSnippet() const override { return nullptr; }
    const std::optional<std::u16string>& typedText() const override { return nothingTyped_; }
    std::shared_ptr<Snippet> snippetAtIndex(std::size_t /*index*/) const override { return nullptr; }
    bool windowVisible() const override { return visible_; }
    Rectangle windowFrame() const override { return SearchFrame; }

  private:
    bool visible_ = false;
    const std::optional<std::u16string> nothingTyped_;
};

class Form final : public FieldsEditor {
  public:
    Form(std::shared_ptr<SnippetExpandedContent> content, Target& target, ScenarioForms& forms,
         const std::string& locale)
        : content_(std::move(content)), target_(target), forms_(forms), model_(*content_, locale) {}
    ~Form() override { disappear(); }
    Form(const Form&) = delete;
    Form& operator=(const Form&) = delete;

    void show() override {
        forms_.open.push_back({this, &model_, [this](bool accept) { close(accept); }});
    }
    const std::shared_ptr<SnippetExpandedContent>& content() const override { return content_; }

  private:
    void disappear() {
        std::erase_if(forms_.open, [this](const ScenarioForms::Open& form) { return form.editor == this; });
    }
    void close(bool accept) {
        disappear();
        target_.fieldsEditorWillClose(*this);
        if (!accept) return;
        model_.accept();
        target_.fieldsEditorAction(*this);
    }

    std::shared_ptr<SnippetExpandedContent> content_;
    Target& target_;
    ScenarioForms& forms_;
    FormModel model_;
};

}  // namespace

std::unique_ptr<SuggestionController> makeScenarioList(ScenarioList& list) {
    return std::make_unique<ListWindow>(list);
}

std::unique_ptr<QuickSearchController> makeScenarioSearch() {
    return std::make_unique<SearchWindow>();
}

FieldsEditor::Factory scenarioFieldsEditors(ScenarioForms& forms, std::string locale) {
    return [&forms, locale = std::move(locale)](std::shared_ptr<SnippetExpandedContent> content,
                                                FieldsEditor::Target& target) -> std::unique_ptr<FieldsEditor> {
        return std::make_unique<Form>(std::move(content), target, forms, locale);
    };
}

}  // namespace plume

#include "app/Windowless.h"

#include <utility>

#include "Foundation/Strings.h"
#include "library/Snippet.h"

namespace plume {

namespace {

class WindowlessList final : public SuggestionController {
  public:
    void setSnippets(const SuggestionList& /*list*/) override {}
    void setSuggestionSelectedAction(std::function<void()> /*action*/) override {}
    void setSnippetSelectorKeyModifier(std::int64_t /*modifier*/) override {}
    void reloadData() override {}
    void refreshHeight() override {}
    void showWindowAtCaret() override {}
    void close() override {}
    void nextSuggestion() override {}
    void previousSuggestion() override {}
    std::size_t selectedSuggestionIndex() const override { return NotFound; }
    bool windowVisible() const override { return false; }
    Rectangle windowFrame() const override { return {}; }
};

class WindowlessSearch final : public QuickSearchController {
  public:
    void setSnippetGroups(const EngineState::Groups& /*groups*/) override {}
    void setSnippetSelectedAction(std::function<void()> /*action*/) override {}
    void setSnippetSelectorKeyModifier(std::int64_t /*modifier*/) override {}
    void showWindowAtCaret() override {}
    void showWindowAtTopRightCorner() override {}
    void close() override {}
    std::shared_ptr<Snippet> selectedSnippet() const override { return nullptr; }
    std::shared_ptr<Snippet> snippetAtIndex(std::size_t /*index*/) const override { return nullptr; }
    bool windowVisible() const override { return false; }
    Rectangle windowFrame() const override { return {}; }
};

class WindowlessForm final : public FieldsEditor {
  public:
    WindowlessForm(std::shared_ptr<SnippetExpandedContent> content, Target& target,
                   std::function<void(const std::string&)> report)
        : content_(std::move(content)), target_(target), report_(std::move(report)) {}

    void show() override {
        const std::shared_ptr<Snippet>& snippet = content_->originalSnippet;
        const std::string name = snippet ? toUtf8(snippet->abbreviation().value_or(u"")) : std::string();
        report_("The snippet \"" + name + "\" has fields to fill in, and there is no form here to do it.");
        target_.fieldsEditorWillClose(*this);
    }
    const std::shared_ptr<SnippetExpandedContent>& content() const override { return content_; }

  private:
    std::shared_ptr<SnippetExpandedContent> content_;
    Target& target_;
    std::function<void(const std::string&)> report_;
};

}  // namespace

std::unique_ptr<SuggestionController> makeWindowlessSuggestionController() {
    return std::make_unique<WindowlessList>();
}

std::unique_ptr<QuickSearchController> makeWindowlessQuickSearchController() {
    return std::make_unique<WindowlessSearch>();
}

FieldsEditor::Factory windowlessFieldsEditors(std::function<void(const std::string&)> report) {
    return [report = std::move(report)](std::shared_ptr<SnippetExpandedContent> content, FieldsEditor::Target& target) {
        return std::make_unique<WindowlessForm>(std::move(content), target, report);
    };
}

}  // namespace plume

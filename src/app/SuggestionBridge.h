// The suggestion list of the thread that hears the keys: keeps what is selected and in sight, and has the main thread's
// window show it.
//
// Owned by the engine; belongs to the tap thread. Nothing waits: the window is told after the key has been decided.
// The view outlives the main loop's calls.
#pragma once

#include <functional>
#include <memory>

#include "app/SuggestionView.h"
#include "engine/SuggestionController.h"
#include "platform/RunLoop.h"

namespace plume {

class SuggestionBridge final : public SuggestionController {
  public:
    // Not owned; all of it outlives the bridge.
    struct Dependencies {
        // Called on the main thread alone, where the window is made when it is first needed.
        std::function<SuggestionView&()> view;
        RunLoop& tapLoop;
        RunLoop& mainLoop;
        const Accessibility& accessibility;
        const ProcessManager& processManager;
        // Another window has the keyboard: nothing is suggested for that one.
        std::function<void()> keyboardMoved;
    };

    explicit SuggestionBridge(Dependencies dependencies);
    ~SuggestionBridge() override;
    SuggestionBridge(const SuggestionBridge&) = delete;
    SuggestionBridge& operator=(const SuggestionBridge&) = delete;

    void setSnippets(const SuggestionList& list) override;
    void setSuggestionSelectedAction(std::function<void()> action) override { selectedAction_ = std::move(action); }
    void setSnippetSelectorKeyModifier(std::int64_t modifier) override { selectorKeyModifier_ = modifier; }
    void reloadData() override;
    // The window is always as high as its page.
    void refreshHeight() override {}
    void showWindowAtCaret() override;
    void close() override;
    void nextSuggestion() override;
    void previousSuggestion() override;
    std::size_t selectedSuggestionIndex() const override;
    bool windowVisible() const override { return visible_; }
    Rectangle windowFrame() const override { return frame_; }

  private:
    // What the view's events find when they arrive; null when the bridge has gone.
    using Self = std::shared_ptr<SuggestionBridge*>;

    SuggestionView::Events events() const;
    void clicked(std::uint64_t page, std::size_t index);
    void scrolled(int rows);
    void select(std::size_t index);
    SuggestionPage page();
    SuggestionRow rowAt(std::size_t index) const;
    void pageChanged();
    void open(const CaretPlace& place);
    void watchKeyboard();

    const Dependencies around_;
    const Self self_ = std::make_shared<SuggestionBridge*>(this);
    const SuggestionList* list_ = nullptr;
    std::function<void()> selectedAction_;
    std::int64_t selectorKeyModifier_ = 0;
    std::size_t first_ = 0;
    std::size_t selected_ = 0;
    bool visible_ = false;
    bool isOpen_ = false;  // the view has been told to show it
    SuggestionPage shown_;
    std::uint64_t pageNumber_ = 0;
    std::uint64_t listStart_ = 0;  // number of the first page of the list as it is
    Rectangle frame_;
    CaretFinder caret_;
    Timer paging_;
    Timer watching_;
    std::uint32_t window_ = 0;  // that the list stands in front of
};

}  // namespace plume

// Quick search on the thread that hears the keys: remembers which window had the keyboard, has the main thread's window
// opened, and has what was chosen sent when the keyboard is back where it was.
//
// Owned by the engine; belongs to the tap thread. Nothing waits: what takes time is asked for again and again, and what
// is typed meanwhile is kept back for 0.3 seconds at most. The view outlives the main loop's calls.
#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "app/KeyInDoubt.h"
#include "app/KeyboardHandover.h"
#include "app/QuickSearchView.h"
#include "engine/QuickSearchController.h"
#include "input/EventArgs.h"
#include "input/UserKeysHold.h"
#include "platform/RunLoop.h"

namespace plume {

class QuickSearchBridge final : public QuickSearchController {
  public:
    // Not owned; all of it outlives the bridge.
    struct Dependencies {
        // Called on the main thread alone, where the window is made when it is first needed.
        std::function<QuickSearchView&()> view;
        RunLoop& tapLoop;
        RunLoop& mainLoop;
        const Accessibility& accessibility;
        ProcessManager& processManager;
        // Keeps the user's keys back for so many seconds, or until it goes.
        std::function<std::unique_ptr<UserKeysHold>(double seconds)> holdUserKeys;
        // What stands before the caret, as far as it is to be the first query and gives way to the snippet then; empty
        // when the user does not want that.
        std::function<std::u16string()> typedQuery;
        // Tells the user, in one sentence.
        std::function<void(const std::string&)> report;
    };

    explicit QuickSearchBridge(Dependencies dependencies);
    ~QuickSearchBridge() override;
    QuickSearchBridge(const QuickSearchBridge&) = delete;
    QuickSearchBridge& operator=(const QuickSearchBridge&) = delete;

    // The main thread searches its own records.
    void setSnippetGroups(const std::vector<std::shared_ptr<SnippetGroup>>& /*groups*/) override {}
    void setSnippetSelectedAction(std::function<void()> action) override { selectedAction_ = std::move(action); }
    void setSnippetSelectorKeyModifier(std::int64_t modifier) override { selectorKeyModifier_ = modifier; }
    void showWindowAtCaret() override { open(true); }
    void showWindowAtTopRightCorner() override { open(false); }
    void close() override;
    std::shared_ptr<Snippet> selectedSnippet() const override { return selected_; }
    const std::optional<std::u16string>& typedText() const override { return typedText_; }
    std::shared_ptr<Snippet> snippetAtIndex(std::size_t index) const override;
    bool windowVisible() const override { return visible_; }
    Rectangle windowFrame() const override { return frame_; }

    // The user has chosen, and the window is gone: the snippet is sent once the keyboard is where it was before. Null
    // when the library has lost it meanwhile.
    void choose(std::shared_ptr<Snippet> snippet);
    // Called for every key, within its callback.
    void keyPressed(ZDKeyEventArgs& key);
    // The same for a key that is pressed with others than Shift.
    void shortcutPressed(ZDUnregisteredHotKeyPressedEventArgs& key);
    // What the first rows of the results are now, for digits that are pressed in another window.
    void setFirstRows(std::vector<std::shared_ptr<Snippet>> rows) { firstRows_ = std::move(rows); }

  private:
    // What the view's events find when they arrive; null when the bridge has gone.
    using Self = std::shared_ptr<QuickSearchBridge*>;

    QuickSearchView::Events events() const;
    void open(bool atCaret);
    void openWindow(const std::optional<CaretPlace>& place);
    void shown(std::uint32_t window);
    void closedByUser();
    void replaced();
    void stayed();
    bool hasKeyboard() const { return keyboard_.hasKeyboard(ownWindow_); }
    bool isSearching() const { return visible_ && hasKeyboard(); }
    void send(bool targetIsBack);

    const Dependencies around_;
    const Self self_ = std::make_shared<QuickSearchBridge*>(this);
    std::function<void()> selectedAction_;
    std::int64_t selectorKeyModifier_ = 0;
    bool visible_ = false;
    std::uint32_t ownWindow_ = 0;
    KeyboardHandover keyboard_;
    KeyboardHandover::Owner target_;
    std::shared_ptr<Snippet> selected_;
    std::optional<std::u16string> typedText_;
    std::vector<std::shared_ptr<Snippet>> firstRows_;
    Rectangle frame_;
    std::unique_ptr<UserKeysHold> hold_;
    CaretFinder caret_;
    KeyInDoubt keyInDoubt_;
};

}  // namespace plume

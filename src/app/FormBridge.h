// One snippet's form on the thread that hears the keys: remembers which window had the keyboard, has the main thread
// show the form, and has the text sent when the keyboard is back where it was.
//
// Owned by the sender; belongs to the tap thread. Nothing waits: what takes time is asked for again and again. What is
// typed until the form has the keyboard is kept back for it, for three seconds at most. The view outlives the main
// loop's calls.
#pragma once

#include <functional>
#include <memory>
#include <string>

#include "app/CaretPlace.h"
#include "app/FormView.h"
#include "app/KeyInDoubt.h"
#include "app/KeyboardHandover.h"
#include "engine/FieldsEditor.h"
#include "input/MacInputService.h"
#include "platform/Accessibility.h"

namespace plume {

class FormBridge final : public FieldsEditor {
  public:
    // Not owned; all of it outlives the bridge.
    struct Dependencies {
        // Called on the main thread alone, where the forms are made when the first is needed.
        std::function<FormView&()> view;
        RunLoop& tapLoop;
        RunLoop& mainLoop;
        const Accessibility& accessibility;
        ProcessManager& processManager;
        MacInputService& inputService;
    };

    FormBridge(FormView::Id id, std::shared_ptr<SnippetExpandedContent> content, Target& target,
               Dependencies dependencies);
    ~FormBridge() override;
    FormBridge(const FormBridge&) = delete;
    FormBridge& operator=(const FormBridge&) = delete;

    void show() override;
    // The form's while it is open.
    const std::shared_ptr<SnippetExpandedContent>& content() const override { return content_; }

  private:
    // What the view's events find when they arrive; null when the bridge has gone.
    using Self = std::shared_ptr<FormBridge*>;

    FormView::Events events() const;
    void onView(std::function<void(FormView&)> call) const;
    void shown(std::uint32_t window);
    void lost();
    void accepted();
    void cancelled();
    void stayed();
    void holdUserKeys(double seconds);
    // Within the callback of a key.
    void keyPressed(ZDKeyEventArgs& key) { mayEnd(key); }
    void shortcutPressed(ZDUnregisteredHotKeyPressedEventArgs& key) { mayEnd(key); }
    void mayEnd(const ZDKeyEventArgs& key);
    // Calls once with the field that has the focus; with an empty name when the program does not tell in time.
    void askForField(std::function<void(const std::string& field)> told);
    void checkField(int attemptsLeft);
    void send();
    void keep(const std::string& reason);

    const FormView::Id id_;
    const std::shared_ptr<SnippetExpandedContent> content_;
    Target& target_;
    const Dependencies around_;
    const Self self_ = std::make_shared<FormBridge*>(this);
    KeyboardHandover keyboard_;
    const KeyboardHandover::Owner owner_;  // who had the keyboard when the abbreviation was typed
    std::string field_;                    // that had the focus then; empty when it is not known
    bool isKept_ = false;                  // the text could not be sent once, and the user says where it goes
    std::uint32_t window_ = 0;
    std::unique_ptr<UserKeysHold> hold_;
    CaretFinder caret_;
    KeyInDoubt keyInDoubt_;
    Timer checking_;
    std::shared_ptr<std::function<void(const std::string&)>> asked_;  // belongs to the tap thread
    Subscription keys_;
    Subscription shortcuts_;
};

}  // namespace plume

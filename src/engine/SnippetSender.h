// Turns a chosen snippet into output: expands its content, works out what has to be erased and whether the key that
// triggered it is kept, asks for fields, runs scripts, hands the result to the input service, and says how to undo it.
//
// Owned by the engine, whose state it never touches: what sending makes of that is returned, or, after a form or a
// script, told later. Belongs to the thread that delivers the key events; only scripts run elsewhere. Destroying it
// drops open forms and all that is still to come and waits for scripts that run, so whoever does it stops the script
// runner first.
#pragma once

#include <cstdint>
#include <functional>
#include <list>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "content/SnippetParser.h"
#include "content/SnippetTrigger.h"
#include "content/scripts/ScriptRunner.h"
#include "engine/BackgroundTasks.h"
#include "engine/FieldsEditor.h"
#include "engine/TypedLetters.h"
#include "input/MacInputService.h"
#include "platform/Accessibility.h"
#include "platform/Sounds.h"

namespace plume {

// What the last expansion did, as far as taking it back needs to know.
struct UndoInformation {
    std::uint64_t backspaceCount = 0;  // of the expansion's units
    std::u16string erasedText;         // the expansion
    std::u16string text;               // what was typed, without the key that triggered the expansion
    std::u16string textWithTrigger;    // the same with that key
};

class SnippetSender final : private FieldsEditor::Target {
  public:
    // What the sender works with; not owned, and outlives it.
    struct Dependencies {
        MacInputService& inputService;
        SnippetParser& snippetParser;
        ScriptRunner& scriptRunner;
        Sounds& sounds;
        const Accessibility& accessibility;
        const TypedLetters& letters;
        FieldsEditor::Factory makeFieldsEditor;  // empty: what needs a form is refused
        // Tells the user that something cannot work, in one sentence. Never empty.
        std::function<void(const std::string&)> report;
        // Told of each snippet that is used. Empty: nobody is.
        std::function<void(const Snippet&)> snippetUsed = {};
    };

    // One snippet to send.
    struct Request {
        std::shared_ptr<Snippet> snippet;
        // What was typed for it and is erased; nothing when it was chosen in another way.
        std::optional<std::u16string> abbreviation;
        SnippetTriggers snippetTrigger;
        const SnippetParser::Groups& groups;  // the library, for snippets nested in this one
        std::int64_t adaptToCaseOption;       // how content is adapted to the case in which its abbreviation was typed
        std::optional<std::u16string> keyString;  // what the key that triggered it produces
        bool keyIsDelivered = false;              // and the program has that already
    };

    // What has been sent, and what it makes of the engine's state.
    struct Sent {
        bool swallowsKey = false;
        // What stands before the caret from now on, as far as it is known; nothing while it is still to come.
        std::optional<std::u16string> letters = {};
        std::optional<UndoInformation> undo = {};  // nothing: there is nothing to take back
    };

    // `sentLater` is told of everything that is sent after a form or a script, from the run loop.
    SnippetSender(Dependencies dependencies, std::function<void(const Sent&)> sentLater);
    ~SnippetSender();
    SnippetSender(const SnippetSender&) = delete;
    SnippetSender& operator=(const SnippetSender&) = delete;

    // Nothing when nothing was sent: the content cannot be expanded, or would change nothing.
    std::optional<Sent> send(const Request& request);
    // Takes an expansion back and types what stood there before, with or without the key that triggered it.
    Sent undo(const UndoInformation& undo, bool withTrigger);
    // Calls at once, or, where the program in front needs a while until it takes keys, brings it there and waits.
    void performOnceKeysAreTaken(std::function<void()> call);

    // The snippet sent last, as long as it exists; else null.
    std::shared_ptr<Snippet> lastUsedSnippet() const { return lastUsedSnippet_.lock(); }

    bool playFeedbackSound() const { return playFeedbackSound_; }
    void setPlayFeedbackSound(bool value) { playFeedbackSound_ = value; }
    // By the name that Sounds knows it by.
    const std::string& feedbackSound() const { return feedbackSound_; }
    void setFeedbackSound(std::string name) { feedbackSound_ = std::move(name); }

    // Scripts were begun whose results have not been dealt with: they run, or their results wait in the run loop.
    bool hasPendingScripts() const { return backgroundTasks_.arePending(); }
    // Blocks until no script runs; the results are with the run loop then, and may begin further scripts there.
    void waitForScripts() const { backgroundTasks_.waitUntilIdle(); }

  private:
    using Expansion = std::shared_ptr<SnippetExpandedContent>;
    using Output = std::shared_ptr<PLOutput>;
    // Shared by what runs for one snippet, which may be one script after the other; null where no key waits.
    using KeysHold = std::shared_ptr<UserKeysHold>;
    // What is known of the text while scripts run.
    struct Waiting {
        KeysHold hold;
        // When the abbreviation was erased, by TypedLetters::resets; nothing where a form was open meanwhile.
        std::optional<std::uint64_t> erased = {};
    };
    struct OpenForm {
        std::unique_ptr<FieldsEditor> editor;  // null until it is time to make it
        KeysHold hold;                         // until then, when the form itself keeps keys back
        Timer next;                            // makes the form, shows it, or lets it go
    };

    bool refuses(const Request& request, const SnippetExpandedContent& content) const;
    Sent sendAtOnce(const Request& request, const Expansion& content, const Output& output);
    Sent sendText(const Expansion& content, const Output& output);
    // What a form or scripts have completed.
    void sendContent(const Expansion& content, SnippetTriggers snippetTrigger, const Waiting& waiting);

    void showFieldsEditor(const Expansion& content, KeysHold hold);
    void makeForm(OpenForm& form, const Expansion& content);
    void fieldsEditorWillClose(FieldsEditor& editor) override;
    void fieldsEditorAction(FieldsEditor& editor) override;
    void fieldsEditorDidClose(const Expansion& content);

    // The user's keys wait for a script that is soon done, and follow behind what it gives.
    KeysHold holdKeys();
    void executeScripts(const Expansion& content, const Waiting& waiting);
    void runScriptSnippet(const Expansion& content, const Waiting& waiting);
    void onScriptExecuted(const PLScript& script, const Waiting& waiting);
    std::u16string movedBehindOutput(const Waiting& waiting, std::u16string_view suffix, PLOutput& output) const;
    void performInBackground(std::function<void()> work, std::function<void()> finish);

    void playFeedback(const std::string& name) const;

    Dependencies dependencies_;
    std::function<void(const Sent&)> sentLater_;
    std::weak_ptr<Snippet> lastUsedSnippet_;
    bool playFeedbackSound_ = false;
    std::string feedbackSound_;
    std::list<OpenForm> forms_;
    std::list<Timer> delayedCalls_;
    BackgroundTasks backgroundTasks_;
};

}  // namespace plume

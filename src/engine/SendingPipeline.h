// Turns a chosen snippet into output: expands its content, works out what has to be erased and whether the key that
// triggered it is kept, asks for fields, runs scripts, hands the result to the input service, remembers how to undo it.
//
// Owned by the composition root. Belongs to the thread that delivers the key events; only scripts run elsewhere, and
// what they gave comes back through that thread's run loop. What was begun (a form, a script) needs the engine that
// asked for it: once the engine is gone, the run loop runs nothing more before the pipeline is gone too. Destroying it
// waits for scripts that run, so whoever does it stops the script runner first.
#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "content/SnippetParser.h"
#include "content/scripts/ScriptRunner.h"
#include "engine/BackgroundTasks.h"
#include "engine/FieldsEditor.h"
#include "engine/SnippetSender.h"
#include "input/InputService.h"
#include "platform/Sounds.h"

namespace plume {

class SendingPipeline final : public SnippetSender, private FieldsEditor::Target {
  public:
    // What the pipeline works with; not owned, and outlives it.
    struct Dependencies {
        InputService& inputService;
        SnippetParser& snippetParser;
        ScriptRunner& scriptRunner;
        Sounds* sounds;  // null: silence
        FieldsEditor::Factory makeFieldsEditor;
        // Tells the user that something cannot work, in one sentence. Never null.
        std::function<void(const std::string&)> report;
    };

    explicit SendingPipeline(Dependencies dependencies);
    ~SendingPipeline() override;
    SendingPipeline(const SendingPipeline&) = delete;
    SendingPipeline& operator=(const SendingPipeline&) = delete;

    bool sendSnippet(EngineState& engine, const std::shared_ptr<Snippet>& snippet,
                     const std::optional<std::u16string>& abbreviation, SnippetTriggers snippetTrigger) override;
    bool undo(EngineState& engine, bool withTrigger) override;

    // The snippet sent last, as long as it exists; else null.
    std::shared_ptr<Snippet> lastUsedSnippet() const { return lastUsedSnippet_.lock(); }

    bool playFeedbackSound() const { return playFeedbackSound_; }
    void setPlayFeedbackSound(bool value) { playFeedbackSound_ = value; }
    // By the name that Sounds knows it by.
    const std::string& feedbackSound() const { return feedbackSound_; }
    void setFeedbackSound(std::string name) { feedbackSound_ = std::move(name); }

    // Scripts were begun whose results have not been dealt with: they run, or their results wait in the run loop.
    bool hasPendingScripts() const { return pendingScripts_ > 0; }
    // Blocks until no script runs; the results are with the run loop then, and may begin further scripts there.
    void waitForScripts() const { backgroundTasks_.waitUntilIdle(); }

  private:
    using Expansion = std::shared_ptr<SnippetExpandedContent>;
    using Output = std::shared_ptr<PLOutput>;
    struct Delivery;
    struct OpenForm {
        std::shared_ptr<FieldsEditor> editor;
        EngineState* engine;
    };

    void sendByForm(const Delivery& delivery);
    void sendByScripts(const Delivery& delivery);
    void sendAtOnce(const Delivery& delivery);

    // By content type. Without an output, as after a form, one is made for the trigger.
    void sendContent(EngineState& engine, const std::shared_ptr<Snippet>& snippet, const Expansion& content,
                     SnippetTriggers snippetTrigger, Output output);
    void sendText(EngineState& engine, const Expansion& content, Output output);
    void runScriptSnippet(EngineState& engine, const Snippet& snippet, const Expansion& content, const Output& output);
    void onScriptExecuted(EngineState& engine, const PLScript& script);
    void executeScripts(EngineState& engine, const Expansion& content);

    void showFieldsEditor(EngineState& engine, const Expansion& content);
    void fieldsEditorWillClose(FieldsEditor& editor) override;
    void fieldsEditorAction(FieldsEditor& editor) override;
    void fieldsEditorDidClose(EngineState& engine, const Expansion& content);
    std::vector<OpenForm>::iterator formOf(const FieldsEditor& editor);

    void playFeedback(const std::string& name) const;
    // On the run loop, unless the pipeline is gone by then.
    void performAfterDelay(double delay, std::function<void()> call);
    // On a thread of its own: `work`, then on the run loop, unless the pipeline is gone by then, `finish`.
    void performInBackground(std::function<void()> work, std::function<void()> finish);

    Dependencies dependencies_;
    std::weak_ptr<Snippet> lastUsedSnippet_;
    bool playFeedbackSound_ = false;
    std::string feedbackSound_;
    std::vector<OpenForm> forms_;
    std::size_t pendingScripts_ = 0;
    const std::shared_ptr<const bool> alive_ = std::make_shared<const bool>(true);
    BackgroundTasks backgroundTasks_;
};

}  // namespace plume

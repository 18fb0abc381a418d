// What a snippet needs before it can be delivered: the fill-in form, and scripts.
#include <algorithm>
#include <utility>

#include "content/FieldMerging.h"
#include "content/NestedScripts.h"
#include "engine/SendingPipeline.h"
#include "engine/SlowActivation.h"

namespace plume {

namespace {

constexpr double FormDelay = 0.1;  // seconds
// Whatever sound announces expansions, a form is announced by this one.
constexpr const char* FormSound = "Pop";

}  // namespace

// ---- The form ----

void SendingPipeline::showFieldsEditor(EngineState& engine, const Expansion& content) {
    performAfterDelay(0, [this, &engine, content] {
        const std::shared_ptr<FieldsEditor> editor = dependencies_.makeFieldsEditor(content, *this);
        forms_.push_back({editor, &engine});
        playFeedback(FormSound);
        performAfterDelay(FormDelay, [form = std::weak_ptr(editor)] {
            if (const auto toShow = form.lock()) toShow->show();
        });
    });
}

std::vector<SendingPipeline::OpenForm>::iterator SendingPipeline::formOf(const FieldsEditor& editor) {
    return std::find_if(forms_.begin(), forms_.end(),
                        [&](const OpenForm& form) { return form.editor.get() == &editor; });
}

void SendingPipeline::fieldsEditorWillClose(FieldsEditor& editor) {
    const auto closing = formOf(editor);
    if (closing == forms_.end()) return;
    // Not now: the form itself is calling, and may have more to say.
    performAfterDelay(0, [this, form = std::weak_ptr(closing->editor)] {
        std::erase_if(forms_, [&](const OpenForm& open) { return open.editor == form.lock(); });
    });
}

void SendingPipeline::fieldsEditorAction(FieldsEditor& editor) {
    const auto form = formOf(editor);
    if (form == forms_.end()) return;
    EngineState& engine = *form->engine;
    const Expansion& content = editor.content();
    InputService& service = dependencies_.inputService;
    if (!losesKeysWhileActivated(service.contextBundleIdentifier())) return fieldsEditorDidClose(engine, content);
    service.bringLastProcessToFront();
    performAfterDelay(ActivationDelay, [this, &engine, content] { fieldsEditorDidClose(engine, content); });
}

void SendingPipeline::fieldsEditorDidClose(EngineState& engine, const Expansion& content) {
    mergeFields(*content);
    processScripts(*content);
    if (content->scripts.empty()) {
        engine.setUndoInfo(std::nullopt);
        sendContent(engine, content->originalSnippet, content, SnippetTrigger::Digit, nullptr);
    } else {
        executeScripts(engine, content);
    }
}

// ---- Scripts ----

void SendingPipeline::executeScripts(EngineState& engine, const Expansion& content) {
    performInBackground(
        [&runner = dependencies_.scriptRunner, content] {
            for (const auto& script : content->scripts) script->execute(runner);
            mergeScriptResults(*content);
        },
        [this, &engine, content] {
            engine.setUndoInfo(std::nullopt);
            sendContent(engine, content->originalSnippet, content, SnippetTrigger::ScriptResult, nullptr);
        });
}

void SendingPipeline::runScriptSnippet(EngineState& engine, const Snippet& snippet, const Expansion& content,
                                       const Output& output) {
    InputService& service = dependencies_.inputService;
    const auto script = std::make_shared<PLScript>();
    script->script = content->string();
    script->isAppleScript = snippet.contentType() == ContentType::AppleScript;
    // Kept since before the form.
    if (!content->suffix.empty()) script->suffix = content->suffix;
    if (output) {
        const std::shared_ptr<SnippetGroup> group = snippet.parentGroup();
        if (group && group->expandTrigger() == ExpandTrigger::DelimiterKept) {
            output->cancelTrigger = true;
            script->suffix = service.lastKeyString();
        }
        service.sendOutput(output);
    }
    performInBackground([&runner = dependencies_.scriptRunner, script] { script->execute(runner); },
                        [this, &engine, script] { onScriptExecuted(engine, *script); });
}

void SendingPipeline::onScriptExecuted(EngineState& engine, const PLScript& script) {
    if (!script.result) return;
    engine.setUndoInfo(std::nullopt);
    const auto output = std::make_shared<PLOutput>();
    output->trigger = SnippetTrigger::ScriptResult;
    output->snippetExpandedContent = std::make_shared<SnippetExpandedContent>(*script.result);
    dependencies_.inputService.sendOutput(output);
    playFeedback(feedbackSound_);
    // What was typed while the script ran stands in front of its output, and the kept delimiter behind it.
    engine.setLetters(script.suffix.value_or(u""));
}

// ---- Where and when things run ----

void SendingPipeline::performAfterDelay(double delay, std::function<void()> call) {
    const std::weak_ptr<const bool> alive = alive_;
    dependencies_.inputService.runLoop().schedule(delay, [alive, call = std::move(call)] {
        if (!alive.expired()) call();
    });
}

void SendingPipeline::performInBackground(std::function<void()> work, std::function<void()> finish) {
    const std::weak_ptr<const bool> alive = alive_;
    RunLoop& loop = dependencies_.inputService.runLoop();
    const auto begun =
        backgroundTasks_.run([this, &loop, alive, work = std::move(work), finish = std::move(finish)]() mutable {
            work();
            // What the work shares with the finish belongs to the loop's thread from here on, to the last reference.
            work = nullptr;
            loop.perform([this, alive, finish = std::exchange(finish, nullptr)] {
                if (alive.expired()) return;
                --pendingScripts_;
                finish();
            });
        });
    if (begun) {
        ++pendingScripts_;
    } else {
        dependencies_.report("A script could not be run: the system gives no further thread.");
    }
}

}  // namespace plume

// What a snippet needs before it can be delivered: the fill-in form, and scripts.
#include <algorithm>
#include <utility>

#include "content/FieldMerging.h"
#include "content/NestedScripts.h"
#include "engine/SnippetSender.h"

namespace plume {

namespace {

constexpr double FormDelay = 0.1;  // seconds
// Whatever sound announces expansions, a form is announced by this one.
constexpr const char* FormSound = "Pop";

}  // namespace

// ---- The form ----

void SnippetSender::showFieldsEditor(const Expansion& content) {
    OpenForm& form = forms_.emplace_back();
    // Not from inside the key callback.
    form.next =
        dependencies_.inputService.runLoop().performAfterDelay(0, [this, &form, content] { makeForm(form, content); });
}

void SnippetSender::makeForm(OpenForm& form, const Expansion& content) {
    form.editor = dependencies_.makeFieldsEditor(content, *this);
    playFeedback(FormSound);
    form.next = dependencies_.inputService.runLoop().performAfterDelay(FormDelay, [&form] { form.editor->show(); });
}

void SnippetSender::fieldsEditorWillClose(FieldsEditor& editor) {
    const auto form =
        std::find_if(forms_.begin(), forms_.end(), [&](const OpenForm& open) { return open.editor.get() == &editor; });
    if (form == forms_.end()) return;
    // Not now: the form itself is calling, and may have more to say.
    form->next = dependencies_.inputService.runLoop().performAfterDelay(0, [this, form] { forms_.erase(form); });
}

void SnippetSender::fieldsEditorAction(FieldsEditor& editor) {
    performOnceKeysAreTaken([this, content = editor.content()] { fieldsEditorDidClose(content); });
}

void SnippetSender::fieldsEditorDidClose(const Expansion& content) {
    mergeFields(*content);
    processScripts(*content);
    if (content->scripts.empty()) {
        sendContent(content, SnippetTrigger::Digit);
    } else {
        executeScripts(content);
    }
}

// ---- Scripts ----

void SnippetSender::executeScripts(const Expansion& content) {
    performInBackground(
        [&runner = dependencies_.scriptRunner, content] {
            for (const auto& script : content->scripts) script->execute(runner);
            mergeScriptResults(*content);
        },
        [this, content] { sendContent(content, SnippetTrigger::ScriptResult); });
}

void SnippetSender::runScriptSnippet(const Expansion& content) {
    lastUsedSnippet_ = content->originalSnippet;
    const auto script = std::make_shared<PLScript>();
    script->script = content->string();
    script->isAppleScript = content->originalSnippet->contentType() == ContentType::AppleScript;
    script->suffix = content->suffix;
    performInBackground([&runner = dependencies_.scriptRunner, script] { script->execute(runner); },
                        [this, script] { onScriptExecuted(*script); });
}

void SnippetSender::onScriptExecuted(const PLScript& script) {
    if (!script.result) return;
    const auto output = std::make_shared<PLOutput>();
    output->trigger = SnippetTrigger::ScriptResult;
    output->snippetExpandedContent = std::make_shared<SnippetExpandedContent>(*script.result);
    dependencies_.inputService.sendOutput(output);
    playFeedback(feedbackSound_);
    // What was typed while the script ran stands in front of its output, and the kept delimiter behind it.
    sentLater_({.letters = script.suffix});
}

void SnippetSender::performInBackground(std::function<void()> work, std::function<void()> finish) {
    if (backgroundTasks_.run(std::move(work), std::move(finish))) return;
    dependencies_.report("A script could not be run: the system gives no further thread.");
}

}  // namespace plume

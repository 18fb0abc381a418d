// What a snippet needs before it can be delivered: the fill-in form, and scripts.
#include <algorithm>
#include <utility>

#include "content/FieldMerging.h"
#include "content/NestedScripts.h"
#include "engine/SnippetSender.h"

namespace plume {

namespace {

constexpr double FormDelay = 0.1;  // seconds
// A person does not notice that a key comes later by this.
constexpr double LongestKeysHold = 0.3;  // seconds
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
    const bool runsScripts = !content->scripts.empty() || content->originalSnippet->isScript();
    const KeysHold hold = runsScripts ? holdKeysForScripts() : nullptr;
    if (content->scripts.empty()) {
        sendContent(content, SnippetTrigger::Digit, hold);
    } else {
        executeScripts(content, hold);
    }
}

// ---- Scripts ----

SnippetSender::KeysHold SnippetSender::holdKeysForScripts() {
    return dependencies_.inputService.holdUserKeys(LongestKeysHold);
}

void SnippetSender::executeScripts(const Expansion& content, const KeysHold& hold) {
    performInBackground(
        [&runner = dependencies_.scriptRunner, content] {
            for (const auto& script : content->scripts) script->execute(runner);
            mergeScriptResults(*content);
        },
        [this, content, hold] { sendContent(content, SnippetTrigger::ScriptResult, hold); });
}

void SnippetSender::runScriptSnippet(const Expansion& content, const KeysHold& hold) {
    lastUsedSnippet_ = content->originalSnippet;
    const auto script = std::make_shared<PLScript>();
    script->script = content->string();
    script->isAppleScript = content->originalSnippet->contentType() == ContentType::AppleScript;
    script->suffix = content->suffix;
    performInBackground([&runner = dependencies_.scriptRunner, script] { script->execute(runner); },
                        [this, script, hold] { onScriptExecuted(*script); });
}

void SnippetSender::onScriptExecuted(const PLScript& script) {
    const std::u16string suffix = script.suffix.value_or(u"");
    const bool isSilent = !script.result || script.result->empty();
    if (isSilent && suffix.empty()) return;
    const auto output = std::make_shared<PLOutput>();
    output->trigger = SnippetTrigger::ScriptResult;
    // The delimiter that was typed behind the abbreviation is the user's own.
    output->snippetExpandedContent = std::make_shared<SnippetExpandedContent>(isSilent ? suffix : *script.result);
    dependencies_.inputService.sendOutput(output);
    if (!isSilent) playFeedback(feedbackSound_);
    // What was typed while the script ran stands in front of its output, and the kept delimiter behind it.
    sentLater_({.letters = script.suffix});
}

void SnippetSender::performInBackground(std::function<void()> work, std::function<void()> finish) {
    if (backgroundTasks_.run(std::move(work), std::move(finish))) return;
    dependencies_.report("A script could not be run: the system gives no further thread.");
}

}  // namespace plume

// What a snippet needs before it can be delivered: the fill-in form, and scripts.
#include <algorithm>
#include <utility>

#include "content/FieldMerging.h"
#include "content/NestedScripts.h"
#include "engine/SnippetSender.h"
#include "input/AXUtils.h"

namespace plume {

namespace {

constexpr double FormDelay = 0.1;  // seconds
// A person does not notice that a key comes later by this.
constexpr double LongestKeysHold = 0.3;  // seconds
// More than this is not erased to be typed again: the user would see it go.
constexpr std::size_t LongestMove = 100;
// Whatever sound announces expansions, a form is announced by this one.
constexpr const char* FormSound = "Pop";

}  // namespace

// ---- The form ----

void SnippetSender::showFieldsEditor(const Expansion& content, KeysHold hold) {
    OpenForm& form = forms_.emplace_back();
    form.hold = std::move(hold);
    // Not from inside the key callback.
    form.next =
        dependencies_.inputService.runLoop().performAfterDelay(0, [this, &form, content] { makeForm(form, content); });
}

void SnippetSender::makeForm(OpenForm& form, const Expansion& content) {
    form.editor = dependencies_.makeFieldsEditor(content, *this);
    form.hold = nullptr;
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
    const Waiting waiting{runsScripts ? holdKeys() : nullptr};
    if (content->scripts.empty()) {
        sendContent(content, SnippetTrigger::Digit, waiting);
    } else {
        executeScripts(content, waiting);
    }
}

// ---- Scripts ----

SnippetSender::KeysHold SnippetSender::holdKeys() {
    return dependencies_.inputService.holdUserKeys(LongestKeysHold);
}

// Output belongs where the abbreviation stood, and the user may have typed on: that is erased and comes again behind
// the output, where the program confirms that nothing else stands between. `suffix` counts as typed and is still to
// come.
std::u16string SnippetSender::movedBehindOutput(const Waiting& waiting, std::u16string_view suffix,
                                                PLOutput& output) const {
    if (!waiting.erased) return {};
    std::u16string_view typed = dependencies_.letters.typedSince(*waiting.erased).value_or(u"");
    if (!typed.starts_with(suffix)) return {};
    typed.remove_prefix(suffix.size());
    if (typed.empty() || typed.size() > LongestMove) return {};
    const auto before =
        AXUtils::getTextBeforeCaretWithMaxLength(dependencies_.accessibility, static_cast<std::int64_t>(typed.size()));
    if (before != typed || AXUtils::getSelectedTextRange(dependencies_.accessibility).length != 0) return {};
    output.erasedText = typed;
    output.backspaceCount = typed.size();
    return std::u16string(typed);
}

void SnippetSender::executeScripts(const Expansion& content, const Waiting& waiting) {
    performInBackground(
        [&runner = dependencies_.scriptRunner, content] {
            for (const auto& script : content->scripts) script->execute(runner);
            mergeScriptResults(*content);
        },
        [this, content, waiting] { sendContent(content, SnippetTrigger::ScriptResult, waiting); });
}

void SnippetSender::runScriptSnippet(const Expansion& content, const Waiting& waiting) {
    lastUsedSnippet_ = content->originalSnippet;
    const auto script = std::make_shared<PLScript>();
    script->script = content->string();
    script->isAppleScript = content->originalSnippet->contentType() == ContentType::AppleScript;
    script->suffix = content->suffix;
    performInBackground([&runner = dependencies_.scriptRunner, script] { script->execute(runner); },
                        [this, script, waiting] { onScriptExecuted(*script, waiting); });
}

void SnippetSender::onScriptExecuted(const PLScript& script, const Waiting& waiting) {
    const std::u16string suffix = script.suffix.value_or(u"");
    const bool isSilent = !script.result || script.result->empty();
    if (isSilent && suffix.empty()) return;
    const auto output = std::make_shared<PLOutput>();
    output->trigger = SnippetTrigger::ScriptResult;
    const std::u16string moved = movedBehindOutput(waiting, suffix, *output);
    // The delimiter that was typed behind the abbreviation is the user's own.
    output->snippetExpandedContent =
        std::make_shared<SnippetExpandedContent>((isSilent ? suffix : *script.result) + moved);
    dependencies_.inputService.sendOutput(output);
    if (!isSilent) playFeedback(feedbackSound_);
    // What was typed while the script ran stands in front of its output, unless it could be moved, and the kept
    // delimiter behind it.
    sentLater_({.letters = suffix + moved});
}

void SnippetSender::performInBackground(std::function<void()> work, std::function<void()> finish) {
    if (backgroundTasks_.run(std::move(work), std::move(finish))) return;
    dependencies_.report("A script could not be run: the system gives no further thread.");
}

}  // namespace plume

// From a chosen snippet to the first output, and back by undo.
#include "engine/SnippetSender.h"

#include <algorithm>
#include <utility>

#include "Foundation/Strings.h"
#include "content/NestedScripts.h"
#include "content/SnippetContentCase.h"

namespace plume {

namespace {

using Request = SnippetSender::Request;

// It needs a while, after it has come to the front again, until it takes keys.
constexpr const char16_t* SlowProgram = u"com.citrix.XenAppViewer";
constexpr double ActivationDelay = 0.5;  // seconds

ExpandTrigger expandTriggerOf(const Snippet& snippet) {
    const std::shared_ptr<SnippetGroup> group = snippet.parentGroup();
    return group ? group->expandTrigger() : ExpandTrigger::Immediately;
}

// What stands in the text of the abbreviation, and of the key that triggered it, and has to go.
std::u16string textToErase(const Request& request) {
    std::u16string typed = request.abbreviation.value_or(u"");
    if (!request.abbreviation) return typed;
    const bool triggerStands = request.keyIsDelivered && request.snippetTrigger == SnippetTrigger::Typed;
    const ExpandTrigger expandTrigger = expandTriggerOf(*request.snippet);
    if (expandTrigger == ExpandTrigger::Immediately) {
        // The last key of the abbreviation is being swallowed: the application never got it.
        if (request.snippetTrigger == SnippetTrigger::Typed && !triggerStands && !typed.empty()) typed.pop_back();
        return typed;
    }
    if (triggerStands) typed += request.keyString.value_or(u"");
    // The delimiter went through when the list of matches opened.
    const bool delimiterStands =
        request.snippetTrigger.contains(SnippetTrigger::FromSeveralMatches) && expandTrigger != ExpandTrigger::HotKey;
    if (delimiterStands) typed += u' ';
    return typed;
}

// The user would see the text erased and typed again.
bool changesNothing(const Request& request, const SnippetExpandedContent& content) {
    return request.snippet->contentType() == ContentType::PlainText && content.fields().empty() &&
           content.abbreviations().empty() && !content.hasCaretLocationOrKeys() &&
           content.string() == request.abbreviation;
}

// A content that comes later has the delimiter that the key typed behind it, if that is kept.
std::u16string keptDelimiter(const Request& request) {
    const bool isKept = request.snippetTrigger == SnippetTrigger::Typed &&
                        expandTriggerOf(*request.snippet) == ExpandTrigger::DelimiterKept;
    return isKept ? request.keyString.value_or(u"") : u"";
}

bool holdsAppleScript(const Request& request, const SnippetExpandedContent& content) {
    if (request.snippet->contentType() == ContentType::AppleScript) return true;
    const auto nested = content.abbreviations();
    return std::any_of(nested.begin(), nested.end(), [](const auto& script) { return script->isAppleScript; });
}

UndoInformation undoOf(const Request& request, const PLOutput& output) {
    UndoInformation undo;
    undo.erasedText = output.snippetExpandedContent->string();
    if (!output.cancelTrigger) undo.erasedText += u' ';
    undo.backspaceCount = undo.erasedText.size();
    undo.text = request.abbreviation.value_or(u"");
    undo.textWithTrigger = undo.text;
    if (expandTriggerOf(*request.snippet) != ExpandTrigger::Immediately) {
        undo.textWithTrigger += request.keyString.value_or(u"");
    } else if (!undo.text.empty()) {
        undo.text.pop_back();
    }
    return undo;
}

}  // namespace

SnippetSender::SnippetSender(Dependencies dependencies, std::function<void(const Sent&)> sentLater)
    : dependencies_(std::move(dependencies)),
      sentLater_(std::move(sentLater)),
      backgroundTasks_(dependencies_.inputService.runLoop()) {}

SnippetSender::~SnippetSender() = default;

std::optional<SnippetSender::Sent> SnippetSender::send(const Request& request) {
    const Expansion content = dependencies_.snippetParser.parseSnippet(request.snippet, request.groups);
    if (!content) return std::nullopt;
    Snippet& snippet = *request.snippet;
    if (request.abbreviation && !request.abbreviation->empty() &&
        snippet.caseSensitivity() == CaseSensitivity::IgnoreCaseAndAdapt) {
        correctSnippetContentCase(*content, *request.abbreviation, request.adaptToCaseOption);
    }
    if (changesNothing(request, *content) || refuses(request, *content)) return std::nullopt;
    snippet.updateLastTimeUsed();
    if (dependencies_.snippetUsed) dependencies_.snippetUsed(snippet);
    content->originalSnippet = request.snippet;

    const auto output = std::make_shared<PLOutput>();
    output->trigger = request.snippetTrigger;
    output->erasedText = textToErase(request);
    output->backspaceCount = output->erasedText->size();
    output->cancelTrigger = request.keyIsDelivered || expandTriggerOf(snippet) != ExpandTrigger::DelimiterKept ||
                            content->hasCaretOrFields();

    const bool needsForm = !content->fields().empty();
    if (!needsForm) processScripts(*content);
    if (!needsForm && content->scripts.empty() && !snippet.isScript()) return sendAtOnce(request, content, output);

    // The abbreviation goes at once, the content comes when the form is filled in or the script has run.
    output->cancelTrigger = true;
    const Waiting waiting{holdKeys(), dependencies_.letters.resets()};
    dependencies_.inputService.sendOutput(output);
    content->suffix = keptDelimiter(request);
    if (needsForm) {
        showFieldsEditor(content, waiting.hold);
    } else if (content->scripts.empty()) {
        runScriptSnippet(content, waiting);
    } else {
        executeScripts(content, waiting);
    }
    return Sent{.swallowsKey = output->cancelTrigger};
}

bool SnippetSender::refuses(const Request& request, const SnippetExpandedContent& content) const {
    if (holdsAppleScript(request, content) && !dependencies_.scriptRunner.canRunAppleScript()) return true;
    if (content.fields().empty() || dependencies_.makeFieldsEditor) return false;
    dependencies_.report("The snippet \"" + toUtf8(request.snippet->abbreviation().value_or(u"")) +
                         "\" has fields to fill in, and there is no form here to do it.");
    return true;
}

SnippetSender::Sent SnippetSender::sendAtOnce(const Request& request, const Expansion& content, const Output& output) {
    Sent sent = sendText(content, output);
    sent.undo = undoOf(request, *output);
    return sent;
}

void SnippetSender::sendContent(const Expansion& content, SnippetTriggers snippetTrigger, const Waiting& waiting) {
    if (content->originalSnippet->isScript()) {
        runScriptSnippet(content, waiting);
        return sentLater_({});
    }
    const auto output = std::make_shared<PLOutput>();
    output->trigger = snippetTrigger;
    content->suffix += movedBehindOutput(waiting, content->suffix, *output);
    sentLater_(sendText(content, output));
}

SnippetSender::Sent SnippetSender::sendText(const Expansion& content, const Output& output) {
    lastUsedSnippet_ = content->originalSnippet;
    output->snippetExpandedContent = content;
    dependencies_.inputService.sendOutput(output);
    playFeedback(feedbackSound_);
    // Typing goes on behind the expanded text, unless the caret may stand elsewhere. What was typed while a form or a
    // script was busy stands in front of the text.
    return {.swallowsKey = output->cancelTrigger, .letters = content->variables.empty() ? content->string() : u""};
}

SnippetSender::Sent SnippetSender::undo(const UndoInformation& undo, bool withTrigger) {
    const std::u16string& text = withTrigger ? undo.textWithTrigger : undo.text;
    const auto output = std::make_shared<PLOutput>();
    output->trigger = SnippetTrigger::HotKey;
    output->backspaceCount = undo.backspaceCount;
    output->erasedText = undo.erasedText;
    output->snippetExpandedContent = std::make_shared<SnippetExpandedContent>(text);
    dependencies_.inputService.sendOutput(output);
    playFeedback(feedbackSound_);
    return {.swallowsKey = true, .letters = text};
}

void SnippetSender::performOnceKeysAreTaken(std::function<void()> call) {
    MacInputService& service = dependencies_.inputService;
    if (service.contextBundleIdentifier() != SlowProgram) return call();
    service.bringLastProcessToFront();
    const auto timer = delayedCalls_.emplace(delayedCalls_.end());
    *timer = service.runLoop().performAfterDelay(ActivationDelay, [this, timer, call = std::move(call)] {
        delayedCalls_.erase(timer);
        call();
    });
}

void SnippetSender::playFeedback(const std::string& name) const {
    if (playFeedbackSound_) dependencies_.sounds.play(name);
}

}  // namespace plume

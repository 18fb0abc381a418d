// From a chosen snippet to the first output, and back by undo.
#include "engine/SendingPipeline.h"

#include <utility>

#include "content/NestedScripts.h"
#include "content/SnippetContentCase.h"

namespace plume {

namespace {

using Expansion = std::shared_ptr<SnippetExpandedContent>;

ExpandTrigger expandTriggerOf(const Snippet& snippet) {
    const std::shared_ptr<SnippetGroup> group = snippet.parentGroup();
    return group ? group->expandTrigger() : ExpandTrigger::Immediately;
}

// What stands in the text of the abbreviation, and of the key that triggered it, and has to go.
std::uint64_t backspaceCount(std::size_t typedLength, ExpandTrigger expandTrigger, SnippetTriggers snippetTrigger) {
    if (expandTrigger == ExpandTrigger::Immediately) {
        // The last key of the abbreviation is being swallowed: the application never got it.
        return snippetTrigger == SnippetTrigger::Typed && typedLength > 0 ? typedLength - 1 : typedLength;
    }
    // The delimiter went through when the list of matches opened.
    const bool delimiterStands =
        snippetTrigger.contains(SnippetTrigger::FromSeveralMatches) && expandTrigger != ExpandTrigger::HotKey;
    return delimiterStands ? typedLength + 1 : typedLength;
}

// The user would see the text erased and typed again.
bool changesNothing(const Snippet& snippet, const SnippetExpandedContent& content,
                    const std::optional<std::u16string>& typed) {
    return snippet.contentType() == ContentType::PlainText && content.fields().empty() &&
           content.abbreviations().empty() && !content.hasCaretLocationOrKeys() && content.string() == typed;
}

UndoInformation undoOf(const PLOutput& output, const std::u16string& typed, ExpandTrigger expandTrigger,
                       const std::optional<std::u16string>& lastKey) {
    UndoInformation undo;
    undo.backspaceCount = output.snippetExpandedContent->string().size() + (output.cancelTrigger ? 0 : 1);
    undo.text = typed;
    undo.textWithTrigger = typed;
    if (expandTrigger != ExpandTrigger::Immediately) {
        undo.textWithTrigger += lastKey.value_or(u"");
    } else if (!typed.empty()) {
        undo.text.pop_back();
    }
    return undo;
}

}  // namespace

// One snippet on its way.
struct SendingPipeline::Delivery {
    EngineState& engine;
    std::shared_ptr<Snippet> snippet;
    std::u16string typed;
    SnippetTriggers snippetTrigger;
    ExpandTrigger expandTrigger;
    Expansion content;
    Output output;

    // The delimiter that the key typed stays, behind a content that is not there yet.
    bool keepsSuffix() const {
        return snippetTrigger == SnippetTrigger::Typed && expandTrigger == ExpandTrigger::DelimiterKept;
    }
};

SendingPipeline::SendingPipeline(Dependencies dependencies) : dependencies_(std::move(dependencies)) {}

SendingPipeline::~SendingPipeline() = default;

bool SendingPipeline::sendSnippet(EngineState& engine, const std::shared_ptr<Snippet>& snippet,
                                  const std::optional<std::u16string>& abbreviation, SnippetTriggers snippetTrigger) {
    engine.clear();
    const Expansion content = dependencies_.snippetParser.parseSnippet(snippet, engine.snippetGroups());
    if (!content) return false;
    const std::u16string typed = abbreviation.value_or(u"");
    if (!typed.empty() && snippet->caseSensitivity() == CaseSensitivity::IgnoreCaseAndAdapt) {
        correctSnippetContentCase(*content, typed, engine.snippetAdaptToAbbreviationCaseOption());
    }
    if (changesNothing(*snippet, *content, abbreviation)) return false;
    snippet->updateLastTimeUsed();
    content->originalSnippet = snippet;

    const ExpandTrigger expandTrigger = expandTriggerOf(*snippet);
    const auto output = std::make_shared<PLOutput>();
    output->trigger = snippetTrigger;
    if (abbreviation) output->backspaceCount = backspaceCount(typed.size(), expandTrigger, snippetTrigger);
    output->cancelTrigger = expandTrigger != ExpandTrigger::DelimiterKept || content->hasCaretOrFields();

    const Delivery delivery{engine, snippet, typed, snippetTrigger, expandTrigger, content, output};
    if (!content->fields().empty()) {
        sendByForm(delivery);
    } else {
        processScripts(*content);
        if (content->scripts.empty()) {
            sendAtOnce(delivery);
        } else {
            sendByScripts(delivery);
        }
    }
    return output->cancelTrigger;
}

// The abbreviation goes at once, the content comes when the form is filled in.
void SendingPipeline::sendByForm(const Delivery& delivery) {
    InputService& service = dependencies_.inputService;
    service.sendOutput(delivery.output);
    if (delivery.keepsSuffix()) delivery.content->suffix = service.lastKeyString().value_or(u"");
    delivery.engine.setUndoInfo(std::nullopt);
    showFieldsEditor(delivery.engine, delivery.content);
}

void SendingPipeline::sendByScripts(const Delivery& delivery) {
    InputService& service = dependencies_.inputService;
    delivery.output->cancelTrigger = true;
    service.sendOutput(delivery.output);
    if (delivery.keepsSuffix()) delivery.content->suffix = service.lastKeyString().value_or(u"");
    delivery.engine.setUndoInfo(std::nullopt);
    executeScripts(delivery.engine, delivery.content);
}

void SendingPipeline::sendAtOnce(const Delivery& delivery) {
    sendContent(delivery.engine, delivery.snippet, delivery.content, delivery.snippetTrigger, delivery.output);
    if (delivery.snippet->isScript()) {
        delivery.engine.setUndoInfo(std::nullopt);
        return;
    }
    delivery.engine.setUndoInfo(
        undoOf(*delivery.output, delivery.typed, delivery.expandTrigger, dependencies_.inputService.lastKeyString()));
}

void SendingPipeline::sendContent(EngineState& engine, const std::shared_ptr<Snippet>& snippet,
                                  const Expansion& content, SnippetTriggers snippetTrigger, Output output) {
    lastUsedSnippet_ = snippet;
    switch (snippet->contentType()) {
        case ContentType::PlainText:
        case ContentType::RichText:
            if (!output) {
                output = std::make_shared<PLOutput>();
                output->trigger = snippetTrigger;
            }
            return sendText(engine, content, std::move(output));
        case ContentType::AppleScript:
        case ContentType::ShellScript:
            return runScriptSnippet(engine, *snippet, content, output);
    }
}

void SendingPipeline::sendText(EngineState& engine, const Expansion& content, Output output) {
    output->snippetExpandedContent = content;
    dependencies_.inputService.sendOutput(std::move(output));
    playFeedback(feedbackSound_);
    // Typing goes on behind the expanded text, unless the caret may stand elsewhere. What was typed while a form or a
    // script was busy stands in front of the text.
    engine.setLetters(content->variables.empty() ? content->string() : u"");
}

bool SendingPipeline::undo(EngineState& engine, bool withTrigger) {
    if (!engine.undoInfo()) return false;
    const UndoInformation undo = *engine.undoInfo();
    const std::u16string& text = withTrigger ? undo.textWithTrigger : undo.text;
    const auto output = std::make_shared<PLOutput>();
    output->trigger = SnippetTrigger::HotKey;
    output->backspaceCount = undo.backspaceCount;
    output->snippetExpandedContent = std::make_shared<SnippetExpandedContent>(text);
    dependencies_.inputService.sendOutput(output);
    playFeedback(feedbackSound_);
    engine.setLetters(text);
    engine.setUndoInfo(std::nullopt);
    return true;
}

void SendingPipeline::playFeedback(const std::string& name) const {
    if (playFeedbackSound_ && dependencies_.sounds) dependencies_.sounds->play(name);
}

}  // namespace plume

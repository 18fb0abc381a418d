#include "tests/engine/SendingDesk.h"

#include <algorithm>
#include <utility>

namespace plume {

std::optional<std::u16string> AnsweringRunner::run(std::u16string_view script, bool /*isAppleScript*/) {
    {
        const std::lock_guard lock(mutex_);
        ran_.emplace_back(script);
    }
    return answer(std::u16string(script));
}

std::vector<std::u16string> AnsweringRunner::ran() const {
    const std::lock_guard lock(mutex_);
    return ran_;
}

TestForm::TestForm(std::shared_ptr<SnippetExpandedContent> content, Target& target, std::vector<TestForm*>& open)
    : content_(std::move(content)), target_(target), open_(open) {
    open_.push_back(this);
}

TestForm::~TestForm() {
    std::erase(open_, this);
}

void TestForm::accept(const std::vector<std::u16string>& values) {
    const auto fields = content_->fields();
    for (std::size_t i = 0; i < std::min(fields.size(), values.size()); ++i) fields[i]->value = values[i];
    target_.fieldsEditorWillClose(*this);
    target_.fieldsEditorAction(*this);
}

SendingDesk::SendingDesk()
    : pipeline({service, parser, runner, &sounds,
                [this](std::shared_ptr<SnippetExpandedContent> content, FieldsEditor::Target& target) {
                    return std::make_unique<TestForm>(std::move(content), target, forms);
                },
                [this](const std::string& sentence) { reports.push_back(sentence); }}),
      correction({service, resolver, sources, accessibility, pipeline}),
      engine({service, resolver, sources, defaults, pipeline, suggestionSource, &correction,
              [this] { return makeRecordedList(list); }, [this] { return makeRecordedSearch(search); }}) {
    processes.setFrontProcess(processes.launch(u"org.example.editor"));
    engine.setEnabled(true);
}

std::shared_ptr<Snippet> SendingDesk::add(std::u16string abbreviation, std::u16string content, ExpandTrigger trigger,
                                          ContentType type) {
    const auto group = SnippetGroup::make();
    group->setExpandTrigger(trigger);
    auto snippet = std::make_shared<Snippet>(std::move(abbreviation), std::move(content));
    snippet->setContentType(type);
    group->addItem(snippet);
    AutoText::Groups groups = engine.snippetGroups();
    groups.push_back(group);
    engine.setSnippetGroups(groups);
    return snippet;
}

void SendingDesk::type(std::u16string_view text) {
    for (const char16_t character : text) {
        const std::u16string passed = service.typeText(std::u16string_view(&character, 1));
        screen();
        screen_ += passed;
        loop.runReady();
        screen();
    }
}

bool SendingDesk::undo(bool withTrigger) {
    const bool done = engine.undo(withTrigger);
    screen();
    return done;
}

void SendingDesk::settle() {
    loop.runUntilIdle();
    while (pipeline.hasPendingScripts()) {
        pipeline.waitForScripts();
        loop.runUntilIdle();
    }
    screen();
}

const std::u16string& SendingDesk::screen() {
    for (; outputsOnScreen_ < service.outputs().size(); ++outputsOnScreen_) {
        const PLOutput& output = *service.outputs()[outputsOnScreen_];
        screen_.resize(screen_.size() - std::min<std::size_t>(screen_.size(), output.backspaceCount));
        const auto& content = output.snippetExpandedContent;
        if (content) screen_ += content->string() + content->suffix;
    }
    return screen_;
}

}  // namespace plume

#include "app/ContentPreview.h"

#include <utility>

#include "app/FormModel.h"
#include "content/FieldMerging.h"
#include "content/NestedScripts.h"
#include "content/PLScript.h"
#include "content/SnippetParser.h"

namespace plume {

namespace {

std::u16string inBrackets(const std::optional<std::u16string>& name) {
    return u"[" + name.value_or(u"") + u"]";
}

// As the form shows them at first, with optional ones ticked, so that nothing is left out.
void fillFields(SnippetExpandedContent& content, const std::string& locale) {
    FormModel(content, locale).accept();
    for (const auto& field : content.fields()) {
        field->isSelected = true;
        const bool isEmpty = field->value.value_or(u"").empty() && !field->richTextValue;
        if (isEmpty && !field->script) field->value = inBrackets(field->name);
    }
    mergeFields(content);
}

void nameScripts(SnippetExpandedContent& content) {
    processScripts(content);
    for (const auto& script : content.scripts) {
        const auto& variable = script->snippetVariable;
        const auto snippet = variable ? variable->snippet : nullptr;
        script->result = inBrackets(snippet ? snippet->abbreviationWithPrefix() : std::nullopt);
    }
    mergeScriptResults(content);
}

}  // namespace

const std::u16string& ContentPreview::text() const {
    const auto* rich = std::get_if<AttributedString>(&content);
    return rich ? rich->string() : std::get<std::u16string>(content);
}

std::optional<ContentPreview> previewOf(const std::shared_ptr<Snippet>& snippet, const SnippetGroups& groups,
                                        ContentEnvironment environment, const std::string& locale) {
    environment.report = nullptr;
    const auto content = SnippetParser(std::move(environment)).parseSnippet(snippet, groups);
    if (!content) return std::nullopt;
    fillFields(*content, locale);
    nameScripts(*content);
    return ContentPreview{std::move(content->content), snippet->isScript()};
}

}  // namespace plume

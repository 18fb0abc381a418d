#include "app/form/FormPage.h"

#include <algorithm>
#include <array>
#include <optional>
#include <string_view>
#include <utility>

#include "Foundation/Strings.h"
#include "Foundation/text/HTMLExport.h"
#include "content/SnippetAbbreviationVariable.h"
#include "library/Snippet.h"

namespace plume {

namespace {

// In an attribute's value or an element's text.
std::string escapedForPage(std::u16string_view text) {
    std::string html;
    for (const char c : escapedForHtml(text)) {
        if (c == '\'') {
            html += "&#39;";
        } else {
            html += c;
        }
    }
    return html;
}

bool isSafeLink(const std::u16string& link) {
    constexpr std::array<std::u16string_view, 3> Starts = {u"http:", u"https:", u"mailto:"};
    return std::any_of(Starts.begin(), Starts.end(),
                       [&](std::u16string_view start) { return findIgnoringCase(link, start) == 0; });
}

// Null when the page can show the text as it is.
SharedAttributes attributesForPage(const TextAttributes& look) {
    const bool hasList = look.paragraphStyle && !look.paragraphStyle->textLists.empty();
    const bool hasUnsafeLink = look.link && !isSafeLink(*look.link);
    if (!hasList && !hasUnsafeLink) return nullptr;
    auto changed = std::make_shared<TextAttributes>(look);
    if (hasList) changed->paragraphStyle->textLists.clear();
    if (hasUnsafeLink) changed->link.reset();
    return changed;
}

// Without links that lead anywhere but to a web page or a letter, and without lists: their elements would end before a
// control and put it on a line of its own. The marks of a list's lines are text, and stay.
AttributedString textForPage(const AttributedString& text) {
    AttributedString result;
    std::size_t position = 0;
    for (const AttributedString::Run& run : text.runs()) {
        const SharedAttributes changed = run.attributes ? attributesForPage(*run.attributes) : nullptr;
        result.append(std::u16string_view(text.string()).substr(position, run.length),
                      changed ? changed : run.attributes);
        position += run.length;
    }
    return result;
}

std::string htmlOf(const AttributedString& text) {
    static const std::vector<std::string> excludedTags = {"doctype", "html", "head", "body", "xml", "p"};
    return htmlFromAttributedString(textForPage(text), excludedTags);
}

std::u16string nameOfScript(const SnippetAbbreviationVariable& script) {
    if (!script.snippet) return script.abbreviation.value_or(u"");
    const auto& label = script.snippet->label();
    return label && !label->empty() ? *label : script.snippet->abbreviation().value_or(u"");
}

// `htmlAt` gives the text of a place in the content, `isRich` says whether scripts' names have the look of their place.
template <class HtmlAt>
std::string walk(std::size_t length, bool isRich, const FormPage::Variables& variables,
                 const std::vector<FormModel::Field>& fields, HtmlAt htmlAt) {
    std::string html;
    std::size_t position = 0;
    std::size_t fieldIndex = 0;
    const auto advanceTo = [&](std::size_t location) {
        const std::size_t end = std::min(location, length);
        if (end > position) html += htmlAt(Range{position, end - position});
        position = std::max(position, end);
    };
    for (const auto& variable : variables) {
        if (dynamic_cast<const SnippetFieldVariable*>(variable.get()) != nullptr) {
            advanceTo(variable->location);
            if (fieldIndex < fields.size()) html += FormPage::generateHtmlTextInput(fields[fieldIndex], fieldIndex);
            ++fieldIndex;
        }
        const auto* script = dynamic_cast<const SnippetAbbreviationVariable*>(variable.get());
        if (script == nullptr || script->scriptLength == 0) continue;
        advanceTo(script->location);
        html += R"(<img src="Script.png" alt="Script">)";
        html += htmlOf(AttributedString(nameOfScript(*script), isRich ? script->attributes : nullptr));
        position = std::max(position, std::min(length, script->location + script->scriptLength));
    }
    advanceTo(length);
    return html;
}

std::string attribute(std::string_view name, std::string_view value) {
    return " " + std::string(name) + "=\"" + std::string(value) + "\"";
}

std::string optionsOf(const FormModel::Field& field) {
    std::string html;
    bool hasCurrent = false;
    for (const std::u16string& choice : field.choices) {
        const std::string text = escapedForPage(choice);
        const bool isCurrent = !hasCurrent && choice == field.value;
        hasCurrent = hasCurrent || isCurrent;
        html += R"(<option value=")";
        html += text;
        html += isCurrent ? R"(" selected="selected">)" : R"(">)";
        html += text;
        html += "</option>";
    }
    return html;
}

// `attributes` begins with a space.
std::string textAreaOf(const FormModel::Field& field, const std::string& attributes) {
    // HTML drops a line break at the start.
    const std::string_view start = field.value.starts_with(u'\n') ? "\n" : "";
    return "<textarea" + attributes + attribute("cols", std::to_string(field.variable->width())) +
           attribute("rows", std::to_string(field.variable->height())) +
           R"( onkeypress="return handleKeyUpEventAlt(event);">)" + std::string(start) + escapedForPage(field.value) +
           "</textarea>";
}

std::string inputOf(const FormModel::Field& field, std::string attributes) {
    if (field.variable->isNumber()) {
        attributes += R"( type="number" onchange="window.SnippetController.onTextInputOnChange_(event.target.id);")";
    } else {
        attributes += attribute("type", "text");
        if (!field.value.empty()) attributes += attribute("value", escapedForPage(field.value));
    }
    attributes += attribute("size", std::to_string(field.variable->width()));
    return "<input" + attributes + R"( onkeypress="return handleKeyUpEvent(event);" />)";
}

// Empty for what shows nothing to fill in.
std::string controlOf(const FormModel::Field& field, std::size_t fieldIndex) {
    if (!field.hasControl()) return {};
    const std::string id = attribute("id", std::to_string(fieldIndex));
    if (field.isReadonly()) return "<span" + id + " >" + escapedForPage(field.value) + "</span>";
    const std::string name = escapedForPage(field.variable->name.value_or(u""));
    std::string attributes = id + attribute("placeholder", name) + attribute("name", name);
    if (fieldIndex == 0) attributes += attribute("autofocus", "autofocus");
    if (field.variable->isPopupMenu()) {
        return "<select" + attributes + R"( onkeyup="return handleKeyUpEvent(event);"> )" + optionsOf(field) +
               " </select>";
    }
    return field.variable->isMultiline() ? textAreaOf(field, attributes) : inputOf(field, std::move(attributes));
}

std::string checkBoxOf(const FormModel::Field& field, std::size_t fieldIndex) {
    const std::string id = "optional" + std::to_string(fieldIndex);
    return R"(<input type="checkbox" onchange="optionalFieldCheckboxOnChange(event);" id=")" + id + "\" " +
           (field.selected ? "checked" : "") + "> <label for=\"" + id + "\"> " +
           escapedForPage(field.variable->name.value_or(u"")) + " </label>";
}

}  // namespace

std::string FormPage::generateHtml(const SnippetExpandedContent& content, const FormModel& model) {
    if (const auto* rich = std::get_if<AttributedString>(&content.content)) {
        return generateHtmlWithAttributedString(*rich, content.variables, model.fields());
    }
    return generateHtmlWithString(content.string(), content.variables, model.fields());
}

std::string FormPage::generateHtmlWithAttributedString(const AttributedString& text, const Variables& variables,
                                                       const std::vector<FormModel::Field>& fields) {
    return walk(text.length(), true, variables, fields, [&](Range range) { return htmlOf(text.substring(range)); });
}

std::string FormPage::generateHtmlWithString(const std::u16string& text, const Variables& variables,
                                             const std::vector<FormModel::Field>& fields) {
    return walk(text.size(), false, variables, fields,
                [&](Range range) { return htmlOf(AttributedString(text.substr(range.location, range.length))); });
}

std::string FormPage::generateHtmlTextInput(const FormModel::Field& field, std::size_t fieldIndex) {
    std::string control = controlOf(field, fieldIndex);
    if (control.empty() || !field.variable->isOptional) return control;
    const std::string colour = field.selected ? "limegreen" : "crimson";
    if (field.variable->isMultiline()) {
        return checkBoxOf(field, fieldIndex) + " <div style=\"background-color: " + colour + ";\"> " + control +
               " </div>";
    }
    return checkBoxOf(field, fieldIndex) + " <span style=\"background-color: " + colour +
           "; margin-top:50px; margin-bottom:50px; padding: 5px\"> " + control + " </span>";
}

bool FormPage::needsPaper(const SnippetExpandedContent& content) {
    const auto* rich = std::get_if<AttributedString>(&content.content);
    return rich != nullptr && std::any_of(rich->runs().begin(), rich->runs().end(), [](const auto& run) {
               return run.attributes && (run.attributes->foregroundColor || run.attributes->backgroundColor);
           });
}

}  // namespace plume

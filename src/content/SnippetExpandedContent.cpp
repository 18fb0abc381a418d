#include "content/SnippetExpandedContent.h"

#include <algorithm>
#include <utility>

#include "content/ExpansionContext.h"

namespace plume {

namespace {

template <class Variable>
std::vector<std::shared_ptr<Variable>> variablesOfKind(const SnippetExpandedContent& content) {
    std::vector<std::shared_ptr<Variable>> result;
    for (const auto& variable : content.variables) {
        if (auto match = std::dynamic_pointer_cast<Variable>(variable)) result.push_back(std::move(match));
    }
    return result;
}

// Whether a variable of the kind meets the condition.
template <class Variable, class Condition>
bool hasVariable(const SnippetExpandedContent& content, Condition condition) {
    return std::any_of(content.variables.begin(), content.variables.end(), [&](const auto& variable) {
        const auto* match = dynamic_cast<const Variable*>(variable.get());
        return match != nullptr && condition(*match);
    });
}

template <class Variable>
bool hasVariable(const SnippetExpandedContent& content) {
    return hasVariable<Variable>(content, [](const Variable&) { return true; });
}

// The last caret in the list, or null.
const SnippetContentCaret* lastCaret(const SnippetExpandedContent& content) {
    for (auto variable = content.variables.rbegin(); variable != content.variables.rend(); ++variable) {
        if (const auto* caret = dynamic_cast<const SnippetContentCaret*>(variable->get())) return caret;
    }
    return nullptr;
}

}  // namespace

const std::u16string& SnippetExpandedContent::string() const {
    if (const auto* rich = std::get_if<AttributedString>(&content)) return rich->string();
    return std::get<std::u16string>(content);
}

std::vector<std::shared_ptr<SnippetFieldVariable>> SnippetExpandedContent::fields() const {
    return variablesOfKind<SnippetFieldVariable>(*this);
}

std::vector<std::shared_ptr<SnippetKeyVariable>> SnippetExpandedContent::keys() const {
    return variablesOfKind<SnippetKeyVariable>(*this);
}

std::vector<std::shared_ptr<SnippetAbbreviationVariable>> SnippetExpandedContent::abbreviations() const {
    return variablesOfKind<SnippetAbbreviationVariable>(*this);
}

bool SnippetExpandedContent::hasCaret() const {
    return hasVariable<SnippetContentCaret>(*this);
}

bool SnippetExpandedContent::hasCaretLocationOrKeys() const {
    return hasCaret() || hasVariable<SnippetKeyVariable>(*this);
}

bool SnippetExpandedContent::hasCaretLocationOrArrowKeys() const {
    return hasCaret() ||
           hasVariable<SnippetKeyVariable>(*this, [](const SnippetKeyVariable& key) { return key.isArrow(); });
}

bool SnippetExpandedContent::hasCaretOrFields() const {
    return hasCaret() || hasVariable<SnippetFieldVariable>(*this);
}

bool SnippetExpandedContent::hasDelayedKey() const {
    return hasVariable<SnippetKeyVariable>(*this, [](const SnippetKeyVariable& key) { return key.delay > 0; });
}

std::int64_t SnippetExpandedContent::caretLocation() const {
    const SnippetContentCaret* caret = lastCaret(*this);
    std::int64_t location = caret != nullptr ? static_cast<std::int64_t>(caret->location) : -1;
    for (const auto& key : keys()) {
        if (key->isReturnOrTab()) ++location;
    }
    return location;
}

std::int64_t SnippetExpandedContent::caretDistanceFromEnding() const {
    std::uint64_t typed = 0;  // by the keys behind the caret
    for (auto variable = variables.rbegin(); variable != variables.rend(); ++variable) {
        if (const auto* caret = dynamic_cast<const SnippetContentCaret*>(variable->get())) {
            return static_cast<std::int64_t>(string().size() + typed - caret->location);
        }
        const auto* key = dynamic_cast<const SnippetKeyVariable*>(variable->get());
        if (key != nullptr && key->movesCaret()) typed += key->count;
    }
    return 0;
}

std::int64_t SnippetExpandedContent::caretDistanceFromEndingIgnoreKeys() const {
    const SnippetContentCaret* caret = lastCaret(*this);
    return caret != nullptr ? static_cast<std::int64_t>(string().size() - caret->location) : 0;
}

std::vector<DeliveryStep> SnippetExpandedContent::deliverySteps() const {
    const std::size_t textLength = string().size();
    std::vector<DeliveryStep> steps;
    std::size_t left = std::max(ExpansionContext::MaximumLength, textLength);
    std::size_t position = 0;
    const auto addUpTo = [&](std::size_t end, std::shared_ptr<SnippetKeyVariable> key) {
        const std::size_t length = std::min(end > position ? end - position : 0, left);
        steps.push_back({{position, length}, std::move(key)});
        left -= length;
        position = end;
    };
    for (const auto& key : keys()) addUpTo(std::min(key->location, textLength), key);
    addUpTo(textLength, nullptr);
    return steps;
}

std::u16string SnippetExpandedContent::copyString() const {
    const std::u16string& text = string();
    std::u16string result;
    for (const DeliveryStep& step : deliverySteps()) {
        result.append(text, step.text.location, step.text.length);
        if (step.key && step.key->isReturnOrTab()) result.push_back(u' ');
    }
    return result;
}

void SnippetExpandedContent::applySuffix() {
    if (suffix.empty()) return;
    if (auto* rich = std::get_if<AttributedString>(&content)) {
        rich->append(suffix);
    } else {
        std::get<std::u16string>(content).append(suffix);
    }
}

}  // namespace plume

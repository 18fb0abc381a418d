#include "app/FormModel.h"

#include <algorithm>
#include <utility>

#include "Foundation/Strings.h"
#include "input/delivery/StepCounts.h"

namespace plume {

namespace {

bool hasChoice(const FormModel::Field& field, const std::u16string& value) {
    return std::find(field.choices.begin(), field.choices.end(), value) != field.choices.end();
}

FormModel::Field fieldFor(const std::shared_ptr<SnippetFieldVariable>& variable) {
    FormModel::Field field{variable, variable->value.value_or(u""), {}, variable->isSelected};
    if (!variable->isPopupMenu() || field.value.empty()) return field;
    field.choices = split(field.value, u'\n');
    const auto last = static_cast<std::int64_t>(field.choices.size()) - 1;
    const std::int64_t index = std::clamp<std::int64_t>(variable->defaultIndex, 0, last);
    field.value = field.choices[static_cast<std::size_t>(index)];
    return field;
}

}  // namespace

bool FormModel::Field::hasControl() const {
    return variable->isSingleline() || variable->isMultiline() || variable->isNumber() || !choices.empty();
}

FormModel::FormModel(const SnippetExpandedContent& content, const std::string& locale)
    : isRich_(content.isRich()), decimals_(locale), text_(content) {
    for (const auto& variable : content.fields()) fields_.push_back(fieldFor(variable));
    collectNumbers();
    numbers_.evaluateAll();
    showNumbers();
}

void FormModel::collectNumbers() {
    for (std::size_t index = 0; index < fields_.size(); ++index) {
        Field& field = fields_[index];
        if (!field.variable->isNumber()) continue;
        auto given = givenNumber(field.value);
        const bool isFormula = !given && !trimmed(field.value).empty();
        const std::u16string name = field.variable->name.value_or(u"");
        if (MathExpressionParser::isValidMathVariableName(name)) {
            const bool saysNothing = !given && !isFormula;
            if (saysNothing && numbers_.find(name) != nullptr) continue;
            numbers_.add(name, std::move(given), isFormula ? field.value : std::u16string());
        } else if (isFormula) {
            uncomputed_.insert(index);
            field.value.clear();
        }
    }
}

std::optional<FormNumbers::Given> FormModel::givenNumber(const std::u16string& text) const {
    const auto number = decimals_.read(text);
    if (!number) return std::nullopt;
    return FormNumbers::Given{number->value, shownNumber(fromUtf8(number->plain))};
}

const FormNumbers::Number* FormModel::numberOf(const Field& field) const {
    return numbers_.find(field.variable->name.value_or(u""));
}

FormModel::Problem FormModel::problem(std::size_t index) const {
    const Field& field = fields_[index];
    if (!field.variable->isNumber()) return Problem::None;
    const FormNumbers::Number* number = numberOf(field);
    if (number != nullptr && !number->isGiven) return number->problem;
    if (uncomputed_.contains(index)) return Problem::UnreadableFormula;
    return trimmed(field.value).empty() || decimals_.read(field.value) ? Problem::None : Problem::NoNumber;
}

Result<void> FormModel::fill(std::size_t index, const std::u16string& value) {
    Field& field = fields_[index];
    if (field.isReadonly()) return Error{"the field can only be read"};
    if (!field.hasControl()) return Error{"the field shows nothing to fill in"};
    if (field.variable->isPopupMenu() && !hasChoice(field, value)) {
        return Error{"the menu has no line \"" + toUtf8(value) + "\""};
    }
    field.value = value;
    if (field.variable->isOptional) field.selected = true;
    uncomputed_.erase(index);
    shareValue(index);
    numberChanged(field);
    return {};
}

// With the fields of the same name, as far as they can show it.
void FormModel::shareValue(std::size_t index) {
    const std::u16string name = fields_[index].variable->name.value_or(u"");
    if (name.empty()) return;
    const std::u16string value = fields_[index].value;
    for (std::size_t other = 0; other < fields_.size(); ++other) {
        Field& field = fields_[other];
        if (field.variable->name != name) continue;
        if (field.variable->isPopupMenu() && !hasChoice(field, value)) continue;
        field.value = value;
        uncomputed_.erase(other);
    }
}

void FormModel::numberChanged(const Field& field) {
    if (numberOf(field) == nullptr) return;
    numbers_.setValue(*field.variable->name, givenNumber(field.value));
    showNumbers();
}

// Text that is no number stays where it was typed.
void FormModel::showNumbers() {
    for (Field& field : fields_) {
        if (!field.variable->isNumber() && !field.variable->isSingleline()) continue;
        const FormNumbers::Number* number = numberOf(field);
        if (number == nullptr || field.isReadonly()) continue;
        if (number->isGiven) {
            if (number->value) field.value = number->shown;
        } else {
            field.value = number->value ? decimals_.written(*number->value) : std::u16string();
        }
    }
}

std::u16string FormModel::plainNumber(const std::u16string& shown) const {
    const auto number = decimals_.read(shown);
    return number ? fromUtf8(number->plain) : shown;
}

std::u16string FormModel::shownNumber(const std::u16string& plain) const {
    return decimals_.written(plain).value_or(plain);
}

std::u16string FormModel::text() const {
    return text_.with([this](std::size_t index) { return deliveredValue(fields_[index]); });
}

std::size_t FormModel::length() const {
    return leftArrowsFor(text());
}

// As accept() hands it over, and as it is put into the content.
std::u16string_view FormModel::deliveredValue(const Field& field) const {
    const SnippetFieldVariable& variable = *field.variable;
    const std::u16string_view given = variable.value ? *variable.value : std::u16string_view();
    const bool isUntouched = !field.hasControl() || field.value == given;
    if (isRich_ && variable.richTextValue && isUntouched) return variable.richTextValue->string();
    if (variable.script || (variable.isOptional && !field.selected)) return {};
    return field.hasControl() ? field.value : given;
}

bool FormModel::runsScripts() const {
    const auto runs = [this](const std::shared_ptr<SnippetAbbreviationVariable>& script) {
        const auto tick = std::find_if(fields_.begin(), fields_.end(),
                                       [&](const Field& field) { return field.variable->script == script; });
        return !script->isOptional || (tick == fields_.end() ? script->isSelected : tick->selected);
    };
    return text_.isScript() || std::any_of(text_.scripts().begin(), text_.scripts().end(), runs);
}

void FormModel::accept() const {
    for (const Field& field : fields_) {
        if (field.hasControl()) {
            // What was typed has no look of its own, and comes before what stood there.
            if (field.value != field.variable->value.value_or(u"")) field.variable->richTextValue.reset();
            field.variable->value = field.value;
        }
        field.variable->isSelected = field.selected;
    }
}

}  // namespace plume

#include "app/FormModel.h"

#include <unicode/unum.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <utility>

#include "Foundation/CharacterSet.h"
#include "Foundation/Strings.h"
#include "Foundation/UserLocale.h"

namespace plume {

namespace {

using NumberFormat = std::unique_ptr<UNumberFormat, void (*)(UNumberFormat*)>;

NumberFormat decimalFormat(const std::string& locale) {
    UErrorCode status = U_ZERO_ERROR;
    const std::string name = locale.empty() ? userLocale(LocaleCategory::Numbers) : locale;
    UNumberFormat* format = unum_open(UNUM_DECIMAL, nullptr, 0, name.c_str(), nullptr, &status);
    unum_setAttribute(format, UNUM_GROUPING_USED, 0);
    return {format, [](UNumberFormat* opened) { unum_close(opened); }};
}

bool isWordUnit(char16_t unit) {
    return unit == u'_' || CharacterSet::letters().contains(unit) || CharacterSet::decimalDigits().contains(unit);
}

std::set<std::u16string> wordsOf(const std::u16string& text) {
    std::set<std::u16string> words;
    std::u16string word;
    for (const char16_t unit : text + u" ") {
        if (isWordUnit(unit)) {
            word += unit;
        } else if (!word.empty()) {
            words.insert(std::exchange(word, {}));
        }
    }
    return words;
}

}  // namespace

bool FormModel::Field::hasControl() const {
    return variable->isSingleline() || variable->isMultiline() || variable->isNumber() || !choices.empty();
}

FormModel::FormModel(const SnippetExpandedContent& content, std::string locale) : locale_(std::move(locale)) {
    for (const auto& variable : content.fields()) {
        Field field{variable, variable->value.value_or(u""), {}, variable->isSelected};
        if (variable->isPopupMenu() && !field.value.empty()) {
            field.choices = split(field.value, u'\n');
            const auto last = static_cast<std::int64_t>(field.choices.size()) - 1;
            const std::int64_t index = std::clamp<std::int64_t>(variable->defaultIndex, 0, last);
            field.value = field.choices[static_cast<std::size_t>(index)];
        }
        fields_.push_back(std::move(field));
    }
    collectNumbers();
    findDependencies();
    std::set<std::u16string> pending;
    for (const auto& [name, number] : numbers_) {
        if (!number.value) pending.insert(name);
    }
    evaluate(std::move(pending));
    showNumbers();
}

void FormModel::collectNumbers() {
    for (const Field& field : fields_) {
        const std::u16string name = field.variable->name.value_or(u"");
        if (!field.variable->isNumber() || !MathExpressionParser::isValidMathVariableName(name)) continue;
        Number& number = numbers_[name];
        number.value = numberIn(field.value);
        number.expression = number.value ? std::u16string() : field.value;
        if (number.value) parser_.setSymbolValue(*number.value, name);
    }
}

void FormModel::findDependencies() {
    for (auto& [name, number] : numbers_) {
        for (const std::u16string& word : wordsOf(number.expression)) {
            if (word != name && numbers_.contains(word)) number.dependedVariableNames.insert(word);
        }
    }
}

// Formulas whose names depend on each other in a circle stay without a value.
void FormModel::evaluate(std::set<std::u16string> pending) {
    const auto isReady = [&](const std::u16string& name) {
        const auto& needed = numbers_.at(name).dependedVariableNames;
        return std::none_of(needed.begin(), needed.end(), [&](const std::u16string& other) {
            return pending.contains(other) || !numbers_.at(other).value;
        });
    };
    for (auto next = pending.begin(); next != pending.end();) {
        const std::u16string name = *next;
        if (!isReady(name)) {
            ++next;
            continue;
        }
        pending.erase(name);
        Number& number = numbers_.at(name);
        try {
            if (!number.expression.empty()) number.value = parser_.evaluate(number.expression);
            if (number.value) parser_.setSymbolValue(*number.value, name);
        } catch (const MathExpressionError&) {
            // A formula that cannot be read has no value, and neither has what needs it.
            number.value.reset();
        }
        next = pending.begin();
    }
}

Result<void> FormModel::fill(std::size_t index, const std::u16string& value) {
    Field& field = fields_[index];
    if (field.isReadonly()) return Error{"the field can only be read"};
    if (!field.hasControl()) return Error{"the field shows nothing to fill in"};
    if (field.variable->isPopupMenu() &&
        std::find(field.choices.begin(), field.choices.end(), value) == field.choices.end()) {
        return Error{"the menu has no line \"" + toUtf8(value) + "\""};
    }
    field.value = value;
    if (field.variable->isOptional) field.selected = true;
    const std::u16string name = field.variable->name.value_or(u"");
    if (!name.empty() && !field.variable->isPopupMenu()) {
        for (Field& other : fields_) {
            if (other.variable->name == name && !other.variable->isPopupMenu()) other.value = value;
        }
    }
    if (field.variable->isNumber()) numberChanged(field);
    return {};
}

void FormModel::numberChanged(const Field& field) {
    const auto changed = numbers_.find(field.variable->name.value_or(u""));
    const std::optional<double> value = numberIn(field.value);
    if (changed == numbers_.end() || !value) return;
    changed->second.value = value;
    parser_.setSymbolValue(*value, changed->first);

    // Everything that follows from it, directly or through others.
    std::set<std::u16string> followers{changed->first};
    for (std::size_t known = 0; known != followers.size();) {
        known = followers.size();
        for (const auto& [name, number] : numbers_) {
            const auto& needed = number.dependedVariableNames;
            if (std::any_of(needed.begin(), needed.end(), [&](const auto& n) { return followers.contains(n); })) {
                followers.insert(name);
            }
        }
    }
    followers.erase(changed->first);
    evaluate(std::move(followers));
    showNumbers();
}

void FormModel::showNumbers() {
    for (Field& field : fields_) {
        if (!field.variable->isNumber() && !field.variable->isSingleline()) continue;
        const auto number = numbers_.find(field.variable->name.value_or(u""));
        if (number == numbers_.end() || field.isReadonly()) continue;
        field.value = number->second.value ? textOf(*number->second.value) : std::u16string();
    }
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

std::optional<double> FormModel::numberIn(const std::u16string& text) const {
    const std::u16string_view digits = trimmed(text);
    UErrorCode status = U_ZERO_ERROR;
    std::int32_t end = 0;
    const auto length = static_cast<std::int32_t>(digits.size());
    const double number = unum_parseDouble(decimalFormat(locale_).get(), digits.data(), length, &end, &status);
    if (U_FAILURE(status) || end != length || digits.empty()) return std::nullopt;
    return number;
}

std::u16string FormModel::textOf(double number) const {
    std::array<char16_t, 400> text{};
    UErrorCode status = U_ZERO_ERROR;
    const std::int32_t length = unum_formatDouble(decimalFormat(locale_).get(), number, text.data(),
                                                  static_cast<std::int32_t>(text.size()), nullptr, &status);
    if (U_FAILURE(status)) return {};
    return {text.data(), static_cast<std::size_t>(length)};
}

}  // namespace plume

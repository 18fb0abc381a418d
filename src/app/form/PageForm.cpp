#include "app/form/PageForm.h"

#include <algorithm>
#include <type_traits>
#include <utility>

#include "app/form/FormWords.h"
#include "app/qt/Text.h"

namespace plume {

namespace {

// What of `now` is not shown yet.
ShownField changesBetween(const ShownField& shown, const ShownField& now) {
    ShownField changes = now;
    if (now.value == shown.value) changes.value.reset();
    if (now.choice == shown.choice) changes.choice.reset();
    if (now.selected == shown.selected) changes.selected.reset();
    if (now.problem == shown.problem) changes.problem.reset();
    return changes;
}

bool saysNothing(const ShownField& field) {
    return !field.value && !field.choice && !field.selected && !field.problem;
}

// As the page writes numbers; what is read only is text there.
bool isNumberInput(const FormModel::Field& field) {
    return field.variable->isNumber() && !field.isReadonly();
}

}  // namespace

PageForm::PageForm(FormNumber number, const FormModel& model, Events events, Program program)
    : number_(number),
      model_(model),
      events_(std::move(events)),
      program_(std::move(program)),
      shown_(model.fields().size()),
      unreadable_(model.fields().size()) {}

void PageForm::show(const FormPlace& place) {
    program_.send(ShowForm{number_, place});
}

void PageForm::update() {
    UpdateForm order{number_, {}, {}};
    for (std::size_t index = 0; index < shown_.size(); ++index) {
        const ShownField now = fieldNow(index);
        ShownField changes = changesBetween(shown_[index], now);
        if (!saysNothing(changes)) order.fields.push_back(std::move(changes));
        shown_[index] = now;
    }
    const QString length = lengthLine(model_);
    if (length != length_) order.length = length_ = length;
    if (order.length || !order.fields.empty()) program_.send(order);
}

ShownField PageForm::fieldNow(std::size_t index) const {
    const FormModel::Field& field = model_.fields()[index];
    ShownField now{.index = static_cast<std::int64_t>(index), .value = {}, .choice = {}, .selected = {}, .problem = {}};
    if (!field.hasControl()) return now;
    if (!field.choices.empty()) {
        now.choice = std::ranges::find(field.choices, field.value) - field.choices.begin();
    } else {
        now.value = toQString(isNumberInput(field) ? model_.plainNumber(field.value) : field.value);
    }
    if (field.variable->isOptional) now.selected = field.selected;
    now.problem = wordsFor(unreadable_[index] ? FormModel::Problem::NoNumber : model_.problem(index));
    return now;
}

// ---- What the program says ----

bool PageForm::take(const FormReport& report) {
    return std::visit(
        [this](const auto& each) {
            // That is said of the program, and not of a form.
            if constexpr (std::is_same_v<decltype(each), const FormsReady&>)
                return false;
            else
                return heard(each);
        },
        report);
}

bool PageForm::isField(std::int64_t index) const {
    return std::cmp_less(index, shown_.size()) && model_.fields()[static_cast<std::size_t>(index)].hasControl();
}

bool PageForm::heard(const FormShown& report) {
    if (events_.shown) events_.shown(report.window);
    return true;
}

bool PageForm::heard(const FormFilled& report) {
    const auto value = takeValue(report);
    if (!value) return false;
    if (events_.filled) events_.filled(static_cast<std::size_t>(report.field), *value);
    return true;
}

std::optional<std::u16string> PageForm::takeValue(const FormFilled& report) {
    if (!isField(report.field)) return std::nullopt;
    const auto index = static_cast<std::size_t>(report.field);
    const FormModel::Field& field = model_.fields()[index];
    if (field.isReadonly()) return std::nullopt;
    if (!field.choices.empty()) {
        if (!report.choice || std::cmp_greater_equal(*report.choice, field.choices.size())) return std::nullopt;
        shown_[index].choice = report.choice;
        return field.choices[static_cast<std::size_t>(*report.choice)];
    }
    shown_[index].value = report.value;
    unreadable_[index] = report.isUnreadable && isNumberInput(field);
    const std::u16string value = fromQString(report.value);
    return isNumberInput(field) ? model_.shownNumber(value) : value;
}

bool PageForm::heard(const FormSelected& report) {
    if (!isField(report.field)) return false;
    const auto index = static_cast<std::size_t>(report.field);
    if (!model_.fields()[index].variable->isOptional) return false;
    shown_[index].selected = report.selected;
    if (events_.selected) events_.selected(index, report.selected);
    return true;
}

bool PageForm::heard(const FormAccepted& /*report*/) {
    // Who is told may end this form.
    const auto accepted = events_.accepted;
    if (accepted) accepted();
    return true;
}

bool PageForm::heard(const FormCancelled& /*report*/) {
    const auto cancelled = events_.cancelled;
    if (cancelled) cancelled();
    return true;
}

bool PageForm::heard(const FormStayed& /*report*/) {
    if (events_.stayed) events_.stayed();
    return true;
}

bool PageForm::heard(const FormSized& report) {
    size_ = report.size;
    return true;
}

}  // namespace plume

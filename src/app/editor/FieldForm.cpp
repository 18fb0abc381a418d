#include "app/editor/FieldForm.h"

#include <QCheckBox>
#include <QComboBox>
#include <QFormLayout>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QSignalBlocker>
#include <QSpinBox>
#include <algorithm>
#include <utility>

#include "Foundation/Strings.h"
#include "app/FirstLine.h"
#include "app/editor/FormControls.h"
#include "app/qt/Text.h"
#include "app/qt/WheelGuard.h"
#include "app/search/SnippetRow.h"

namespace plume {

namespace {

constexpr std::int64_t LargestSize = 1000;  // letters or lines

template <class Field>
void showText(Field& field, const QString& text) {
    const QSignalBlocker silent(&field);
    if constexpr (std::is_same_v<Field, QLineEdit>) {
        field.setText(text);
    } else {
        field.setPlainText(text);
    }
}

}  // namespace

FieldForm::FieldForm(ChipFormServices services, std::shared_ptr<SnippetFieldVariable> variable)
    : ChipForm(tr("Field of the Form"), std::move(services), variable), variable_(std::move(variable)) {
    QLineEdit* name = makeLine(variable_->name, [this](std::u16string text) {
        variable_->name = std::move(text);
        changed();
    });
    rows().addRow(tr("&Name:"), name);
    addKindRow();
    addValueRows();
    addSizeRows();
    isReadonly_ = makeTick(tr("Cannot be &edited in the form"), variable_->isReadonly, [this](bool isOn) {
        variable_->isReadonly = isOn;
        changed();
    });
    rows().addRow(QString(), isReadonly_);
    addOptionalRow();
    showKind();
    name->selectAll();
}

void FieldForm::addKindRow() {
    const auto number = [](FieldType type) { return static_cast<std::int64_t>(type); };
    const Choices kinds{{number(FieldType::Singleline), tr("Text in one line")},
                        {number(FieldType::Multiline), tr("Text in several lines")},
                        {number(FieldType::PopupMenu), tr("Menu to choose from")},
                        {number(FieldType::Number), tr("Number, which can be calculated")}};
    QComboBox* kind = makeChoice(kinds, number(variable_->type), tr("Unknown kind %1"), [this](std::int64_t chosen) {
        variable_->type = static_cast<FieldType>(chosen);
        showKind();
        changed();
    });
    rows().addRow(tr("&Kind:"), kind);
}

void FieldForm::addValueRows() {
    const auto edited = [this](std::u16string value) { valueEdited(std::move(value)); };
    line_ = makeLine(variable_->value, edited);
    lines_ = makeLines(variable_->value, edited);
    items_ = makeLines(variable_->value, edited);
    first_ = new QComboBox;
    first_->setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
    first_->setMinimumContentsLength(12);
    ignoreWheelWithoutFocus(*first_);
    rows().addRow(tr("&Begins with:"), line_);
    rows().addRow(tr("&Begins with:"), lines_);
    rows().addRow(tr("C&hoices, one a line:"), items_);
    rows().addRow(tr("Chosen at f&irst:"), first_);
    connect(first_, &QComboBox::activated, this, [this](int index) {
        if (index == variable_->defaultIndex) return;
        variable_->defaultIndex = index;
        changed();
    });
}

void FieldForm::addSizeRows() {
    const auto make = [this](std::int64_t size, void (SnippetFieldVariable::*set)(std::int64_t)) {
        QSpinBox* number = makeNumber(size, 0, LargestSize, [this, set](std::int64_t value) {
            (*variable_.*set)(value);
            changed();
        });
        number->setSpecialValueText(tr("As usual"));
        return number;
    };
    width_ = make(variable_->hasWidth() ? variable_->width() : 0, &SnippetFieldVariable::setWidth);
    height_ = make(variable_->hasHeight() ? variable_->height() : 0, &SnippetFieldVariable::setHeight);
    rows().addRow(tr("&Width in letters:"), width_);
    rows().addRow(tr("Hei&ght in lines:"), height_);
}

void FieldForm::showKind() {
    const bool isMenu = variable_->isPopupMenu();
    const bool isMultiline = variable_->isMultiline();
    const QString value = toQString(variable_->value.value_or(u""));
    showText(*line_, value);
    showText(*lines_, value);
    showText(*items_, value);
    rows().setRowVisible(line_, !isMenu && !isMultiline);
    rows().setRowVisible(lines_, isMultiline);
    rows().setRowVisible(items_, isMenu);
    rows().setRowVisible(first_, isMenu);
    rows().setRowVisible(width_, variable_->canSetWidth());
    rows().setRowVisible(height_, variable_->canSetHeight());
    rows().setRowVisible(isReadonly_, variable_->canSetReadonly());
    fillFirstChoices();
    fitToRows();
}

void FieldForm::valueEdited(std::u16string value) {
    variable_->value = std::move(value);
    fillFirstChoices();
    changed();
}

std::vector<std::u16string> FieldForm::choices() const {
    const std::u16string value = variable_->value.value_or(u"");
    return value.empty() ? std::vector<std::u16string>() : split(value, u'\n');
}

// The form begins with the last choice when there are fewer.
void FieldForm::fillFirstChoices() {
    first_->clear();
    for (const std::u16string& choice : choices()) first_->addItem(inOneLine(choice));
    const std::int64_t last = std::max(first_->count() - 1, 0);
    first_->setCurrentIndex(static_cast<int>(std::clamp<std::int64_t>(variable_->defaultIndex, 0, last)));
    first_->setEnabled(first_->count() > 0);
}

ChipForm::Shown FieldForm::shown() const {
    const QString name = toQString(variable_->name.value_or(u""));
    const QString noName = name.isEmpty() ? tr("Without a name the form does not say what is asked for.") : QString();
    if (variable_->isPopupMenu()) {
        const bool isEmpty = first_->count() == 0;
        if (isEmpty) return {tr("Gives: nothing"), tr("A menu without choices is not shown in the form.")};
        return {tr("Gives at first: %1").arg(first_->currentText()), noName};
    }
    const std::u16string value = variable_->value.value_or(u"");
    if (value.empty()) return {tr("Gives: what is typed in the form"), noName};
    return {tr("Gives at first: %1").arg(inOneLine(firstLine(value))), noName};
}

}  // namespace plume

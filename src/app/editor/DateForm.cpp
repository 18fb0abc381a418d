#include "app/editor/DateForm.h"

#include <QComboBox>
#include <QFormLayout>
#include <QLocale>
#include <utility>

#include "app/qt/Text.h"

namespace plume {

namespace {

using ValueType = SnippetDateVariable::ValueType;

}  // namespace

DateForm::DateForm(ChipFormServices services, std::shared_ptr<SnippetDateVariable> variable)
    : DateTimeForm(tr("Date"), std::move(services), variable, DateTextKind::DayOnly), variable_(std::move(variable)) {
    addFormatRows();
    addDayRows();
    addLocaleRow();
    addOptionalRow();
}

void DateForm::addDayRows() {
    const Choices days{{static_cast<std::int64_t>(ValueType::Offset), tr("From today")},
                       {static_cast<std::int64_t>(ValueType::NextWeekday), tr("The next weekday of this name")},
                       {static_cast<std::int64_t>(ValueType::PreviousWeekday), tr("The last weekday of this name")}};
    QComboBox* day = makeChoice(days, static_cast<std::int64_t>(variable_->valueType),
                                tr("The last weekday of this name (%1)"), [this](std::int64_t type) {
                                    variable_->valueType = static_cast<ValueType>(type);
                                    showDayRows();
                                    changed();
                                });
    offsets_ = makeRow({makeOffset(variable_->year, tr("Years:"), tr("Years added")),
                        makeOffset(variable_->month, tr("Months:"), tr("Months added")),
                        makeOffset(variable_->day, tr("Days:"), tr("Days added"))});
    weekday_ = makeChoice(weekdays(), variable_->weekday, tr("Weekday %1"), [this](std::int64_t weekday) {
        variable_->weekday = weekday;
        changed();
    });
    rows().addRow(tr("D&ay:"), day);
    rows().addRow(tr("Added:"), offsets_);
    rows().addRow(tr("&Weekday:"), weekday_);
    showDayRows();
}

void DateForm::showDayRows() {
    rows().setRowVisible(offsets_, variable_->valueIsToday());
    rows().setRowVisible(weekday_, !variable_->valueIsToday());
    fitToRows();
}

Choices DateForm::weekdays() const {
    constexpr int DaysOfWeek = 7;
    Choices choices;
    for (int day = 0; day < DaysOfWeek; ++day) {
        // Qt counts from Monday as 1, the placeholder from Sunday as 0.
        choices.emplace_back(day, locale().standaloneDayName(day == 0 ? DaysOfWeek : day));
    }
    return choices;
}

}  // namespace plume

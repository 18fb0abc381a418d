// The form of a date: its style or pattern, which day it is, and its language.
//
// On the main thread; owns itself as every form does.
#pragma once

#include "app/editor/DateTimeForm.h"

namespace plume {

class DateForm final : public DateTimeForm {
    Q_OBJECT
  public:
    DateForm(ChipFormServices services, std::shared_ptr<SnippetDateVariable> variable);

  private:
    void addDayRows();
    // Those that count for the kind of day that is chosen.
    void showDayRows();
    Choices weekdays() const;

    const std::shared_ptr<SnippetDateVariable> variable_;
    QWidget* offsets_ = nullptr;
    QWidget* weekday_ = nullptr;
};

}  // namespace plume

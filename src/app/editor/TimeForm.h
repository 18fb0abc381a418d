// The form of a time: its style or pattern, how far from now it is, and its language.
//
// On the main thread; owns itself as every form does.
#pragma once

#include "app/editor/DateTimeForm.h"

namespace plume {

class TimeForm final : public DateTimeForm {
    Q_OBJECT
  public:
    TimeForm(ChipFormServices services, const std::shared_ptr<SnippetTimeVariable>& variable);
};

}  // namespace plume

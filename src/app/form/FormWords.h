// What forms say, in the user's language, whatever draws them.
//
// On the main thread.
#pragma once

#include <QString>

#include "app/FormModel.h"

namespace plume {

// What stands beside a field with this problem; empty when there is none.
QString wordsFor(FormModel::Problem problem);
// The live line: how long the text is, and whether scripts add to it.
QString lengthLine(const FormModel& model);
// Which keys do what.
QString hintLine(const FormModel& model);
// Of the buttons.
QString insertLabel();
QString cancelLabel();

}  // namespace plume

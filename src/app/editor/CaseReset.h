// The question with which letter case all snippets of a group are to expand.
//
// Main thread. The sheet owns itself, and goes with its parent.
#pragma once

#include <QDialog>
#include <functional>

#include "library/Snippet.h"

class QWidget;

namespace plume {

// In the order of CaseSensitivity.
QStringList caseSensitivityNames();

// Nothing but that window is held up. `chosen` is called when "Reset" is; `suggested` is what is chosen at first.
QDialog* askForCaseReset(QWidget* parent, CaseSensitivity suggested,
                         const std::function<void(CaseSensitivity value)>& chosen);

}  // namespace plume

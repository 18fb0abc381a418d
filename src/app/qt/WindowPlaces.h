// Where windows stood when they were closed, kept with the user's settings.
#pragma once

#include "platform/UserDefaults.h"

class QWidget;

namespace plume {

// The window opens where it was closed last, on a screen that is there, and what it is closed at is kept. `name` tells
// windows apart. Before the window is shown; the settings outlive it.
void rememberPlace(QWidget& window, WritableUserDefaults& settings, const char* name);

}  // namespace plume

// Light or dark, as the desktop wants it, also when it changes its mind.
#pragma once

#include <memory>

#include "app/qt/ColorSchemePortal.h"

namespace plume {

// Gives the application the colours of the desktop's settings portal, and follows it as long as the result lives. Where
// there is none, the environment's "GTK_THEME" counts; else it is light. Once, on the main thread, before the first
// window.
[[nodiscard]] std::unique_ptr<ColorSchemePortal> followColorScheme();

// What followColorScheme() does with the answer.
void setColorScheme(bool isDark);

}  // namespace plume

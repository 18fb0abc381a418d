// Light or dark, as the desktop wants it, also when it changes its mind.
#pragma once

class QApplication;

namespace plume {

// Gives the application the colours of the desktop's settings portal, and follows it. Where there is none, the
// environment's "GTK_THEME" counts; else it is light. Once, on the main thread, before the first window.
void followColorScheme(QApplication& application);

// What followColorScheme() does with the answer.
void setColorScheme(bool isDark);

}  // namespace plume

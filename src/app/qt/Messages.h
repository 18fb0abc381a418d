// Messages and questions of a few words, which nobody waits for.
//
// On the main thread. Each owns itself, and is gone when it is answered. With a parent it holds up that window alone,
// and goes with it.
#pragma once

#include <QString>
#include <functional>

class QMessageBox;
class QWidget;

namespace plume {

// Tells that something was or was not done: one button, "OK".
QWidget* tell(QWidget* parent, const QString& message, const QString& details);

// Asks for consent: `agreed` is called when the button `consent` is chosen, nothing when it is "Cancel" or the question
// is closed. Return chooses "Cancel".
void ask(QWidget* parent, const QString& message, const QString& details, const QString& consent,
         std::function<void()> agreed);

// An empty question, to be given buttons and opened.
QMessageBox* makeMessageBox(QWidget* parent, const QString& message, const QString& details);

}  // namespace plume

// Makes the whole page of a form out of what Plume says of it: the template, its style, and the rules that keep a page
// from running or loading anything.
//
// On the main thread, once the application is there.
#pragma once

#include <QByteArray>
#include <QString>

#include "app/form/FormMessages.h"

namespace plume {

// UTF-8.
QByteArray pageOf(const PrepareForm& form);
// The colours and the font that windows have now, as a style sheet.
QString coloursOfPage();
// What runs in each page before anything of it is there.
QString scriptOfPage();

}  // namespace plume

// Plume's own pictures: the application's icon, and the one in the desktop's panel with what it says of the status.
//
// Drawn when asked for, in every size that panels and windows use, plain and for screens of twice the density. Pure,
// but only on the main thread of an application with windows.
#pragma once

#include <QIcon>
#include <QString>

#include "app/StatusItem.h"

namespace plume {

enum class IconStyle {
    Coloured,  // for panels whose colour nobody knows
    Symbolic   // one colour: light in the dark appearance, else dark
};

// The name of the image that stands for the status.
QString statusImageName(const Status& status, bool isDark);
// That image. A keyboard that is lost is shown on it, too.
QIcon statusIcon(const Status& status, bool isDark, IconStyle style);

// For windows and launchers.
QIcon applicationIcon();

}  // namespace plume

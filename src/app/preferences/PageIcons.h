// Icons for the pages of the settings window, drawn in the colour of the text beside them.
//
// Main thread. They are sharp at every size, and follow light and dark by themselves.
#pragma once

#include <QIcon>

namespace plume {

enum class PageIcon {
    General,
    Expansion,
    Search,
    Typing,
    Correction,
    HotKeys,
    Applications,
    Backups,
    ImportExport,
    Advanced
};

QIcon iconOfPage(PageIcon icon);

}  // namespace plume

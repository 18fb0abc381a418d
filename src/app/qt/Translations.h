// The languages that windows speak besides English, which is what is written in them.
//
// On the main thread, before the first window is made: texts that are shown already stay as they are.
#pragma once

#include <QLocale>
#include <QStringList>
#include <filesystem>

class QApplication;

namespace plume {

// From then on windows speak the first of the user's languages that there are texts for in `folder`, in files such as
// plume_de.qm, and Qt's own texts do too where they are installed. English comes as it is: without such files, or
// where English is wanted before any language that is there.
void installTranslations(QApplication& application, const std::filesystem::path& folder,
                         const QStringList& languages = QLocale::system().uiLanguages());

}  // namespace plume

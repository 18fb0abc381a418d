#include "app/qt/Translations.h"

#include <QApplication>
#include <QLibraryInfo>
#include <QTranslator>
#include <memory>

namespace plume {

namespace {

// Languages are named as in "pt-BR", files as in "plume_pt_BR.qm" or "plume_pt.qm".
bool install(QApplication& application, const QString& name, QString language, const QString& folder) {
    auto translator = std::make_unique<QTranslator>(&application);
    language.replace(QLatin1Char('-'), QLatin1Char('_'));
    return translator->load(name + QLatin1Char('_') + language, folder) &&
           QApplication::installTranslator(translator.release());
}

}  // namespace

void installTranslations(QApplication& application, const std::filesystem::path& folder, const QStringList& languages) {
    for (const QString& language : languages) {
        if (QLocale(language).language() == QLocale::English || language == QLatin1String("C")) return;
        if (!install(application, QStringLiteral("plume"), language, QString::fromStdString(folder.string()))) continue;
        install(application, QStringLiteral("qtbase"), language, QLibraryInfo::path(QLibraryInfo::TranslationsPath));
        return;
    }
}

}  // namespace plume

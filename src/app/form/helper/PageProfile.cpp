#include "app/form/helper/PageProfile.h"

#include <QDir>
#include <QLocale>
#include <QWebEngineCookieStore>
#include <QWebEngineDownloadRequest>
#include <QWebEngineScript>
#include <QWebEngineScriptCollection>
#include <QWebEngineSettings>

#include "app/form/helper/PageTemplate.h"

namespace plume {

PageProfile::PageProfile() {
    profile_.setHttpCacheType(QWebEngineProfile::NoCache);
    profile_.setPersistentCookiesPolicy(QWebEngineProfile::NoPersistentCookies);
    profile_.cookieStore()->setCookieFilter([](const auto& /*request*/) { return false; });
    profile_.setUrlRequestInterceptor(&filter_);
    profile_.installUrlSchemeHandler(FormScheme::Name, &scheme_);
    QObject::connect(&profile_, &QWebEngineProfile::downloadRequested,
                     [](QWebEngineDownloadRequest* download) { download->cancel(); });
    allowLittle();
    addScript();
    checkSpelling();
}

void PageProfile::allowLittle() {
    using Settings = QWebEngineSettings;
    Settings& settings = *profile_.settings();
    for (const auto attribute : {Settings::JavascriptCanOpenWindows,
                                 Settings::JavascriptCanAccessClipboard,
                                 Settings::JavascriptCanPaste,
                                 Settings::LocalStorageEnabled,
                                 Settings::LocalContentCanAccessRemoteUrls,
                                 Settings::LocalContentCanAccessFileUrls,
                                 Settings::HyperlinkAuditingEnabled,
                                 Settings::PluginsEnabled,
                                 Settings::FullScreenSupportEnabled,
                                 Settings::ScreenCaptureEnabled,
                                 Settings::WebGLEnabled,
                                 Settings::Accelerated2dCanvasEnabled,
                                 Settings::AutoLoadIconsForPage,
                                 Settings::TouchIconsEnabled,
                                 Settings::ErrorPageEnabled,
                                 Settings::DnsPrefetchEnabled,
                                 Settings::PdfViewerEnabled,
                                 Settings::NavigateOnDropEnabled,
                                 Settings::LinksIncludedInFocusChain,
                                 Settings::FocusOnNavigationEnabled}) {
        settings.setAttribute(attribute, false);
    }
}

// Scripts that are put in are not held to the page's policy.
void PageProfile::addScript() {
    QWebEngineScript script;
    script.setName(QStringLiteral("form"));
    script.setSourceCode(scriptOfPage());
    script.setInjectionPoint(QWebEngineScript::DocumentCreation);
    script.setWorldId(QWebEngineScript::MainWorld);
    script.setRunsOnSubFrames(false);
    profile_.scripts()->insert(script);
}

// In the user's language where a dictionary of it is installed, as in "de_DE.bdic" or "de-DE-3-0.bdic".
void PageProfile::checkSpelling() {
    const QString named = qEnvironmentVariable("QTWEBENGINE_DICTIONARIES_PATH");
    const QDir folder(named.isEmpty() ? QStringLiteral("/usr/share/hunspell-bdic") : named);
    const QString language = QLocale::system().name();
    for (const QString& wanted : {language, QString(language).replace(u'_', u'-'), language.section(u'_', 0, 0)}) {
        const QStringList found = folder.entryList({wanted + QStringLiteral("*.bdic")}, QDir::Files, QDir::Name);
        if (found.isEmpty()) continue;
        qputenv("QTWEBENGINE_DICTIONARIES_PATH", folder.path().toLocal8Bit());
        profile_.setSpellCheckLanguages({found.front().chopped(5)});
        profile_.setSpellCheckEnabled(true);
        return;
    }
}

}  // namespace plume

#include "app/form/helper/LockedPage.h"

namespace plume {

LockedPage::LockedPage(QWebEngineProfile* profile, QObject* parent) : QWebEnginePage(profile, parent) {
    connect(this, &QWebEnginePage::featurePermissionRequested, this, [this](const QUrl& origin, Feature feature) {
        setFeaturePermission(origin, feature, PermissionDeniedByUser);
    });
}

void LockedPage::open(const QUrl& address) {
    address_ = address;
    load(address);
}

bool LockedPage::acceptNavigationRequest(const QUrl& url, NavigationType type, bool isMainFrame) {
    const bool isFirst = isMainFrame && type == NavigationTypeTyped && url == address_;
    if (isFirst) address_.clear();
    return isFirst;
}

QWebEnginePage* LockedPage::createWindow(WebWindowType /*type*/) {
    return nullptr;
}

QStringList LockedPage::chooseFiles(FileSelectionMode /*mode*/, const QStringList& /*oldFiles*/,
                                    const QStringList& /*acceptedMimeTypes*/) {
    return {};
}

void LockedPage::javaScriptAlert(const QUrl& /*origin*/, const QString& /*message*/) {}

bool LockedPage::javaScriptConfirm(const QUrl& /*origin*/, const QString& /*message*/) {
    return false;
}

bool LockedPage::javaScriptPrompt(const QUrl& /*origin*/, const QString& /*message*/, const QString& /*value*/,
                                  QString* /*result*/) {
    return false;
}

// It may hold what was typed.
void LockedPage::javaScriptConsoleMessage(JavaScriptConsoleMessageLevel /*level*/, const QString& /*message*/,
                                          int /*line*/, const QString& /*source*/) {}

}  // namespace plume

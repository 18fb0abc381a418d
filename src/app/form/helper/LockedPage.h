// A page that shows what it is given and goes nowhere: no links, no windows, no dialogs, no files, no permissions.
//
// On the main thread; belongs to its window.
#pragma once

#include <QUrl>
#include <QWebEnginePage>

namespace plume {

class LockedPage final : public QWebEnginePage {
    Q_OBJECT
  public:
    LockedPage(QWebEngineProfile* profile, QObject* parent);

    // Once.
    void open(const QUrl& address);

  protected:
    bool acceptNavigationRequest(const QUrl& url, NavigationType type, bool isMainFrame) override;
    QWebEnginePage* createWindow(WebWindowType type) override;
    QStringList chooseFiles(FileSelectionMode mode, const QStringList& oldFiles,
                            const QStringList& acceptedMimeTypes) override;
    void javaScriptAlert(const QUrl& origin, const QString& message) override;
    bool javaScriptConfirm(const QUrl& origin, const QString& message) override;
    bool javaScriptPrompt(const QUrl& origin, const QString& message, const QString& value, QString* result) override;
    void javaScriptConsoleMessage(JavaScriptConsoleMessageLevel level, const QString& message, int line,
                                  const QString& source) override;

  private:
    QUrl address_;
};

}  // namespace plume

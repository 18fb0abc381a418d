// Serves the pages of forms out of memory, under a scheme of their own: plume-form://form/7.
//
// On the main thread; outlives the profile that it is installed in.
#pragma once

#include <QByteArray>
#include <QMap>
#include <QUrl>
#include <QWebEngineUrlSchemeHandler>

#include "app/form/FormMessages.h"

namespace plume {

class FormScheme final : public QWebEngineUrlSchemeHandler {
    Q_OBJECT
  public:
    static constexpr const char* Name = "plume-form";

    // Before the application is made.
    static void announce();
    static QUrl addressOf(FormNumber form);

    // What stands there from then on, until it is loaded: that happens once.
    void setPage(FormNumber form, QByteArray html);
    void removePage(FormNumber form) { pages_.remove(addressOf(form).path()); }

    void requestStarted(QWebEngineUrlRequestJob* request) override;

  private:
    QMap<QString, QByteArray> pages_;  // by path
};

}  // namespace plume

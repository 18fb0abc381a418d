// Lets pages load what this program itself has, and nothing else: no network, no files.
//
// Called on the main thread; outlives the profile that it is set on.
#pragma once

#include <QWebEngineUrlRequestInterceptor>

namespace plume {

class RequestFilter final : public QWebEngineUrlRequestInterceptor {
    Q_OBJECT
  public:
    void interceptRequest(QWebEngineUrlRequestInfo& request) override;
};

}  // namespace plume

#include "app/form/helper/RequestFilter.h"

#include "app/form/helper/FormScheme.h"

namespace plume {

void RequestFilter::interceptRequest(QWebEngineUrlRequestInfo& request) {
    const QString scheme = request.requestUrl().scheme();
    const bool isImage = request.resourceType() == QWebEngineUrlRequestInfo::ResourceTypeImage;
    const bool isOurs = scheme == QLatin1String(FormScheme::Name);
    request.block(!isOurs && !(isImage && scheme == QLatin1String("data")));
}

}  // namespace plume

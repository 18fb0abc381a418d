// What all pages of forms have in common: nothing is kept, nothing is fetched, nothing runs but our script.
//
// On the main thread; outlives the pages.
#pragma once

#include <QWebEngineProfile>

#include "app/form/helper/FormScheme.h"
#include "app/form/helper/RequestFilter.h"

namespace plume {

class PageProfile final {
  public:
    PageProfile();

    QWebEngineProfile& profile() { return profile_; }
    FormScheme& scheme() { return scheme_; }

  private:
    void allowLittle();
    void addScript();
    void checkSpelling();

    FormScheme scheme_;
    RequestFilter filter_;
    QWebEngineProfile profile_;  // without a name it keeps nothing
};

}  // namespace plume

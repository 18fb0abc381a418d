// Which Plume this is, under which licence, and what it is built upon.
//
// On the main thread; owns itself, and is gone when it is closed.
#pragma once

#include "app/windows/SmallWindow.h"
#include "platform/UserDefaults.h"

namespace plume {

class AboutWindow final : public SmallWindow {
    Q_OBJECT
  public:
    AboutWindow(const QString& version, WritableUserDefaults& settings);
};

}  // namespace plume

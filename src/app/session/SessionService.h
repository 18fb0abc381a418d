// Plume on the session bus: what launchers, desktop actions and scripts ask of it under the name org.plume.Plume.
//
// Owned by whoever runs the application, on the main thread. Everything goes the way that the command line goes, so
// that both do the same. Without a session bus there is no service, which is no error.
#pragma once

#include <QObject>
#include <functional>
#include <string>
#include <vector>

#include "app/session/CommandSocket.h"

namespace plume {

class SessionService final : public QObject {
    Q_OBJECT
  public:
    // `perform` gets the words of a command line.
    using Perform = std::function<CommandReply(const std::vector<std::string>& words)>;

    explicit SessionService(Perform perform);
    // The name goes with it.
    ~SessionService() override;

    // Whether the name is ours. Another Plume may have it, on another display.
    bool isRegistered() const { return registered_; }

    CommandReply perform(const std::vector<std::string>& words) const { return perform_(words); }

  private:
    const Perform perform_;
    bool registered_ = false;
};

}  // namespace plume

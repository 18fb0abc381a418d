// Notices shown by the desktop's own service for them (org.freedesktop.Notifications).
//
// Asked on a thread of its own, which connects with the first notice.
#pragma once

#include <functional>
#include <memory>
#include <string>

#include "platform/Notices.h"
#include "platform/RunLoop.h"
#include "ports/dbus/BusThread.h"

namespace plume {

class NoticeSession;

class DesktopNotices final : public Notices {
  public:
    // Told the body of what the desktop cannot show, on the main thread.
    using CannotShow = std::function<void(const std::string& body)>;

    // The loop outlives it.
    explicit DesktopNotices(RunLoop& mainLoop);
    ~DesktopNotices() override;

    // Before the first notice.
    void setCannotShow(CannotShow cannotShow);
    void show(Notice notice) override;

  private:
    BusThread<NoticeSession> thread_;
};

}  // namespace plume

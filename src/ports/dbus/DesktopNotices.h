// Notices shown by the desktop's own service for them (org.freedesktop.Notifications).
//
// Asked on a thread of its own, which connects with the first notice.
#pragma once

#include <functional>
#include <memory>
#include <string>
#include <utility>

#include "platform/Notices.h"
#include "platform/RunLoop.h"
#include "ports/dbus/BusThread.h"

namespace plume {

class NoticeSession;

class DesktopNotices final : public Notices {
  public:
    // Told the body of what the desktop cannot show, on the main thread.
    using CannotShow = std::function<void(const std::string& body)>;
    using Words = std::function<std::string(const std::string& text)>;

    // The loop outlives it.
    explicit DesktopNotices(RunLoop& mainLoop);
    ~DesktopNotices() override;

    // Before the first notice.
    void setCannotShow(CannotShow cannotShow);
    // What is shown in place of a title, a body and a button; asked on the main thread. Before the first notice.
    void setWords(Words words) { words_ = std::move(words); }
    void show(Notice notice) override;

  private:
    Words words_;
    BusThread<NoticeSession> thread_;
};

}  // namespace plume

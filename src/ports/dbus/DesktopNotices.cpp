#include "ports/dbus/DesktopNotices.h"

#include <algorithm>
#include <cstdint>
#include <map>
#include <utility>
#include <vector>

#include "ports/dbus/MainLoopLink.h"
#include "ports/dbus/ServiceBus.h"

namespace plume {

namespace {

constexpr BusAddress Service{"org.freedesktop.Notifications", "/org/freedesktop/Notifications",
                             "org.freedesktop.Notifications"};

std::string withoutMarkup(const std::string& text) {
    std::string escaped;
    for (const char c : text) {
        if (c == '&') {
            escaped += "&amp;";
        } else if (c == '<') {
            escaped += "&lt;";
        } else {
            escaped += c;
        }
    }
    return escaped;
}

}  // namespace

// On the thread, but for what says otherwise.
class NoticeSession {
  public:
    explicit NoticeSession(RunLoop& mainLoop) : bus_(loop_), mainLoop_(mainLoop) {
        bus_.heard = [this](DBusMessage& signal) { hear(signal); };
        bus_.lost = [this] { shown_.clear(); };
    }

    void run() { loop_.run(); }
    // From any thread.
    void end() {
        mainLoop_.cut();
        loop_.stop();
    }
    // From any thread.
    void show(Notice notice) {
        loop_.perform([this, notice = std::move(notice)]() mutable { askForAbilities(std::move(notice)); });
    }

    DesktopNotices::CannotShow cannotShow;  // set before the first notice

  private:
    struct Abilities {
        bool buttons = false;
        bool markup = false;
    };

    void askForAbilities(Notice notice) {
        if (!bus_.isConnected()) {
            if (!bus_.connect(sessionBusAddress())) return giveUp(notice);
            bus_.listen(std::string("type='signal',sender='") + Service.name + "',interface='" + Service.interface +
                        "'");
        }
        bus_.call(newCall(Service, "GetCapabilities"),
                  [this, notice = std::move(notice)](const BusAnswer& answer) mutable {
                      if (!answer) return giveUp(notice);
                      Abilities abilities;
                      for (BusReader list = answer.values().inside(); !list.isAtEnd();) {
                          const std::string name = list.string().value_or("");
                          if (name == "actions") abilities.buttons = true;
                          if (name == "body-markup") abilities.markup = true;
                      }
                      send(std::move(notice), abilities);
                  });
    }

    void send(Notice notice, Abilities abilities) {
        if (!notice.buttons.empty() && !abilities.buttons) return giveUp(notice);
        std::vector<std::string> buttons;  // names and labels by turns
        for (std::size_t i = 0; i < notice.buttons.size(); ++i) {
            buttons.push_back(std::to_string(i));
            buttons.push_back(notice.buttons[i].label);
        }
        constexpr std::int32_t AsLongAsUsual = -1;
        const BusMessage call = newCall(
            Service, "Notify",
            {std::string("Plume"), std::uint32_t{0}, std::string("input-keyboard"), notice.title,
             abilities.markup ? withoutMarkup(notice.body) : notice.body, buttons, BusNoOptions(), AsLongAsUsual});
        bus_.call(call, [this, notice = std::move(notice)](const BusAnswer& answer) mutable {
            const auto number = answer.values().uint32();
            if (!number) return giveUp(notice);
            if (!notice.buttons.empty()) shown_[*number] = std::move(notice.buttons);
        });
    }

    void hear(DBusMessage& signal) {
        BusReader values(&signal);
        const auto shown = shown_.find(values.uint32().value_or(0));
        if (shown == shown_.end()) return;
        if (dbus_message_is_signal(&signal, Service.interface, "NotificationClosed") != 0) {
            shown_.erase(shown);
        } else if (dbus_message_is_signal(&signal, Service.interface, "ActionInvoked") != 0) {
            const std::string name = values.string().value_or("");
            for (std::size_t i = 0; i < shown->second.size(); ++i) {
                if (name == std::to_string(i)) mainLoop_.perform(std::move(shown->second[i].pressed));
            }
            shown_.erase(shown);
        }
    }

    void giveUp(const Notice& notice) {
        if (cannotShow) mainLoop_.perform([tell = cannotShow, body = notice.body] { tell(body); });
    }

    PollRunLoop loop_;
    ServiceBus bus_;
    std::map<std::uint32_t, std::vector<Notice::Button>> shown_;  // those with buttons, by the service's numbers
    MainLoopLink mainLoop_;
};

DesktopNotices::DesktopNotices(RunLoop& mainLoop) : thread_(std::make_shared<NoticeSession>(mainLoop)) {}

DesktopNotices::~DesktopNotices() = default;

void DesktopNotices::setCannotShow(CannotShow cannotShow) {
    thread_->cannotShow = std::move(cannotShow);
}

void DesktopNotices::show(Notice notice) {
    if (words_) {
        notice.title = words_(notice.title);
        notice.body = words_(notice.body);
        for (Notice::Button& button : notice.buttons) button.label = words_(button.label);
    }
    thread_->show(std::move(notice));
}

}  // namespace plume

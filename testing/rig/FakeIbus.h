#pragma once

#include <cstdint>
#include <deque>
#include <memory>
#include <mutex>
#include <optional>
#include <string>

#include "testing/rig/BusService.h"
#include "testing/rig/Deadline.h"
#include "testing/rig/DesktopRig.h"

namespace plume::rig {

// An input method in the process of the test, and a program that gives it keys: on a bus of its own they say to each
// other what IBus and programs say.
class FakeIbus {
  public:
    // On this desktop, whose session this process has joined; throws RigError.
    FakeIbus(DesktopRig& rig, std::string engine);

    void setEngine(const std::string& name);
    // The program gives it a key of this code, and gets that text before the key is taken or passed, after the delay.
    void takeKey(std::uint32_t code, const std::string& text, bool passes, Milliseconds delay = Milliseconds(0));
    // It puts a text into a field that does not have the focus.
    void putElsewhere(const std::string& text);

  private:
    struct Outcome {
        std::string text;
        bool passes;
        Milliseconds delay;
    };

    static void sayWhere(const std::string& display, const std::string& address);
    BusMessage answer(DBusMessage* call);
    BusMessage engineIn(DBusMessage* call);
    BusMessage outcomeOf(DBusMessage* call);
    BusMessage commit(const char* context, const std::string& text);

    std::unique_ptr<ChildProcess> bus_;
    BusConnection program_;
    std::mutex mutex_;
    std::string engine_;            // guarded by mutex_
    std::deque<Outcome> outcomes_;  // of the keys that come next; guarded by mutex_
    std::optional<BusService> service_;
    std::optional<BusService> session_;
};

}  // namespace plume::rig

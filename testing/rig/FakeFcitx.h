#pragma once

#include <cstdint>
#include <deque>
#include <mutex>
#include <string>

#include "testing/rig/BusService.h"
#include "testing/rig/Deadline.h"

namespace plume::rig {

// An input method in the process of the test, and a program with a field that has the focus: on the session's bus they
// say to each other what Fcitx and programs say.
class FakeFcitx {
  public:
    // On the session's bus of this process, with an engine for a field that had the focus before; throws RigError.
    explicit FakeFcitx(std::string engine);

    // In the field with the focus; the program alone is told.
    void setEngine(const std::string& name);
    void loseFocus();
    // The program gives it a key of this code of the hardware, and gets that text after the delay; then the key is
    // passed or taken, and without a text composed.
    void takeKey(std::uint32_t code, const std::string& text, bool passes, Milliseconds delay = Milliseconds(0));
    // Another field gets that text.
    void putElsewhere(const std::string& text);

  private:
    struct Outcome {
        std::string text;
        bool passes;
        Milliseconds delay;
    };

    BusMessage answer(DBusMessage* call);
    void tellOutcome(DBusMessage* call);
    BusMessage signal(const char* path, const char* member) const;
    BusMessage commit(const char* path, const std::string& text) const;
    BusMessage preedit(const char* text) const;

    BusConnection program_;
    const std::string engine_;
    std::mutex mutex_;
    std::deque<Outcome> outcomes_;  // of the keys that come next; guarded by mutex_
    BusService service_;
};

}  // namespace plume::rig

#pragma once

#include <atomic>
#include <memory>
#include <mutex>
#include <string>
#include <thread>

#include "ports/dbus/BusMessages.h"
#include "testing/rig/DesktopRig.h"

namespace plume::rig {

// An input method in the process of the test: says which engine works, on a bus of its own.
class FakeIbus {
  public:
    // On this desktop, whose session this process has joined; throws RigError.
    FakeIbus(DesktopRig& rig, std::string engine);
    ~FakeIbus();
    FakeIbus(const FakeIbus&) = delete;
    FakeIbus& operator=(const FakeIbus&) = delete;

    void setEngine(const std::string& name);

  private:
    static void sayWhere(const std::string& display, const std::string& address);
    void serve();
    void answer(DBusMessage* call);
    BusMessage engineIn(DBusMessage* call);

    std::unique_ptr<ChildProcess> bus_;
    BusConnection service_;
    BusConnection session_;
    std::mutex mutex_;
    std::string engine_;  // guarded by mutex_
    std::atomic<bool> ended_ = false;
    std::thread thread_;
};

}  // namespace plume::rig

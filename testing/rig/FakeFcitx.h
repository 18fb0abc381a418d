#pragma once

#include <string>

#include "testing/rig/BusService.h"

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

  private:
    BusMessage answer(DBusMessage* call) const;

    BusConnection program_;
    const std::string engine_;
    BusService service_;
};

}  // namespace plume::rig

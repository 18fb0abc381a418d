#pragma once

#include <atomic>
#include <cstdint>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include "ports/atspi/AtspiBus.h"

namespace plume::rig {

// Something on the accessibility bus that looks like a program, in the process of the test: an active window, and a
// text and a password field so many parts below it. Which of them has the focus, the test says. Made with a toolkit
// that Plume does not know.
class ListedProgram {
  public:
    enum class Field { Text, Password };

    ListedProgram(const std::string& address, int depth);  // throws RigError
    ~ListedProgram();
    ListedProgram(const ListedProgram&) = delete;
    ListedProgram& operator=(const ListedProgram&) = delete;

    // Tells whoever listens.
    void focus(Field field);
    // From now on the window is neither active nor has any parts until somebody asks for its relations, as with
    // Chromium.
    void hideParts() { hidesParts_ = true; }

  private:
    void enlist();
    void serve();
    void answer(DBusMessage* call);
    void answerProperty(DBusMessage* call, const std::string& path, const std::string& name);
    std::uint32_t stateOf(const std::string& path) const;
    std::vector<std::string> childrenOf(const std::string& path) const;
    void send(const BusMessage& message) { dbus_connection_send(connection_.get(), message.get(), nullptr); }

    const int depth_;
    BusConnection connection_;
    std::string name_;
    std::atomic<Field> focused_ = Field::Text;
    std::atomic<bool> hidesParts_ = false;
    std::atomic<bool> ended_ = false;
    std::thread thread_;
};

}  // namespace plume::rig

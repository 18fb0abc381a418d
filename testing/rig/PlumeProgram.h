#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "testing/rig/DesktopRig.h"

namespace plume::rig {

// Plume as a user starts it, on a rig's desktop. Hears the keyboard when the constructor returns, and gives it back
// when it is destroyed.
class PlumeProgram {
  public:
    enum class Accessibility { Found, Missing };

    // The contents of a library and a settings file; empty ones mean those of the user's store. Throws RigError.
    PlumeProgram(DesktopRig& rig, const std::string& library, const std::string& settings = "{}",
                 Accessibility accessibility = Accessibility::Found);
    // The same for the application, with its icon and its windows, on the user's store: `plume` without arguments, with
    // these lines added to its environment. Answers commands when this returns.
    static std::unique_ptr<PlumeProgram> startApplication(DesktopRig& rig, const Environment& also = {});

    ChildProcess& process() { return *process_; }
    // Seconds from the start to the moment it said that it was ready.
    double secondsToReady() const { return secondsToReady_; }

  private:
    PlumeProgram() = default;
    void start(DesktopRig& rig, const std::vector<std::string>& arguments, const std::function<bool()>& isReady);

    std::unique_ptr<ChildProcess> process_;
    double secondsToReady_ = 0;
};

// How a command ended, and what it wrote, errors included.
struct CommandOutcome {
    int status = 0;
    std::string said;
};

// A `plume` with arguments, as somebody on that desktop gives it. Throws RigError when it does not end.
CommandOutcome runPlume(DesktopRig& rig, std::vector<std::string> arguments);

// Whether what is typed into the empty target, which has the focus, becomes the expected text.
bool becomes(DesktopRig& rig, TargetProgram& target, const std::string& typed, const std::string& expected,
             Milliseconds within = Milliseconds(10'000));
// The same, tried again for ten seconds: Plume may not know yet that another program has come to the front, or may not
// have heard yet of what was changed.
bool soonBecomes(DesktopRig& rig, TargetProgram& target, const std::string& typed, const std::string& expected);

// What became of a text typed on the keyboard, whose last character sets something off.
struct Expansion {
    std::string got;
    double milliseconds = 0;  // from the press of the last key to the change that made the text complete
    bool isRight = false;     // it became what was expected
};

// Clears the target, has somebody make the text, and waits at most ten seconds until it is there. The time counts from
// the call.
Expansion awaitExpansion(TargetProgram& target, const std::string& expected, const std::function<void()>& make);

// Types into the target that has the focus. The last character sets something off; it is typed, and the time counts,
// when those before it are there, as nobody types faster than programs show it.
Expansion typeAndAwait(DesktopRig& rig, TargetProgram& target, const std::string& typed, const std::string& expected);

}  // namespace plume::rig

#pragma once

#include <memory>
#include <string>
#include <vector>

#include "testing/rig/ChildProcess.h"
#include "testing/rig/PrivateDirectory.h"
#include "testing/rig/XClient.h"
#include "testing/rig/XServer.h"

namespace plume::rig {

// What a program sees of the machine before there is a display: the search path, a UTF-8 locale, a home folder and a
// runtime folder inside `directory`, and no setting of whoever runs the test.
Environment privateEnvironment(const PrivateDirectory& directory);

// The second one gives the keyboard to the window under the pointer.
enum class WindowManager { Openbox, OpenboxFollowingPointer, Xfwm4 };

// A desktop on a display: a private D-Bus session, the accessibility bus on it, and a window manager.
class DesktopSession {
  public:
    // Ready when the constructor returns; throws RigError. The directory and the server outlive the session.
    DesktopSession(const PrivateDirectory& directory, const XServer& server,
                   WindowManager manager = WindowManager::Openbox);

    // For the programs of this desktop.
    const Environment& environment() const { return environment_; }

    // Makes the calling program one of this desktop: it takes over the environment.
    void join() const;

    // Starts a program of this desktop, found along PATH; its output goes to a file of its own.
    std::unique_ptr<ChildProcess> start(const std::vector<std::string>& arguments, const std::string& package);

  private:
    void startBus();
    void startAccessibility(XClient& client);
    void startWindowManager(XClient& client, WindowManager manager);
    static void awaitManaging(XClient& client);
    std::unique_ptr<ChildProcess> startProgram(const std::filesystem::path& program, std::vector<std::string> arguments,
                                               const std::vector<int>& keptDescriptors = {});

    const PrivateDirectory& directory_;
    Environment environment_;
    int programs_ = 0;  // started so far
    // In the order of their start: they end the other way round.
    std::unique_ptr<ChildProcess> bus_;
    std::unique_ptr<ChildProcess> accessibility_;
    std::unique_ptr<ChildProcess> windowManager_;
};

}  // namespace plume::rig

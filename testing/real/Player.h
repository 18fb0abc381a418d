// Plays stories in real programs.
#pragma once

#include <filesystem>
#include <functional>
#include <memory>
#include <string>

#include "testing/real/RealProgram.h"
#include "testing/real/Story.h"
#include "testing/real/TextReader.h"
#include "testing/rig/DesktopRig.h"

namespace plume::real {

// What came of one story in one place.
struct Outcome {
    std::string program;
    std::string version;
    std::string place;
    std::string story;
    std::string expected;
    std::string got;
    double milliseconds = 0;  // from the first key to the moment at which the text was read
    bool isRight = false;
};

// What is played, and how often; empty: everything.
struct Choice {
    std::string program;
    std::string place;
    std::string story;
    int times = 1;
};

// Starts one program and plays in it. One thread, the rig's.
class Player {
  public:
    using Tell = std::function<void(const Outcome&)>;

    // Pictures of the screen, of what was wrong, go to the folder. The rig outlives the player.
    Player(rig::DesktopRig& rig, std::filesystem::path pictures, Choice choice, Tell tell);

    // Tells every outcome; a program that does not start is one, too. Throws RigError when the desktop is gone.
    void play(const RealProgram& program);

  private:
    std::unique_ptr<rig::ChildProcess> start(const RealProgram& program);
    void serve();
    std::string filled(std::string text) const;
    xcb_window_t awaitWindow(const RealProgram& program, rig::ChildProcess& process);
    void playPlace(const Place& place);
    void enter(const Place& place);
    void awaitReady(const Place& place);
    bool awaitTitle(const std::string& start, rig::Milliseconds bound);
    void awaitPasswordField(const Place& place);
    void visit(const Place& place);
    void keepBookmark();
    void awaitProposal(const Place& place);
    void clear(const Place& place);
    static void settle(const Place& place);
    Outcome playStory(const Place& place, const Story& story);
    void type(const Place& place, const Story& story);
    std::string awaitText(const std::string& expected);
    std::string playClipboard(const Place& place, const Story& story);
    void finish(Outcome& outcome);
    bool isChosen(const Place& place, const Story& story) const;

    rig::DesktopRig& rig_;
    std::filesystem::path pictures_;
    Choice choice_;
    Tell tell_;
    const RealProgram* program_ = nullptr;  // the one that is played in
    std::string version_;
    std::filesystem::path folder_;
    std::unique_ptr<rig::ChildProcess> server_;
    std::string port_;  // the server's
    xcb_window_t window_ = XCB_WINDOW_NONE;
    std::unique_ptr<TextReader> reader_;
};

}  // namespace plume::real

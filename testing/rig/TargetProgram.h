#pragma once

#include <chrono>
#include <condition_variable>
#include <cstdint>
#include <deque>
#include <filesystem>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <thread>

#include "testing/rig/ChildProcess.h"
#include "testing/rig/DesktopSession.h"
#include "testing/rig/XClient.h"

namespace plume::rig {

enum class TargetKind { GtkTextView, QtTextEdit, Xterm };

std::string nameOf(TargetKind kind);

using MonotonicTime = std::chrono::steady_clock::time_point;

// A change of a target's text, as the target itself noticed it. Positions and lengths count characters.
struct TextChange {
    MonotonicTime time;
    int position = 0;
    int removed = 0;
    std::string inserted;  // UTF-8
    int length = 0;        // of the whole text afterwards
};

// A program of the desktop with one text in it, to type into. It tells of every change and of pastes, and gives and
// takes its whole text. A thread of its own reads what it tells, so it never waits for a test that is busy
// typing.
class TargetProgram {
  public:
    // Started, and its window active and focused for the server, when the constructor returns; throws RigError. The
    // session and the client outlive the target.
    TargetProgram(TargetKind kind, DesktopSession& session, XClient& client, const std::filesystem::path& socket);
    ~TargetProgram();
    TargetProgram(const TargetProgram&) = delete;
    TargetProgram& operator=(const TargetProgram&) = delete;

    TargetKind kind() const { return kind_; }
    xcb_window_t window() const { return window_; }  // its top-level window
    pid_t pid() const { return process_->pid(); }

    // Brings it to the front and gives it the keyboard focus.
    void activate() { client_.activate(window_); }

    // The whole text, in UTF-8.
    std::string text();

    // Sets the whole text, insertion point at its end for a terminal and at its start for the others. Changes told so
    // far are forgotten.
    void setText(const std::string& text);
    void clear() { setText(""); }

    // Shows a window of its own with the password "secret" in a field, in front of the text, or takes it away. Not for
    // a terminal.
    void showPassword(bool shown);

    // The next change that was not taken yet, waiting for it at most `bound`.
    std::optional<TextChange> takeChange(Milliseconds bound);

    // Waits until the text is the expected one and returns it; returns what the text is instead when it still is not
    // after the bound. Changes told meanwhile are taken.
    std::string awaitText(const std::string& expected, Milliseconds bound = Milliseconds(10'000));

    // Waits for the end of the next paste; false when there is none within the bound.
    bool awaitPaste(Milliseconds bound);

    // Forgets what was told so far: changes and pastes.
    void forgetReports();

  private:
    std::string ask(const std::string& request);
    void readLines();
    void takeLine(const std::string& line);
    RigError failure(const std::string& what) const;

    TargetKind kind_;
    XClient& client_;
    std::unique_ptr<ChildProcess> process_;
    FileDescriptor line_;
    xcb_window_t window_ = XCB_WINDOW_NONE;

    std::mutex mutex_;  // over all that follows, which the reading thread fills
    std::condition_variable told_;
    bool ended_ = false;
    std::optional<xcb_window_t> ready_;
    std::deque<TextChange> changes_;
    std::deque<std::string> answers_;
    int pastes_ = 0;
    std::thread reader_;
};

}  // namespace plume::rig

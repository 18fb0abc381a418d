// The application on a desktop of its own, and what a test does with it.
#pragma once

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "testing/rig/Deadline.h"
#include "testing/rig/PlumeProgram.h"
#include "testing/rig/ScreenReader.h"

namespace plume::rig {

inline constexpr const char* Greetings = R"json([
  { "name": "Greetings", "abbreviationPrefix": ";", "expandAfter": 2, "expandTrigger": 0, "items": [
      { "abbreviation": "sig", "content": "Kind regards, Jo" },
      { "abbreviation": "brb", "content": "be right back", "caseSensitivity": 2 } ] }
])json";

inline constexpr Milliseconds Bound(10'000);

inline bool contains(const std::string& text, const std::string& part) {
    return text.find(part) != std::string::npos;
}

// Each test has a desktop and a home of its own.
class ApplicationDesktop : public testing::Test {
  protected:
    explicit ApplicationDesktop(WindowManager manager = WindowManager::Openbox) : rig_({}, manager) {}
    void SetUp() override { rig_.session().join(); }

    // As somebody who has this library for a while already: nobody is welcomed.
    void keepLibrary(const std::string& library = Greetings) {
        const auto folder = rig_.directory() / "home/.config/plume";
        std::filesystem::create_directories(folder);
        std::ofstream(folder / "library.json") << library;
        ASSERT_EQ(runPlume(rig_, {"list"}).status, 0);
        ASSERT_EQ(runPlume(rig_, {"settings", "PlayFeedbackSound", "false"}).status, 0);
    }
    void start(const Environment& also = {}) { plume_ = PlumeProgram::startApplication(rig_, also); }
    std::string log() const { return plume_->process().logTail(); }

    std::string command(const std::vector<std::string>& arguments) {
        const CommandOutcome outcome = runPlume(rig_, arguments);
        EXPECT_EQ(outcome.status, 0) << outcome.said;
        return outcome.said;
    }
    bool stateHas(const std::string& part) { return contains(command({"status", "--json"}), part); }

    // The window that has the focus is one whose title begins like this.
    bool hasFocus(const std::string& title) {
        XClient& client = rig_.client();
        const xcb_window_t active = client.activeWindow();
        return active != XCB_WINDOW_NONE && client.property(active, "_NET_WM_NAME").starts_with(title);
    }
    bool comesToFront(const std::string& title) {
        return waitUntil([&] { return hasFocus(title); }, Bound);
    }

    // Clicks on what is called like this in a window of Plume.
    bool click(const std::string& name) {
        const pid_t process = plume_->process().pid();
        const auto isSteady = [&, last = std::optional<Rectangle>()]() mutable {
            const auto before = std::exchange(last, reader().place(process, name));
            return last && last == before;
        };
        if (!waitUntil(isSteady, Bound)) return false;
        const Rectangle place = *reader().place(process, name);
        rig_.click(static_cast<int>(place.origin.x + place.size.width / 2),
                   static_cast<int>(place.origin.y + place.size.height / 2));
        return true;
    }
    ScreenReader& reader() {
        if (!reader_) reader_ = std::make_unique<ScreenReader>();
        return *reader_;
    }

    void expectAtOnce(TargetProgram& target, const std::string& typed, const std::string& expected) {
        EXPECT_TRUE(becomes(rig_, target, typed, expected)) << expected << " is " << target.text() << '\n' << log();
    }
    void expectSoon(TargetProgram& target, const std::string& typed, const std::string& expected) {
        EXPECT_TRUE(soonBecomes(rig_, target, typed, expected)) << expected << " is " << target.text() << '\n' << log();
    }

    DesktopRig rig_;
    std::unique_ptr<PlumeProgram> plume_;

  private:
    std::unique_ptr<ScreenReader> reader_;
};

}  // namespace plume::rig

// What the rig tells and takes down. That keys, texts and clicks reach its programs, the other tests show.

#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <csignal>
#include <fstream>

#include "testing/rig/Deadline.h"
#include "testing/rig/DesktopRig.h"
#include "testing/rig/FocusCounter.h"

namespace plume::rig {

namespace {

// Every process of a desktop has the rig's folder in its environment, the services that D-Bus started included.
int countProcessesOf(const std::filesystem::path& directory) {
    int count = 0;
    for (const auto& entry : std::filesystem::directory_iterator("/proc")) {
        std::ifstream file(entry.path() / "environ", std::ios::binary);
        const std::string environment{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
        if (environment.find("HOME=" + directory.string() + '/') != std::string::npos) ++count;
    }
    return count;
}

bool awaitNoProcessOf(const std::filesystem::path& directory) {
    return waitUntil([&] { return countProcessesOf(directory) == 0; });
}

// All tests of the program share one desktop: what is tested is that it serves one test after the other.
class DesktopSelftest : public testing::Test {
  protected:
    static void SetUpTestSuite() { rig_ = std::make_unique<DesktopRig>(); }
    static void TearDownTestSuite() {
        const std::filesystem::path directory = rig_->directory();
        EXPECT_GE(countProcessesOf(directory), 3);
        rig_.reset();
        EXPECT_TRUE(awaitNoProcessOf(directory));
        EXPECT_FALSE(std::filesystem::exists(directory));
    }

    static inline std::unique_ptr<DesktopRig> rig_;
};

TEST_F(DesktopSelftest, FocusThatGoesAndComesBackIsCounted) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    FocusCounter counter(rig_->server().display(), target->window());
    const auto other = rig_->startTarget(TargetKind::GtkTextView);
    EXPECT_GE(counter.takeCore().out, 1);
    target->activate();
    rig_->keyboard().type("back");
    EXPECT_EQ(target->awaitText("back"), "back");
    EXPECT_EQ(other->text(), "");
    EXPECT_GE(counter.takeCore().in, 1);
    EXPECT_GE(counter.takeInputExtension().in, 1);
}

TEST_F(DesktopSelftest, GrabbedKeyboardIsCountedAsFocusEvents) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    FocusCounter counter(rig_->server().display(), target->window());
    XClient grabber(rig_->server().display());
    const auto cookie = xcb_grab_keyboard(grabber.connection(), 0, grabber.root(), XCB_CURRENT_TIME,
                                          XCB_GRAB_MODE_ASYNC, XCB_GRAB_MODE_ASYNC);
    xcb_discard_reply(grabber.connection(), cookie.sequence);
    xcb_ungrab_keyboard(grabber.connection(), XCB_CURRENT_TIME);
    grabber.focusedWindow();
    const auto counts = counter.takeCore();
    EXPECT_GT(counts.byGrab, 0);
    EXPECT_EQ(counts.in + counts.out, counts.byGrab);
}

TEST(DesktopRigTest, EndsWithATestThatIsKilled) {
    std::array<int, 2> ends{};
    ASSERT_EQ(pipe(ends.data()), 0);
    const pid_t test = fork();
    if (test == 0) {
        DesktopRig rig;
        const auto terminal = rig.startTarget(TargetKind::Xterm);
        const std::string directory = rig.directory();
        if (write(ends[1], directory.data(), directory.size()) > 0) static_cast<void>(raise(SIGKILL));
        _exit(1);
    }
    close(ends[1]);
    std::string directory(256, '\0');
    const ssize_t length = read(ends[0], directory.data(), directory.size());
    close(ends[0]);
    int status = 0;
    ASSERT_EQ(waitpid(test, &status, 0), test);
    ASSERT_TRUE(WIFSIGNALED(status));
    ASSERT_GT(length, 0);
    directory.resize(static_cast<std::size_t>(length));
    EXPECT_TRUE(awaitNoProcessOf(directory));
    std::filesystem::remove_all(directory);
}

}  // namespace

}  // namespace plume::rig

// The rig itself at work: what a test types arrives, exactly, in every program that the desktop tests type into.

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <csignal>
#include <fstream>
#include <iostream>
#include <nlohmann/json.hpp>
#include <vector>

#include "testing/rig/Deadline.h"
#include "testing/rig/DesktopRig.h"
#include "testing/rig/FocusCounter.h"
#include "testing/rig/Screenshot.h"

namespace plume::rig {

namespace {

using std::chrono::duration_cast;
using std::chrono::microseconds;
using std::chrono::steady_clock;

// Text of the given length made of words, such that a lost, doubled or swapped key shows.
std::string runningText(std::size_t length) {
    std::string text;
    for (int word = 0; text.size() < length; ++word) text += "word" + std::to_string(word * 7919 % 1000) + ' ';
    text.resize(length);
    return text;
}

// All tests of the program share one desktop: what is tested is that it serves one test after the other.
class DesktopSelftest : public testing::Test {
  protected:
    static void SetUpTestSuite() { rig_ = std::make_unique<DesktopRig>(); }
    static void TearDownTestSuite() { rig_.reset(); }

    static inline std::unique_ptr<DesktopRig> rig_;
};

class DesktopTargetTest : public DesktopSelftest, public testing::WithParamInterface<TargetKind> {
  protected:
    void SetUp() override { target_ = rig_->startTarget(GetParam()); }

    std::unique_ptr<TargetProgram> target_;
};

TEST_P(DesktopTargetTest, HoldsExactlyWhatIsTyped) {
    rig_->keyboard().type("Hello, World 123");
    EXPECT_EQ(target_->awaitText("Hello, World 123"), "Hello, World 123");
    rig_->keyboard().tap(Key::Backspace);
    rig_->keyboard().type("4\n(~_~)");
    EXPECT_EQ(target_->awaitText("Hello, World 124\n(~_~)"), "Hello, World 124\n(~_~)");
}

TEST_P(DesktopTargetTest, TakesAndGivesWholeTexts) {
    const std::string text = "naïve Ünïcödé — 日本語 😀\n" + runningText(20'000);
    target_->setText(text);
    EXPECT_EQ(target_->text(), text);
    target_->clear();
    EXPECT_EQ(target_->text(), "");
}

TEST_P(DesktopTargetTest, LosesNoKeyWhenKeysRollOver) {
    const std::string text = runningText(2'000);
    rig_->keyboard().typeRollingOver(text);
    EXPECT_EQ(target_->awaitText(text, Milliseconds(30'000)), text);
}

TEST_P(DesktopTargetTest, FocusThatGoesAndComesBackIsCounted) {
    FocusCounter counter(rig_->server().display(), target_->window());
    const auto other = rig_->startTarget(TargetKind::GtkTextView);
    const TargetProgram::FocusChanges away{.in = 0, .out = 1};
    EXPECT_EQ(target_->awaitFocusChanges(away), away);
    target_->activate();
    rig_->keyboard().type("back");
    EXPECT_EQ(target_->awaitText("back"), "back");
    EXPECT_EQ(other->text(), "");
    const TargetProgram::FocusChanges back{.in = 1, .out = 1};
    EXPECT_EQ(target_->awaitFocusChanges(back), back);
    EXPECT_GE(counter.takeCore().out, 1);
    EXPECT_GE(counter.takeInputExtension().in, 1);
}

TEST_P(DesktopTargetTest, GrabbedKeyboardIsCountedAsFocusEvents) {
    FocusCounter counter(rig_->server().display(), target_->window());
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

TEST_P(DesktopTargetTest, TellsOfPastes) {
    const bool terminal = GetParam() == TargetKind::Xterm;
    auto source = rig_->startTarget(TargetKind::GtkTextView);
    source->setText("copied text");
    rig_->keyboard().chord({Key::LeftControl}, U'a');
    rig_->keyboard().chord({Key::LeftControl}, U'c');
    rig_->client().await("the copy", Milliseconds(5'000), [&] {
        return rig_->client().areOfSameClient(rig_->client().selectionOwner("CLIPBOARD"), source->window());
    });
    target_->activate();
    if (terminal) {
        rig_->keyboard().chord({Key::LeftShift}, Key::Insert);
    } else {
        rig_->keyboard().chord({Key::LeftControl}, U'v');
    }
    EXPECT_TRUE(target_->awaitPaste(Milliseconds(5'000)));
    EXPECT_EQ(target_->awaitText("copied text"), "copied text");
}

TEST_P(DesktopTargetTest, LatencyFromKeyToText) {
    constexpr int keys = 200;
    std::vector<microseconds> latencies;
    const int keycode = rig_->keyboard().keycodeOf(U'a');
    for (int i = 0; i < keys; ++i) {
        const auto pressed = steady_clock::now();
        rig_->keyboard().press(keycode);
        const auto change = target_->takeChange(Milliseconds(2'000));
        rig_->keyboard().release(keycode);
        rig_->keyboard().sync();
        ASSERT_TRUE(change.has_value());
        ASSERT_EQ(change->inserted, "a");
        ASSERT_GT(change->time, pressed);
        latencies.push_back(duration_cast<microseconds>(change->time - pressed));
    }
    std::ranges::sort(latencies);
    std::cout << nameOf(GetParam()) << ": key to text, median " << latencies[keys / 2].count() << " us, 95% "
              << latencies[keys * 95 / 100].count() << " us, longest " << latencies.back().count() << " us\n";
    EXPECT_LT(latencies[keys / 2], std::chrono::milliseconds(100));
}

// xterm tells assistive programs nothing.
using DesktopAccessibilityTest = DesktopTargetTest;

TEST_P(DesktopAccessibilityTest, TextIsSeenByAssistivePrograms) {
    rig_->keyboard().type("seen");
    ASSERT_EQ(target_->awaitText("seen"), "seen");
    const std::string program = GetParam() == TargetKind::GtkTextView ? "gtk_target" : "qt_target";
    const auto folder = std::filesystem::read_symlink("/proc/self/exe").parent_path();
    const auto probe = rig_->session().start({folder / "accessibility_probe", program, "5000"}, "plume");
    ASSERT_EQ(probe->waitForExit(Milliseconds(20'000)), 0) << probe->logTail();
    const auto seen = nlohmann::json::parse(probe->logTail());
    EXPECT_EQ(seen.at("role"), "text");
    EXPECT_EQ(seen.at("text"), "seen");
    EXPECT_EQ(seen.at("focused"), true);
}

INSTANTIATE_TEST_SUITE_P(All, DesktopTargetTest,
                         testing::Values(TargetKind::GtkTextView, TargetKind::QtTextEdit, TargetKind::Xterm),
                         [](const auto& tested) { return nameOf(tested.param); });

INSTANTIATE_TEST_SUITE_P(All, DesktopAccessibilityTest,
                         testing::Values(TargetKind::GtkTextView, TargetKind::QtTextEdit),
                         [](const auto& tested) { return nameOf(tested.param); });

TEST_F(DesktopSelftest, ScreenshotShowsTheWindows) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    rig_->keyboard().type("on the picture");
    ASSERT_EQ(target->awaitText("on the picture"), "on the picture");
    const auto file = rig_->directory() / "screen.png";
    writeScreenshot(rig_->client(), file);
    std::ifstream picture(file, std::ios::binary);
    std::string signature(8, '\0');
    picture.read(signature.data(), 8);
    EXPECT_EQ(signature, "\x89PNG\r\n\x1a\n");
    EXPECT_GT(std::filesystem::file_size(file), 2'000U);  // an empty screen compresses to far less
}

TEST_F(DesktopSelftest, KeysThatPrintNothingAreWhereTheKeyboardHasThem) {
    const auto target = rig_->startTarget(TargetKind::QtTextEdit);
    rig_->keyboard().type("bd");
    rig_->keyboard().tap(Key::Left);
    rig_->keyboard().type("c");
    rig_->keyboard().tap(Key::Home);
    rig_->keyboard().type("a");
    rig_->keyboard().tap(Key::Delete);
    rig_->keyboard().tap(Key::End);
    rig_->keyboard().tap(Key::Return);
    EXPECT_EQ(target->awaitText("acd\n"), "acd\n");
}

TEST_F(DesktopSelftest, PointerClicksWhereItPoints) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    rig_->keyboard().type("first\nsecond");
    ASSERT_EQ(target->awaitText("first\nsecond"), "first\nsecond");
    const auto place = rig_->client().placeOf(target->window());
    rig_->click(place.x + 100, place.y + 8);  // behind the end of the first line
    rig_->keyboard().type("!");
    EXPECT_EQ(target->awaitText("first!\nsecond"), "first!\nsecond");
}

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
    const Deadline deadline(Milliseconds(10'000));
    while (countProcessesOf(directory) > 0 && !deadline.passed()) deadline.waitReadable(-1, Milliseconds(5));
    return countProcessesOf(directory) == 0;
}

TEST(DesktopRigTest, LeavesNothingBehind) {
    std::filesystem::path directory;
    {
        DesktopRig rig;
        directory = rig.directory();
        const auto terminal = rig.startTarget(TargetKind::Xterm);
        const auto editor = rig.startTarget(TargetKind::GtkTextView);
        EXPECT_GE(countProcessesOf(directory), 6);
    }
    EXPECT_TRUE(awaitNoProcessOf(directory));
    EXPECT_FALSE(std::filesystem::exists(directory));
}

TEST(DesktopRigTest, EndsWithATestThatIsKilled) {
    std::array<int, 2> ends{};
    ASSERT_EQ(pipe(ends.data()), 0);
    const pid_t test = fork();
    if (test == 0) {
        DesktopRig rig;
        const auto terminal = rig.startTarget(TargetKind::Xterm);
        const std::string directory = rig.directory();
        if (write(ends[1], directory.data(), directory.size()) > 0) raise(SIGKILL);
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

TEST(DesktopRigTest, NamesThePackageOfAMissingPart) {
    EXPECT_THAT([] { requireProgram("no-such-window-manager", "no-such-package"); },
                testing::ThrowsMessage<RigError>(testing::HasSubstr("install the package no-such-package")));
    EXPECT_THAT([] { requireFile({"/nowhere/driver.so"}, "another-package"); },
                testing::ThrowsMessage<RigError>(testing::HasSubstr("install the package another-package")));
}

}  // namespace

}  // namespace plume::rig

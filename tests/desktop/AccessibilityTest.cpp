// What Plume learns of texts, carets and passwords in real programs, and what it costs when they do not answer.

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <chrono>
#include <csignal>
#include <cstring>

#include "Foundation/Strings.h"
#include "input/AXUtils.h"
#include "tests/desktop/AccessibilityDesktop.h"

namespace plume::rig {

namespace {

using std::chrono::steady_clock;

class AccessibilityTest : public AccessibilityDesktop, public testing::WithParamInterface<TargetKind> {
  protected:
    void SetUp() override { target_ = startFocused(GetParam()); }

    // The text, and the caret at its end.
    void write(const std::string& text) {
        target_->setText(text);
        rig_->keyboard().chord({Key::LeftControl}, Key::End);
        const auto units = static_cast<std::int64_t>(fromUtf8(text).size());
        EXPECT_TRUE(awaitSelection({units, 0}));
    }

    static bool awaitSelection(TextRange range) {
        return waitUntil([&] { return AXUtils::getSelectedTextRange(*accessibility_) == range; });
    }

    std::unique_ptr<TargetProgram> target_;
};

// What is answered in the end: on a busy machine a question may take too long, and the next ones get no answer then.
template <typename Question>
auto answerTo(Question question) {
    auto answer = question();
    waitUntil([&] {
        answer = question();
        return answer != decltype(answer)();
    });
    return answer;
}

std::optional<std::u16string> before(std::int64_t length, const Accessibility& accessibility) {
    return answerTo([&] { return AXUtils::getTextBeforeCaretWithMaxLength(accessibility, length); });
}

TEST_P(AccessibilityTest, TextBeforeTheCaretIsCountedInUnits) {
    write("naïve 日本 a😀b");
    using Text = std::optional<std::u16string>;
    EXPECT_EQ(before(1, *accessibility_), Text(u"b"));
    EXPECT_EQ(before(3, *accessibility_), Text(u"😀b"));
    EXPECT_EQ(before(4, *accessibility_), Text(u"a😀b"));
    EXPECT_EQ(before(100, *accessibility_), Text(u"naïve 日本 a😀b"));
    EXPECT_EQ(answerTo([] { return AXUtils::getValue(*accessibility_); }), Text(u"naïve 日本 a😀b"));
    rig_->keyboard().tap(Key::Left);
    rig_->keyboard().tap(Key::Left);
    ASSERT_TRUE(awaitSelection({10, 0}));
    EXPECT_EQ(before(3, *accessibility_), Text(u"本 a"));
    rig_->keyboard().chord({Key::LeftControl}, Key::Home);
    ASSERT_TRUE(awaitSelection({0, 0}));
    EXPECT_EQ(before(3, *accessibility_), Text(u""));
}

TEST_P(AccessibilityTest, AnyStretchOfTheTextIsReadAfterASelectionIsKnown) {
    write("😀😀😀 one 😀 two");
    rig_->keyboard().tap(Key::Home);
    for (int i = 0; i < 4; ++i) rig_->keyboard().tap(Key::Right);
    ASSERT_TRUE(awaitSelection({7, 0}));
    const auto focused = AXUtils::getFocusedUIElement(*accessibility_);
    ASSERT_TRUE(focused);
    ASSERT_EQ(answerTo([&] { return focused->rangeAttribute("AXSelectedTextRange"); }), (TextRange{7, 0}));
    const auto text = [&](TextRange range) {
        return answerTo([&] { return focused->stringForRange("AXStringForRange", range); });
    };
    using Text = std::optional<std::u16string>;
    EXPECT_EQ(text({2, 4}), Text(u"😀😀"));
    EXPECT_EQ(text({4, 6}), Text(u"😀 one"));
    EXPECT_EQ(text({11, 4}), Text(u"😀 t"));
    EXPECT_EQ(text({11, 6}), Text(u"😀 two"));
    EXPECT_EQ(focused->stringForRange("AXStringForRange", {11, 7}), std::nullopt);
    EXPECT_EQ(focused->stringForRange("AXStringForRange", {-1, 1}), std::nullopt);
}

TEST_P(AccessibilityTest, ElementsAreNamed) {
    using Text = std::optional<std::u16string>;
    const auto application = accessibility_->frontApplicationElement();
    ASSERT_TRUE(application);
    EXPECT_EQ(answerTo([&] { return application->stringAttribute("AXRole"); }), Text(u"AXApplication"));
    const auto focused = AXUtils::getFocusedUIElement(*accessibility_);
    ASSERT_TRUE(focused);
    EXPECT_EQ(answerTo([&] { return focused->stringAttribute("AXRole"); }), Text(u"AXTextArea"));
    EXPECT_EQ(focused->stringAttribute("AXSubrole"), std::nullopt);
    const auto window = GetParam() == TargetKind::QtTextEdit  // the edit is the window itself there
                            ? nullptr
                            : answerTo([] { return AXUtils::getFocusedTopLevelUIElement(*accessibility_); });
    if (GetParam() == TargetKind::GtkTextView) {
        ASSERT_TRUE(window);
        EXPECT_EQ(answerTo([&] { return window->stringAttribute("AXRole"); }), Text(u"AXWindow"));
        EXPECT_EQ(answerTo([&] { return window->stringAttribute("AXTitle"); }), Text(u"GTK text"));
        EXPECT_THAT(answerTo([&] { return window->elementsAttribute("AXChildren"); }), testing::SizeIs(1));
        const auto parent = answerTo([&] { return focused->elementAttribute("AXParent"); });
        ASSERT_TRUE(parent);
        EXPECT_EQ(answerTo([&] { return parent->stringAttribute("AXRole"); }), Text(u"AXScrollArea"));
    }
}

TEST_P(AccessibilityTest, CaretIsFoundOnTheScreen) {
    const auto window = rig_->client().placeOf(target_->window());
    accessibility_->setMainScreenHeight(0);
    const auto caret = [] {
        Rectangle bound = answerTo([] { return AXUtils::getSelectedTextBound(*accessibility_); });
        bound.origin.y = -bound.origin.y - bound.size.height;  // from the top again
        return bound;
    };
    target_->clear();
    const Rectangle empty = caret();
    EXPECT_GE(empty.origin.x, window.x - 2);
    EXPECT_GE(empty.origin.y, window.y - 2);
    EXPECT_LT(empty.origin.y, window.y + 40);
    EXPECT_LT(empty.size.height, 60) << "the first line of an empty text, and not the whole field";

    write("wide enough 😀");
    const Rectangle atEnd = caret();
    EXPECT_EQ(atEnd.size.width, 0);
    EXPECT_GT(atEnd.size.height, 5);
    EXPECT_LT(atEnd.size.height, 60);
    rig_->keyboard().tap(Key::Home);
    ASSERT_TRUE(awaitSelection({0, 0}));
    const Rectangle atStart = caret();
    EXPECT_GT(atEnd.origin.x, atStart.origin.x + 50);
    EXPECT_GE(atStart.origin.x, window.x);
    EXPECT_GE(atStart.origin.y, window.y);
    EXPECT_LT(atStart.origin.x, window.x + 40);

    rig_->keyboard().chord({Key::LeftShift}, Key::End);
    ASSERT_TRUE(awaitSelection({0, 14}));
    EXPECT_EQ(answerTo([] { return AXUtils::getSelectedTextLength(*accessibility_); }), 14);
    EXPECT_NEAR(caret().size.width, atEnd.origin.x - atStart.origin.x, 2);
    EXPECT_GT(answerTo([] { return AXUtils::getFocusedUIElementBound(*accessibility_); }).size.width, 100);
}

TEST_P(AccessibilityTest, PasswordsAreNoticedAndNotRead) {
    EXPECT_FALSE(accessibility_->focusIsPassword());
    target_->showPassword(true);
    accessibility_->focusMayHaveMoved();
    ASSERT_TRUE(awaitTyping([] { return accessibility_->focusIsPassword(); }));
    const auto focused = AXUtils::getFocusedUIElement(*accessibility_);
    ASSERT_TRUE(focused);
    EXPECT_EQ(answerTo([&] { return focused->stringAttribute("AXSubrole"); }),
              std::optional<std::u16string>(u"AXSecureTextField"));
    EXPECT_TRUE(answerTo([&] { return focused->rangeAttribute("AXSelectedTextRange"); }));
    EXPECT_EQ(focused->stringAttribute("AXValue"), std::nullopt);
    EXPECT_EQ(focused->stringForRange("AXStringForRange", {0, 1}), std::nullopt);
    target_->showPassword(false);
    EXPECT_TRUE(awaitTyping([] { return !accessibility_->focusIsPassword(); }));

    // A program that is killed takes its password along.
    target_->showPassword(true);
    ASSERT_TRUE(awaitTyping([] { return accessibility_->focusIsPassword(); }));
    ASSERT_EQ(kill(target_->pid(), SIGKILL), 0);
    EXPECT_TRUE(awaitTyping([] { return !accessibility_->focusIsPassword(); }));
    EXPECT_EQ(accessibility_->frontApplicationElement(), nullptr);
}

TEST_P(AccessibilityTest, FocusIsFollowedFromProgramToProgram) {
    const auto other = startFocused(TargetKind::GtkTextView);
    rig_->keyboard().type("there");
    EXPECT_TRUE(waitUntil([] { return AXUtils::getValue(*accessibility_) == u"there"; }));
    target_->activate();
    comesToFront(*target_);
    rig_->keyboard().type("here");
    EXPECT_TRUE(waitUntil([] { return AXUtils::getValue(*accessibility_) == u"here"; }));
    // A terminal tells nothing: whoever had the focus before must not stand for it, once it knows that it lost it.
    const auto terminal = startFocused(TargetKind::Xterm);
    EXPECT_TRUE(waitUntil([] { return accessibility_->frontApplicationElement() == nullptr; }));
}

// What a quick typist's corrections ask of a program that hangs, within a second.
std::chrono::duration<double, std::milli> costOfTwentyKeys(const AtspiAccessibility& accessibility) {
    const auto begin = steady_clock::now();
    for (int key = 0; key < 20; ++key) {
        EXPECT_EQ(AXUtils::getTextBeforeCaretWithMaxLength(accessibility, 3), std::nullopt);
        EXPECT_FALSE(accessibility.focusIsPassword());
    }
    return steady_clock::now() - begin;
}

TEST_P(AccessibilityTest, AProgramThatHangsCostsTwentyMilliseconds) {
    write("waiting");
    auto cost = std::chrono::duration<double, std::milli>::max();
    // A busy machine may keep this thread from running for longer than that: one of a few tries must do.
    for (int i = 0; i < 4 && cost.count() > 20; ++i) {
        ASSERT_TRUE(waitUntil([] { return before(3, *accessibility_) == u"ing"; }));
        ASSERT_EQ(kill(target_->pid(), SIGSTOP), 0);
        cost = costOfTwentyKeys(*accessibility_);
        ASSERT_EQ(kill(target_->pid(), SIGCONT), 0);
    }
    EXPECT_LE(cost.count(), 20);
    EXPECT_GT(cost.count(), 1);  // it was asked
    EXPECT_EQ(before(3, *accessibility_), u"ing");
}

INSTANTIATE_TEST_SUITE_P(All, AccessibilityTest, testing::Values(TargetKind::GtkTextView, TargetKind::QtTextEdit),
                         [](const auto& tested) { return nameOf(tested.param); });

TEST_F(AccessibilityDesktop, WhatHadTheFocusBeforeIsFound) {
    const auto target = startFocused(TargetKind::GtkTextView);
    accessibility_.reset();  // one at a time
    accessibility_ = std::make_unique<AtspiAccessibility>();
    comesToFront(*target);
}

TEST_F(AccessibilityDesktop, TellsThatTheSessionHasNotSwitchedItOn) {
    EXPECT_EQ(accessibility_->status(), AccessibilityStatus::SwitchedOff);
    EXPECT_THAT(sentenceOf(accessibility_->status()), testing::HasSubstr("toolkit-accessibility true"));
}

// ---- Sessions without accessibility: each in a process of its own, which has that session's environment. ----

[[noreturn]] void reportStatus(const char* sessionBus) {
    if (sessionBus != nullptr) {
        setenv("DBUS_SESSION_BUS_ADDRESS", sessionBus, 1);
    } else {
        unsetenv("DBUS_SESSION_BUS_ADDRESS");
    }
    setenv("XDG_RUNTIME_DIR", "/nonexistent", 1);
    unsetenv("DISPLAY");
    const AtspiAccessibility accessibility;
    const bool told = waitUntil([&] { return accessibility.status() != AccessibilityStatus::Starting; });
    const bool silent = accessibility.frontApplicationElement() == nullptr && !accessibility.focusIsPassword();
    std::exit(told && silent ? static_cast<int>(accessibility.status()) : 100);
}

TEST(AccessibilityMissingDeathTest, NoSession) {
    GTEST_FLAG_SET(death_test_style, "threadsafe");
    const auto noSession = testing::ExitedWithCode(static_cast<int>(AccessibilityStatus::NoSession));
    EXPECT_EXIT(reportStatus(nullptr), noSession, "");
    EXPECT_EXIT(reportStatus("unix:path=/nonexistent/bus"), noSession, "");
}

// A bus that takes the connection and never says anything.
[[noreturn]] void startAndEndWithSilentBus() {
    const FileDescriptor listener(socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0));
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    const std::string name = "plume-silent-bus-" + std::to_string(getpid());
    std::memcpy(address.sun_path + 1, name.data(), name.size());
    const auto size = static_cast<socklen_t>(offsetof(sockaddr_un, sun_path) + 1 + name.size());
    if (bind(listener.get(), reinterpret_cast<sockaddr*>(&address), size) != 0 || listen(listener.get(), 5) != 0) {
        std::exit(100);
    }
    setenv("DBUS_SESSION_BUS_ADDRESS", ("unix:abstract=" + name).c_str(), 1);
    const auto begin = steady_clock::now();
    { const AtspiAccessibility accessibility; }
    const bool quick = steady_clock::now() - begin < std::chrono::milliseconds(500);
    std::exit(quick ? 0 : 1);
}

TEST(AccessibilityMissingDeathTest, SilentBusDelaysNeitherStartNorEnd) {
    GTEST_FLAG_SET(death_test_style, "threadsafe");
    EXPECT_EXIT(startAndEndWithSilentBus(), testing::ExitedWithCode(0), "");
}

}  // namespace

}  // namespace plume::rig

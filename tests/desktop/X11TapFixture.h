// The keyboard tap of X11 on a rig of its own, and somebody who listens to it.
#pragma once

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <array>
#include <functional>
#include <memory>
#include <optional>
#include <ostream>
#include <string>
#include <utility>
#include <vector>

#include "Foundation/Strings.h"
#include "ports/x11/keyboard/TapConnection.h"
#include "ports/x11/keyboard/X11InputSources.h"
#include "ports/x11/keyboard/X11KeyboardTap.h"
#include "ports/x11/keyboard/XkbKeyboard.h"
#include "testing/rig/DesktopRig.h"
#include "testing/rig/SessionThread.h"

namespace plume::rig {

using Type = TapEvent::Type;

inline constexpr Milliseconds Bound{10'000};

struct Heard {
    Type type = Type::KeyDown;
    KeyCode keyCode = KeyCode::None;
    EventFlags flags;
    std::u16string string;
    bool composing = false;
    bool command = false;

    bool operator==(const Heard&) const = default;
    friend std::ostream& operator<<(std::ostream& out, const Heard& heard) {
        constexpr std::array<const char*, 3> Names{"down", "up", "flags"};
        out << Names[static_cast<std::size_t>(heard.type)] << ' ' << numberOf(heard.keyCode) << ' ' << std::hex
            << heard.flags.bits();
        for (const char16_t unit : heard.string) out << " U+" << static_cast<unsigned>(unit);
        return out << std::dec << (heard.composing ? " composing" : "") << (heard.command ? " command" : "");
    }
};

// Writes down what it hears and does as it is told. Tap thread.
class Listener final : public KeyboardTapListener {
  public:
    bool keyboardEvent(const TapEvent& event) override {
        heard.push_back(
            {event.type, event.keyCode, event.flags, std::u16string(event.string), event.composing, event.command});
        return decide && decide(event);
    }
    void tapDisabledByTimeout() override {
        ++timeouts;
        if (tapToEnable) tapToEnable->enable();
    }
    void tapDisabledByUserInput() override { ADD_FAILURE() << "nobody did that"; }
    void typingInterrupted() override { ++withheld; }

    std::vector<Heard> heard;
    std::function<bool(const TapEvent&)> decide;
    int timeouts = 0;
    int withheld = 0;
    X11KeyboardTap* tapToEnable = nullptr;  // as soon as it was lost; none if null
};

// Plume's ears on a rig's display. All of it is used inside run().
class TapThread : public SessionThread {
  public:
    explicit TapThread(const std::string& display) : SessionThread(display) {
        run([&] {
            keyboard = valueOrThrow(XkbKeyboard::open(session().connection()));
            keyboard->listenTo(session());
            inputSources = std::make_unique<X11InputSources>(*keyboard);
            connection = valueOrThrow(TapConnection::open(display, *keyboard));
            tap = std::make_unique<X11KeyboardTap>(loop(), *connection, *keyboard);
        });
    }
    ~TapThread() {
        run([this] { tap->remove(); });
        end();
    }

    std::unique_ptr<XkbKeyboard> keyboard;
    std::unique_ptr<X11InputSources> inputSources;
    std::unique_ptr<TapConnection> connection;
    std::unique_ptr<X11KeyboardTap> tap;
};

class X11TapTest : public testing::Test {
  protected:
    static void SetUpTestSuite() {
        rig_ = std::make_unique<DesktopRig>();
        rig_->keyboard().tap(Key::LeftShift);  // only a device that was used answers when asked to sync
    }
    static void TearDownTestSuite() { rig_.reset(); }

    void SetUp() override { tap_ = std::make_unique<TapThread>(rig_->server().display()); }
    void TearDown() override {
        rig_->keyboard().releaseAll();
        tap_.reset();
        EXPECT_EQ(keysDown(), std::vector<int>{}) << "what was pressed has to come up";
        if (layoutChanged_) setLayout({"us", "-option", ""});
    }

    void createTap() {
        const auto created = tap_->run([this] { return tap_->tap->create(listener_, false); });
        ASSERT_TRUE(created.ok()) << created.error().message;
    }
    void removeTap() {
        tap_->run([this] { tap_->tap->remove(); });
    }
    void setDecision(std::function<bool(const TapEvent&)> decide) {
        tap_->run([&] { listener_.decide = std::move(decide); });
    }
    std::vector<Heard> heard() {
        return tap_->run([this] { return listener_.heard; });
    }
    std::vector<Heard> takeHeard(std::size_t count) {
        await("keys are heard", [&] { return heard().size() >= count; });
        return tap_->run([this] { return std::exchange(listener_.heard, {}); });
    }
    static void await(const std::string& what, const std::function<bool()>& condition) {
        rig_->client().await(what, Bound, condition);
    }

    void setLayout(const std::vector<std::string>& arguments) {
        layoutChanged_ = true;
        std::vector<std::string> command{"setxkbmap"};
        command.insert(command.end(), arguments.begin(), arguments.end());
        const auto program = rig_->session().start(command, "x11-xkb-utils");
        ASSERT_EQ(program->waitForExit(Bound), 0) << program->logTail();
    }
    std::string identifier() {
        const auto name = tap_->run([this] { return tap_->inputSources->currentInputSourceIdentifier(); });
        return name ? toUtf8(*name) : "";
    }
    std::optional<std::u16string> translate(KeyCode keyCode, EventFlags flags) {
        return tap_->run([=, this] { return tap_->inputSources->translateKey(keyCode, flags); });
    }

    static void tapKey(int keycode) {
        rig_->keyboard().press(keycode);
        rig_->keyboard().release(keycode);
        rig_->keyboard().sync();
    }

    // On the main keyboard, as programs see it.
    static std::vector<int> keysDown() { return rig_->client().keysDown(); }

    static inline std::unique_ptr<DesktopRig> rig_;
    Listener listener_;  // outlives the tap
    std::unique_ptr<TapThread> tap_;
    bool layoutChanged_ = false;
};

}  // namespace plume::rig

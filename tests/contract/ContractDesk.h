// What a port has to show for the contract suites to be run on it: its interfaces, and hands to play the user and other
// programs with.
//
// A port adds itself with one file that implements these and instantiates the suites.
#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <optional>
#include <ostream>
#include <string>

#include "platform/Accessibility.h"
#include "platform/EventPoster.h"
#include "platform/InputSources.h"
#include "platform/KeyboardTap.h"
#include "platform/MouseTap.h"
#include "platform/Notices.h"
#include "platform/Pasteboard.h"
#include "platform/ProcessManager.h"
#include "platform/RunLoop.h"
#include "platform/SecureInput.h"
#include "platform/SystemHotKeys.h"

namespace plume {

// A run loop on the test's own thread.
class ContractLoop {
  public:
    virtual ~ContractLoop() = default;
    virtual RunLoop& runLoop() = 0;
    // Lets this time pass on the loop, running what is due by then, or a little later.
    virtual void run(double seconds) = 0;
};

// A desktop with two programs, each with an empty text field that has the focus, the first in front. The keyboard has a
// US layout.
class ContractDesk {
  public:
    enum class Program { First, Second };
    enum class Button { Left, Middle, Right, Wheel };

    virtual ~ContractDesk() = default;
    virtual Pasteboard& pasteboard() = 0;
    virtual KeyboardTap& keyboardTap() = 0;
    virtual EventPoster& poster() = 0;
    virtual ProcessManager& processManager() = 0;
    virtual InputSources& inputSources() = 0;
    virtual Accessibility& accessibility() = 0;
    virtual SecureInput& secureInput() = 0;
    virtual SystemHotKeys& systemHotKeys() = 0;
    virtual MouseTap& mouseTap() = 0;
    virtual Notices& notices() = 0;

    // Whether the poster can make the user's keys wait.
    virtual bool canHoldUserKeys() = 0;

    // Lets the port and the programs work, at least once, until the condition holds; false when it does not in good
    // time. On a real desktop nothing happens outside of it, and nobody can tell when all has happened: what must not
    // happen is shown by something later that did.
    virtual bool runUntil(const std::function<bool()>& condition) = 0;

    // The user's keyboard: a, b, c, Shift and Control.
    virtual void press(KeyCode keyCode) = 0;
    virtual void release(KeyCode keyCode) = 0;
    // The user moves the mouse there and clicks, or turns its wheel; no program minds it.
    virtual void click(Button button, Point place) = 0;
    virtual void activate(Program program) = 0;
    // What stands in the program's field.
    virtual std::u16string text(Program program) = 0;
    // Another program than Plume puts this on the clipboard, or reads the clipboard's text.
    virtual void copyElsewhere(const std::u16string& text) = 0;
    virtual std::optional<std::u16string> readElsewhere() = 0;
    // Another program takes the keyboard to itself, or gives it back.
    virtual void setKeyboardHeldElsewhere(bool held) = 0;
    // What the notice with that title says, if it is shown; and the user presses a button of it.
    virtual std::optional<std::string> notice(const std::string& title) = 0;
    virtual void pressNoticeButton(const std::string& title, const std::string& label) = 0;
};

template <typename Bench>
struct ContractPort {
    const char* name;
    std::function<std::unique_ptr<Bench>()> make;
};

template <typename Bench>
void PrintTo(const ContractPort<Bench>& port, std::ostream* stream) {
    *stream << port.name;
}

class RunLoopContract : public testing::TestWithParam<ContractPort<ContractLoop>> {
  protected:
    std::unique_ptr<ContractLoop> bench_ = GetParam().make();
    RunLoop& loop_ = bench_->runLoop();
};

class DeskContract : public testing::TestWithParam<ContractPort<ContractDesk>> {
  protected:
    using Program = ContractDesk::Program;
    std::unique_ptr<ContractDesk> desk_ = GetParam().make();
};

class PasteboardContract : public DeskContract {};
class KeyboardContract : public DeskContract {};
class ProcessManagerContract : public DeskContract {};
class InputSourcesContract : public DeskContract {};
class AccessibilityContract : public DeskContract {};
class SecureInputContract : public DeskContract {};
class MouseTapContract : public DeskContract {};
class NoticesContract : public DeskContract {};

class SystemHotKeysContract : public DeskContract {
  protected:
    static constexpr SystemHotKeys::Id FirstId = 1;
    static constexpr SystemHotKeys::Id SecondId = 2;

    // A desk may be there for longer than the test whose handlers these are.
    void TearDown() override {
        for (const auto id : {FirstId, SecondId}) desk_->systemHotKeys().unregisterHotKey(id);
    }
};

}  // namespace plume

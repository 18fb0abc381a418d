// The simulated desktop keeps what the platform's headers promise.
#include <algorithm>

#include "ports/simulated/SimulatedDesktop.h"
#include "tests/contract/ContractDesk.h"

namespace plume {

namespace {

class SimulatedLoop final : public ContractLoop {
  public:
    RunLoop& runLoop() override { return loop_; }
    void run(double seconds) override { loop_.advance(seconds); }

  private:
    SimulatedRunLoop loop_;
};

class SimulatedDesk final : public ContractDesk {
  public:
    explicit SimulatedDesk(bool canHoldUserKeys) : canHoldUserKeys_(canHoldUserKeys) {
        desktop_.keyboard().setCanHold(canHoldUserKeys);
        activate(Program::First);
    }

    Pasteboard& pasteboard() override { return desktop_.pasteboard(); }
    KeyboardTap& keyboardTap() override { return desktop_.keyboardTap(); }
    EventPoster& poster() override { return desktop_.poster(); }
    ProcessManager& processManager() override { return desktop_.processManager(); }
    InputSources& inputSources() override { return desktop_.inputSources(); }
    Accessibility& accessibility() override { return desktop_.accessibility(); }
    SecureInput& secureInput() override { return desktop_.secureInput(); }
    SystemHotKeys& systemHotKeys() override { return desktop_.systemHotKeys(); }
    MouseTap& mouseTap() override { return desktop_.mouseTap(); }
    Notices& notices() override { return desktop_.notices(); }
    bool canHoldUserKeys() override { return canHoldUserKeys_; }

    bool runUntil(const std::function<bool()>& condition) override {
        // In small steps: a look must not let the time of held keys run out.
        for (int step = 0; step < 500; ++step) {
            desktop_.runLoop().advance(0.01);
            if (condition()) return true;
        }
        return false;
    }

    void press(KeyCode keyCode) override { desktop_.keyboard().press(keyCode); }
    void release(KeyCode keyCode) override { desktop_.keyboard().release(keyCode); }
    void click(Button button, Point place) override {
        desktop_.poster().setPointerLocation(place);
        if (button != Button::Wheel) desktop_.click();
    }
    void activate(Program program) override { desktop_.activate(nameOf(program)); }
    std::u16string text(Program program) override { return desktop_.application(nameOf(program)).field().text(); }
    void copyElsewhere(const std::u16string& text) override { desktop_.pasteboard().copyFromProgram(text); }
    std::optional<std::u16string> readElsewhere() override { return desktop_.pasteboard().string(); }
    void setKeyboardHeldElsewhere(bool held) override { desktop_.secureInput().setEnabled(held); }

    std::optional<std::string> notice(const std::string& title) override {
        const auto& shown = desktop_.notices().shown();
        const auto found = std::ranges::find(shown, title, &Notice::title);
        return found != shown.end() ? std::optional(found->body) : std::nullopt;
    }
    void pressNoticeButton(const std::string& title, const std::string& label) override {
        desktop_.notices().press(title, label);
    }

  private:
    static std::u16string nameOf(Program program) {
        return program == Program::First ? u"org.example.first" : u"org.example.second";
    }

    const bool canHoldUserKeys_;
    SimulatedDesktop desktop_;
};

const ContractPort<ContractLoop> Loop{"Simulated", [] { return std::make_unique<SimulatedLoop>(); }};
const ContractPort<ContractDesk> Desk{"Simulated", [] { return std::make_unique<SimulatedDesk>(false); }};
const ContractPort<ContractDesk> HoldingDesk{"SimulatedHolding", [] { return std::make_unique<SimulatedDesk>(true); }};

}  // namespace

INSTANTIATE_TEST_SUITE_P(Simulated, RunLoopContract, testing::Values(Loop));
INSTANTIATE_TEST_SUITE_P(Simulated, PasteboardContract, testing::Values(Desk));
INSTANTIATE_TEST_SUITE_P(Simulated, KeyboardContract, testing::Values(Desk, HoldingDesk));
INSTANTIATE_TEST_SUITE_P(Simulated, ProcessManagerContract, testing::Values(Desk));
INSTANTIATE_TEST_SUITE_P(Simulated, InputSourcesContract, testing::Values(Desk));
INSTANTIATE_TEST_SUITE_P(Simulated, AccessibilityContract, testing::Values(Desk));
INSTANTIATE_TEST_SUITE_P(Simulated, SecureInputContract, testing::Values(Desk));
INSTANTIATE_TEST_SUITE_P(Simulated, SystemHotKeysContract, testing::Values(Desk));
INSTANTIATE_TEST_SUITE_P(Simulated, MouseTapContract, testing::Values(Desk));
INSTANTIATE_TEST_SUITE_P(Simulated, NoticesContract, testing::Values(Desk));

}  // namespace plume

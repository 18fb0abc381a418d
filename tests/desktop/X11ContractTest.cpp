// The X11 port, put together as the program does it, keeps what the platform's headers promise: the suites of
// tests/contract on one rig for all of them.
//
// The test's own thread is the tap thread: the loop runs while a test waits, and at no other time.
#include <chrono>
#include <future>
#include <map>

#include "Foundation/Strings.h"
#include "app/LinuxPort.h"
#include "tests/contract/ContractDesk.h"
#include "tests/desktop/Deadline.h"
#include "tests/desktop/DesktopRig.h"
#include "tests/desktop/SelectionClients.h"

// libatspi does not free all it allocates: leaks are not looked for in this program.
// NOLINTBEGIN(bugprone-reserved-identifier,cert-dcl37-c,cert-dcl51-cpp): the name is the sanitizer's
extern "C" const char* __asan_default_options();
const char* __asan_default_options() {
    return "detect_leaks=0";
}
// NOLINTEND(bugprone-reserved-identifier,cert-dcl37-c,cert-dcl51-cpp)

namespace plume::rig {

namespace {

constexpr Milliseconds Bound{10'000};
constexpr double Step = 0.005;  // seconds between two looks at a condition

// The keys that the suites press, as a US keyboard has them.
const std::map<std::uint16_t, int> Keycodes{{0, 38}, {11, 56}, {8, 54}, {56, static_cast<int>(Key::LeftShift)}};

// What is expensive to bring up, and what a process can have only once.
struct Desktop {
    Desktop() {
        rig.session().join();
        auto opened = LinuxPort::open(rig.server().display());
        if (!opened) throw RigError(opened.error().message);
        port = std::move(opened).value();
    }

    DesktopRig rig;
    std::unique_ptr<TargetProgram> second = rig.startTarget(TargetKind::GtkTextView);
    std::unique_ptr<TargetProgram> first = rig.startTarget(TargetKind::GtkTextView);
    std::unique_ptr<LinuxPort> port;
};

class DesktopEnvironment final : public testing::Environment {
  public:
    void SetUp() override { desktop = std::make_unique<Desktop>(); }
    void TearDown() override { desktop.reset(); }

    static inline std::unique_ptr<Desktop> desktop;
};

const testing::Environment* const TheEnvironment = testing::AddGlobalTestEnvironment(new DesktopEnvironment);

class X11Desk final : public ContractDesk {
  public:
    X11Desk() {
        activate(Program::First);
        // Keys of the test before may be on their way still: when this one has come, they have.
        desktop_.rig.keyboard().type("x");
        const bool isReady = runUntil([this] { return text(Program::First).ends_with(u'x') && isInFront(); });
        if (!isReady) throw RigError("the program in front is not known, or takes no keys");
        desktop_.first->clear();
        desktop_.second->clear();
    }
    ~X11Desk() override {
        desktop_.rig.keyboard().releaseAll();
        keyboardTap().remove();
        pasteboard().declareTypes({}, nullptr);
    }

    Pasteboard& pasteboard() override { return ports_.pasteboard; }
    KeyboardTap& keyboardTap() override { return ports_.keyboardTap; }
    EventPoster& poster() override { return ports_.poster; }
    ProcessManager& processManager() override { return ports_.processManager; }
    InputSources& inputSources() override { return ports_.inputSources; }
    Accessibility& accessibility() override { return ports_.accessibility; }

    bool runUntil(const std::function<bool()>& condition) override {
        PollRunLoop& loop = desktop_.port->tapLoop();
        const Deadline deadline(Bound);
        do {
            loop.performAfterDelay(Step, [&loop] { loop.stop(); });
            loop.run();
            if (condition()) return true;
        } while (!deadline.passed());
        return false;
    }

    void press(std::uint16_t keyCode) override { desktop_.rig.keyboard().press(Keycodes.at(keyCode)); }
    void release(std::uint16_t keyCode) override { desktop_.rig.keyboard().release(Keycodes.at(keyCode)); }
    void activate(Program program) override { target(program).activate(); }
    std::u16string text(Program program) override { return fromUtf8(target(program).text()); }
    void copyElsewhere(const std::u16string& text) override {
        const SelectionData data{.type = "UTF8_STRING", .bytes = toUtf8(text)};
        elsewhere_ = std::make_unique<ForeignOwner>(display(), SelectionOffer{{"UTF8_STRING", data}});
    }
    // On a thread of its own: Plume may have to answer.
    std::optional<std::u16string> readElsewhere() override {
        auto answer = std::async(std::launch::async,
                                 [this] { return SelectionRequestor(display()).request("CLIPBOARD", "UTF8_STRING"); });
        runUntil([&] { return answer.wait_for(std::chrono::seconds(0)) == std::future_status::ready; });
        const auto data = answer.get();
        return data ? std::optional(fromUtf8(data->bytes)) : std::nullopt;
    }

  private:
    TargetProgram& target(Program program) const {
        return program == Program::First ? *desktop_.first : *desktop_.second;
    }
    const std::string& display() { return desktop_.rig.server().display(); }
    bool isInFront() {
        const auto process = processManager().frontProcess();
        const auto application = process ? processManager().runningApplication(*process) : std::nullopt;
        return application && application->processIdentifier == desktop_.first->pid();
    }

    Desktop& desktop_ = *DesktopEnvironment::desktop;
    const Composition::Ports ports_ = desktop_.port->ports();
    std::unique_ptr<ForeignOwner> elsewhere_;
};

const ContractPort<ContractDesk> Desk{"X11", [] { return std::make_unique<X11Desk>(); }};

}  // namespace

}  // namespace plume::rig

namespace plume {

using rig::Desk;
INSTANTIATE_TEST_SUITE_P(X11, PasteboardContract, testing::Values(Desk));
INSTANTIATE_TEST_SUITE_P(X11, KeyboardContract, testing::Values(Desk));
INSTANTIATE_TEST_SUITE_P(X11, ProcessManagerContract, testing::Values(Desk));
INSTANTIATE_TEST_SUITE_P(X11, InputSourcesContract, testing::Values(Desk));
INSTANTIATE_TEST_SUITE_P(X11, AccessibilityContract, testing::Values(Desk));

}  // namespace plume

// The virtual time. What all run loops have in common is in tests/contract.
#include "ports/simulated/SimulatedRunLoop.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

namespace plume {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class SimulatedRunLoopTest : public testing::Test {
  protected:
    // Writes down its name and the time.
    RunLoop::Call note(const std::string& name) {
        return [this, name] { log.push_back(name + "@" + std::to_string(static_cast<int>(loop.now()))); };
    }

    void later(double delay, RunLoop::Call call) { timers.push_back(loop.performAfterDelay(delay, std::move(call))); }

    SimulatedRunLoop loop;
    std::vector<Timer> timers;
    std::vector<std::string> log;
};

TEST_F(SimulatedRunLoopTest, RunsWhatCallsAskFor) {
    later(1, [this] {
        note("first")();
        later(0, note("at once"));
        later(1, note("later"));
        later(5, note("much later"));
    });
    loop.advance(2);
    EXPECT_THAT(log, ElementsAre("first@1", "at once@1", "later@2"));
    EXPECT_EQ(loop.nextDue(), 6);
}

TEST_F(SimulatedRunLoopTest, RunsLateWhatIsOverdue) {
    later(1, note("a"));
    loop.setNow(10);
    EXPECT_THAT(log, IsEmpty());
    loop.setNow(5);
    EXPECT_EQ(loop.now(), 10) << "time never goes back";
    loop.runReady();
    EXPECT_THAT(log, ElementsAre("a@10"));
}

TEST_F(SimulatedRunLoopTest, CallsWithoutEndAtOneMomentAreReported) {
    RunLoop::Call repeat = [&] { later(0, repeat); };
    repeat();
    EXPECT_THROW(loop.advance(1), std::runtime_error);
}

}  // namespace
}  // namespace plume

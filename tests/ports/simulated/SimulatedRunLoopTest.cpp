#include "ports/simulated/SimulatedRunLoop.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <stdexcept>
#include <string>
#include <thread>
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

    SimulatedRunLoop loop;
    std::vector<std::string> log;
};

TEST_F(SimulatedRunLoopTest, RunsDelayedCallsAtTheirMomentInTheOrderAskedFor) {
    loop.schedule(3, note("c"));
    loop.schedule(1, note("a"));
    loop.schedule(3, note("d"));
    loop.schedule(2, note("b"));
    loop.advance(2.5);
    EXPECT_THAT(log, ElementsAre("a@1", "b@2"));
    EXPECT_DOUBLE_EQ(loop.now(), 2.5);
    loop.advance(0.5);
    EXPECT_THAT(log, ElementsAre("a@1", "b@2", "c@3", "d@3"));
}

TEST_F(SimulatedRunLoopTest, NeverRunsACallFromInsideTheAsking) {
    loop.schedule(0, note("delayed"));
    loop.schedule(-1, note("late"));
    loop.perform(note("handed over"));
    EXPECT_THAT(log, IsEmpty());
    loop.runReady();
    EXPECT_THAT(log, ElementsAre("handed over@0", "delayed@0", "late@0"));
}

TEST_F(SimulatedRunLoopTest, RunsWhatCallsAskFor) {
    loop.schedule(1, [this] {
        note("first")();
        loop.schedule(0, note("at once"));
        loop.schedule(1, note("later"));
        loop.schedule(5, note("much later"));
    });
    loop.advance(2);
    EXPECT_THAT(log, ElementsAre("first@1", "at once@1", "later@2"));
    EXPECT_EQ(loop.nextDue(), 6);
}

TEST_F(SimulatedRunLoopTest, ForgetsCancelledCalls) {
    const auto a = loop.schedule(1, note("a"));
    const auto b = loop.schedule(1, note("b"));
    loop.schedule(0.5, [&] { loop.cancel(b); });
    loop.cancel(a);
    loop.cancel(a);
    loop.cancel(0);
    loop.advance(2);
    EXPECT_THAT(log, IsEmpty());
    loop.cancel(b);
    EXPECT_EQ(loop.nextDue(), std::nullopt);
}

TEST_F(SimulatedRunLoopTest, RunsLateWhatIsOverdue) {
    loop.schedule(1, note("a"));
    loop.setNow(10);
    EXPECT_THAT(log, IsEmpty());
    loop.setNow(5);
    EXPECT_EQ(loop.now(), 10) << "time never goes back";
    loop.runReady();
    EXPECT_THAT(log, ElementsAre("a@10"));
}

TEST_F(SimulatedRunLoopTest, RunsUntilIdleWithinItsBound) {
    loop.schedule(10, note("a"));
    loop.schedule(50, note("b"));
    EXPECT_FALSE(loop.runUntilIdle(20));
    EXPECT_EQ(loop.now(), 10);
    EXPECT_TRUE(loop.runUntilIdle());
    EXPECT_THAT(log, ElementsAre("a@10", "b@50"));
    EXPECT_EQ(loop.now(), 50) << "time stops at the last call";
}

TEST_F(SimulatedRunLoopTest, ARepeatingCallIsNeverIdle) {
    RunLoop::Call repeat = [&] { loop.schedule(1, repeat); };
    repeat();
    EXPECT_FALSE(loop.runUntilIdle(100));
    EXPECT_EQ(loop.now(), 100);
}

TEST_F(SimulatedRunLoopTest, CallsWithoutEndAtOneMomentAreReported) {
    RunLoop::Call repeat = [&] { loop.schedule(0, repeat); };
    repeat();
    EXPECT_THROW(loop.advance(1), std::runtime_error);
}

TEST_F(SimulatedRunLoopTest, ACallMayRunFurtherOnes) {
    loop.schedule(1, [this] {
        loop.advance(2);
        note("outer")();
    });
    loop.schedule(2, note("inner"));
    loop.advance(1);
    EXPECT_THAT(log, ElementsAre("inner@2", "outer@3"));
    EXPECT_EQ(loop.now(), 3);
}

TEST_F(SimulatedRunLoopTest, TakesCallsFromOtherThreadsInTheirOrder) {
    std::vector<std::vector<int>> seen(4);
    std::vector<std::thread> threads;
    for (auto& sequence : seen) {
        threads.emplace_back([this, &sequence] {
            for (int i = 0; i < 1000; ++i) loop.perform([&sequence, i] { sequence.push_back(i); });
        });
    }
    loop.runReady();
    for (auto& thread : threads) thread.join();
    loop.runReady();
    for (const auto& sequence : seen) {
        ASSERT_EQ(sequence.size(), 1000U);
        for (int i = 0; i < 1000; ++i) ASSERT_EQ(sequence[static_cast<std::size_t>(i)], i);
    }
}

}  // namespace
}  // namespace plume

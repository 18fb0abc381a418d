#include "engine/BackgroundTasks.h"

#include <gtest/gtest.h>

#include <atomic>
#include <future>
#include <memory>

#include "ports/simulated/SimulatedRunLoop.h"

namespace plume {
namespace {

TEST(BackgroundTasks, RunAsManySideBySideAsAllowedAndTheRestAfterThem) {
    SimulatedRunLoop loop;
    BackgroundTasks tasks(loop);
    std::size_t finished = 0;
    std::atomic<std::size_t> running = 0;
    std::atomic<std::size_t> done = 0;
    std::promise<void> full;
    std::promise<void> gate;
    const std::shared_future<void> opened = gate.get_future().share();
    constexpr std::size_t Count = BackgroundTasks::MaximumThreads * 3;
    for (std::size_t i = 0; i < Count; ++i) {
        const auto work = [&] {
            const std::size_t now = ++running;
            if (now == BackgroundTasks::MaximumThreads) full.set_value();
            opened.wait();
            ++done;
        };
        ASSERT_TRUE(tasks.run(work, [&] { ++finished; }));
    }
    full.get_future().wait();
    EXPECT_EQ(done, 0U);
    EXPECT_EQ(running, BackgroundTasks::MaximumThreads);
    gate.set_value();
    tasks.waitUntilIdle();
    EXPECT_EQ(done, Count);
    EXPECT_EQ(finished, 0U) << "the loop has not run";
    EXPECT_TRUE(tasks.arePending());
    loop.runReady();
    EXPECT_EQ(finished, Count);
    EXPECT_FALSE(tasks.arePending());
}

TEST(BackgroundTasks, LetGoOfTheWorkBeforeItIsFinished) {
    SimulatedRunLoop loop;
    BackgroundTasks tasks(loop);
    auto held = std::make_shared<int>(1);
    const std::weak_ptr<int> watched = held;
    ASSERT_TRUE(tasks.run([held = std::move(held)] {}, [] {}));
    tasks.waitUntilIdle();
    EXPECT_TRUE(watched.expired());
}

TEST(BackgroundTasks, AtTheEndWaitForWhatRunsAndDropTheRest) {
    SimulatedRunLoop loop;
    bool finished = false;
    std::atomic<std::size_t> done = 0;
    std::promise<void> gate;
    const std::shared_future<void> opened = gate.get_future().share();
    std::atomic<std::size_t> begun = 0;
    std::promise<void> full;
    std::thread opener;
    {
        BackgroundTasks tasks(loop);
        for (std::size_t i = 0; i < BackgroundTasks::MaximumThreads; ++i) {
            const auto work = [&] {
                if (++begun == BackgroundTasks::MaximumThreads) full.set_value();
                opened.wait();
                ++done;
            };
            ASSERT_TRUE(tasks.run(work, [&] { finished = true; }));
        }
        full.get_future().wait();
        auto waits = std::make_shared<std::promise<void>>();
        const std::shared_future<void> dropped = waits->get_future().share();
        ASSERT_TRUE(tasks.run([&done, waits = std::move(waits)] { done += 1000; }, [] {}));
        // The tasks that run may end only once the waiting one was dropped, which breaks its promise.
        opener = std::thread([dropped, &gate] {
            dropped.wait();
            gate.set_value();
        });
    }
    opener.join();
    EXPECT_EQ(done, BackgroundTasks::MaximumThreads);
    loop.runReady();
    EXPECT_FALSE(finished) << "nobody is left to finish for";
}

}  // namespace
}  // namespace plume

#include <string>
#include <thread>

#include "tests/contract/ContractDesk.h"

namespace plume {

TEST_P(RunLoopContract, CallsInTheOrderOfTheirMoments) {
    std::string order;
    // Far enough apart for a busy machine, on which time passes between these lines.
    loop_.schedule(0.2, [&] { order += 'c'; });
    loop_.schedule(0, [&] { order += 'a'; });
    loop_.schedule(0.1, [&] { order += 'b'; });
    EXPECT_EQ(order, "") << "a call from inside performAfterDelay";
    bench_->run(0.3);
    EXPECT_EQ(order, "abc");
}

TEST_P(RunLoopContract, KeepsTheOrderOfCallsForOneMoment) {
    std::string order;
    for (const char name : {'a', 'b', 'c'}) loop_.schedule(0, [&order, name] { order += name; });
    bench_->run(0.01);
    EXPECT_EQ(order, "abc");
}

TEST_P(RunLoopContract, NeverCallsEarly) {
    const double asked = loop_.now();
    double called = 0;
    loop_.schedule(0.03, [&] { called = loop_.now(); });
    bench_->run(0.05);
    EXPECT_GE(called, asked + 0.03);
}

TEST_P(RunLoopContract, ForgetsCancelledCalls) {
    std::string order;
    const RunLoop::CallId kept = loop_.schedule(0, [&] { order += 'k'; });
    const RunLoop::CallId cancelled = loop_.schedule(0, [&] { order += 'x'; });
    loop_.cancel(cancelled);
    loop_.cancel(cancelled);
    loop_.cancel(0);
    bench_->run(0.01);
    loop_.cancel(kept);
    EXPECT_EQ(order, "k");
}

TEST_P(RunLoopContract, TimersThatGoOrAreGivenAnotherCallForgetTheirs) {
    std::string order;
    const auto call = [&](char name) { return [&order, name] { order += name; }; };
    Timer empty = loop_.performAfterDelay(0, call('m'));
    Timer moved = std::move(empty);
    EXPECT_FALSE(empty);  // NOLINT(bugprone-use-after-move): what is promised
    EXPECT_TRUE(moved);
    Timer given = loop_.performAfterDelay(0, call('x'));
    given = loop_.performAfterDelay(0, call('g'));
    Timer cancelled = loop_.performAfterDelay(0, call('x'));
    cancelled.cancel();
    cancelled.cancel();
    { const Timer gone = loop_.performAfterDelay(0, call('x')); }
    bench_->run(0.01);
    EXPECT_EQ(order, "mg");
    moved.cancel();
}

TEST_P(RunLoopContract, LetsACallCancelOneThatIsDueWithIt) {
    std::string order;
    RunLoop::CallId second = 0;
    loop_.schedule(0, [&] {
        order += 'a';
        loop_.cancel(second);
    });
    second = loop_.schedule(0, [&] { order += 'b'; });
    bench_->run(0.01);
    EXPECT_EQ(order, "a");
}

TEST_P(RunLoopContract, TakesCallsFromOtherThreadsInOrder) {
    std::string order;
    std::thread::id where;
    std::thread other([&] {
        loop_.perform([&] { order += 'a'; });
        loop_.perform([&] {
            order += 'b';
            where = std::this_thread::get_id();
        });
    });
    other.join();
    bench_->run(0.01);
    EXPECT_EQ(order, "ab");
    EXPECT_EQ(where, std::this_thread::get_id());
}

}  // namespace plume

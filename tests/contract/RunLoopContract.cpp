#include <string>
#include <thread>

#include "tests/contract/ContractDesk.h"

namespace plume {

TEST_P(RunLoopContract, CallsInTheOrderOfTheirMomentsAndNeverEarly) {
    std::string order;
    const double asked = loop_.now();
    // Far enough apart for a busy machine, on which time passes between these lines.
    const Timer last = loop_.performAfterDelay(0.2, [&] { order += 'd'; });
    const Timer first = loop_.performAfterDelay(0, [&] { order += 'a'; });
    const Timer second = loop_.performAfterDelay(0, [&] { order += 'b'; });
    const Timer third = loop_.performAfterDelay(0.04, [&] {
        order += 'c';
        EXPECT_GE(loop_.now(), asked + 0.04);
    });
    EXPECT_EQ(order, "") << "a call from inside performAfterDelay";
    bench_->run(0.3);
    EXPECT_EQ(order, "abcd");
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
    Timer dueToo;
    const Timer canceller = loop_.performAfterDelay(0, [&] { dueToo.cancel(); });
    dueToo = loop_.performAfterDelay(0, call('x'));
    bench_->run(0.01);
    EXPECT_EQ(order, "mg");
    moved.cancel();  // whose call has run
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

#include "ports/posix/PollRunLoop.h"

#include <gmock/gmock.h>
#include <unistd.h>

#include <array>
#include <chrono>
#include <string>
#include <thread>

namespace plume {
namespace {

using testing::ElementsAre;

class PollRunLoopTest : public testing::Test {
  protected:
    // Everything that was asked for, up to here, happens.
    void runUntil(double delay) {
        const Timer end = loop.performAfterDelay(delay, [this] { loop.stop(); });
        loop.run();
    }
    RunLoop::Call note(std::string what) {
        return [this, what = std::move(what)] { happened.push_back(what); };
    }

    PollRunLoop loop;
    std::vector<std::string> happened;
};

TEST_F(PollRunLoopTest, CallsFromOtherThreadsWakeItAndKeepTheirOrder) {
    std::thread other([this] {
        for (int i = 0; i < 1000; ++i) loop.perform([this, i] { happened.push_back(std::to_string(i)); });
        loop.perform([this] { loop.stop(); });
    });
    loop.run();
    other.join();
    ASSERT_EQ(happened.size(), 1000U);
    for (int i = 0; i < 1000; ++i) EXPECT_EQ(happened[static_cast<std::size_t>(i)], std::to_string(i));
}

TEST_F(PollRunLoopTest, StopThatCameFirstHolds) {
    loop.stop();
    loop.run();
    EXPECT_THAT(happened, ElementsAre());
}

class PipeSource {
  public:
    PipeSource() {
        if (pipe(ends_.data()) != 0) throw std::runtime_error("pipe");
    }
    ~PipeSource() {
        close(ends_[0]);
        close(ends_[1]);
    }
    int descriptor() const { return ends_[0]; }
    void write(char byte) const { EXPECT_EQ(::write(ends_[1], &byte, 1), 1); }
    char read() const {
        char byte = 0;
        EXPECT_EQ(::read(ends_[0], &byte, 1), 1);
        return byte;
    }

  private:
    std::array<int, 2> ends_{};
};

TEST_F(PollRunLoopTest, PausedSourcesKeepTheirInputAndItsOrder) {
    const PipeSource source;
    int waiting = 3;
    const Subscription reading = loop.addSource(source.descriptor(), [&] {
        for (; waiting > 0; --waiting) happened.emplace_back(1, source.read());
    });
    for (const char byte : {'a', 'b', 'c'}) source.write(byte);
    loop.setSourcePaused(source.descriptor(), true);
    const Timer unpausing = loop.performAfterDelay(0.005, [&] {
        note("unpaused")();
        loop.setSourcePaused(source.descriptor(), false);
    });
    runUntil(0.02);
    EXPECT_THAT(happened, ElementsAre("unpaused", "a", "b", "c"));
}

TEST_F(PollRunLoopTest, ASourceMayEndItself) {
    const PipeSource source;
    Subscription reading = loop.addSource(source.descriptor(), [&] {
        note("drained")();
        reading.end();
    });
    source.write('x');
    const Timer waking = loop.performAfterDelay(0.001, note("woken"));
    runUntil(0.005);
    EXPECT_THAT(happened, ElementsAre("drained", "woken"));
}

// A call that asks for itself again and again leaves the others their turn.
TEST_F(PollRunLoopTest, ARestlessCallDoesNotStarveTheRest) {
    Timer restless;
    std::function<void()> again = [&] { restless = loop.performAfterDelay(0, again); };
    again();
    Timer end;
    loop.perform([&] { end = loop.performAfterDelay(0, [this] { loop.stop(); }); });
    loop.run();
}

}  // namespace
}  // namespace plume

#include "Foundation/ZDEvent.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>

namespace plume {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

struct Arguments {
    std::vector<std::string> calls;
};

using Event = ZDEvent<Arguments>;

class Listener {
  public:
    explicit Listener(std::string name) : name_(std::move(name)) {}

    void first(Arguments& arguments) {
        arguments.calls.push_back(name_ + ".first");
        if (during) during();
    }
    void second(Arguments& arguments) { arguments.calls.push_back(name_ + ".second"); }

    std::function<void()> during;

  private:
    std::string name_;
};

class ZDEventTest : public testing::Test {
  protected:
    void listen(Listener& listener, void (Listener::*selector)(Arguments&)) {
        subscriptions_.push_back(event_.addObserver(&listener, selector));
    }
    std::vector<std::string> raise() {
        Arguments arguments;
        event_.raise(arguments);
        return arguments.calls;
    }

    // Stands for the main thread: keeps the calls until they are run.
    Event::Post later() {
        return [this](std::function<void()> call) { queue_.push_back(std::move(call)); };
    }
    void runQueue() {
        for (const auto& call : queue_) call();
        queue_.clear();
    }

    Event event_;
    Listener a_{"a"};
    Listener b_{"b"};
    std::vector<std::function<void()>> queue_;
    std::vector<Subscription> subscriptions_;
};

TEST_F(ZDEventTest, CallsInTheOrderOfRegistrationAndRemovesTheFirstThatWasNamed) {
    listen(a_, &Listener::first);
    listen(b_, &Listener::second);
    listen(b_, &Listener::first);
    listen(a_, &Listener::first);
    EXPECT_THAT(raise(), ElementsAre("a.first", "b.second", "b.first", "a.first"));
    event_.removeObserver(&a_, &Listener::first);
    event_.removeObserver(&a_, &Listener::second);
    EXPECT_THAT(raise(), ElementsAre("b.second", "b.first", "a.first"));
}

TEST_F(ZDEventTest, HandlersMayRemoveThemselvesAndOthersWhileTheEventIsRaised) {
    a_.during = [this] {
        event_.removeObserver(&a_, &Listener::first);
        for (int i = 0; i < 2; ++i) event_.removeObserver(&b_, &Listener::first);
    };
    listen(b_, &Listener::first);
    listen(a_, &Listener::first);
    listen(b_, &Listener::first);
    listen(a_, &Listener::second);
    EXPECT_THAT(raise(), ElementsAre("b.first", "a.first", "a.second"));
    EXPECT_THAT(raise(), ElementsAre("a.second"));
}

TEST_F(ZDEventTest, AHandlerAddedWhileTheEventIsRaisedIsCalledFromTheNextTimeOn) {
    a_.during = [this] {
        a_.during = nullptr;
        for (int i = 0; i < 100; ++i) listen(b_, &Listener::second);
    };
    listen(a_, &Listener::first);
    listen(b_, &Listener::first);
    EXPECT_THAT(raise(), ElementsAre("a.first", "b.first"));
    EXPECT_EQ(raise().size(), 102U);
}

TEST_F(ZDEventTest, RemovingWhileRaisedWithinAHandlerKeepsThePlacesOfTheOuterRaise) {
    std::vector<std::string> inner;
    a_.during = [&] {
        a_.during = nullptr;
        event_.removeObserver(&a_, &Listener::first);
        inner = raise();
    };
    listen(a_, &Listener::first);
    listen(b_, &Listener::first);
    listen(b_, &Listener::second);
    EXPECT_THAT(raise(), ElementsAre("a.first", "b.first", "b.second"));
    EXPECT_THAT(inner, ElementsAre("b.first", "b.second"));
}

TEST_F(ZDEventTest, ASubscriptionThatEndsRemovesItsHandlerAlone) {
    Subscription first = event_.addObserver(&a_, &Listener::first);
    Subscription second = event_.addObserver(&b_, &Listener::first);
    first = std::move(second);
    EXPECT_THAT(raise(), ElementsAre("b.first"));
    a_.during = [&first] { first.end(); };
    listen(a_, &Listener::first);
    EXPECT_THAT(raise(), ElementsAre("b.first", "a.first"));
    EXPECT_THAT(raise(), ElementsAre("a.first"));
    subscriptions_.clear();
    EXPECT_FALSE(event_.isObserved());
}

TEST_F(ZDEventTest, OnTheMainThreadEveryHandlerGetsACallOfItsOwnUnlessRemovedBefore) {
    listen(b_, &Listener::second);
    listen(a_, &Listener::first);
    listen(b_, &Listener::first);
    const auto arguments = std::make_shared<Arguments>();
    event_.raiseOnMainThread(arguments, later());
    EXPECT_EQ(queue_.size(), 3U);
    EXPECT_THAT(arguments->calls, IsEmpty());
    event_.removeObserver(&a_, &Listener::first);
    runQueue();
    EXPECT_THAT(arguments->calls, ElementsAre("b.second", "b.first"));
}

TEST_F(ZDEventTest, QueuedCallsKeepTheArgumentAliveAndOutliveTheEvent) {
    auto arguments = std::make_shared<Arguments>();
    const std::weak_ptr<Arguments> watched = arguments;
    {
        Event event;
        subscriptions_.push_back(event.addObserver(&a_, &Listener::first));
        event.raiseOnMainThread(arguments, later());
    }
    arguments.reset();
    EXPECT_FALSE(watched.expired());
    runQueue();
    EXPECT_TRUE(watched.expired());
}

}  // namespace
}  // namespace plume

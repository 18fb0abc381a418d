// Events as the input service raises them.
#include "Foundation/ZDEvent.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "input/EventArgs.h"

namespace plume {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

struct Listener {
    Listener(std::vector<std::string>& aLog, std::string aName) : log(aLog), name(std::move(aName)) {}
    void hear(ZDKeyEventArgs& args) { log.push_back(name + (args.cancel ? " cancelled" : "")); }
    void hearToo(ZDKeyEventArgs& /*event*/) { log.push_back(name + " too"); }
    void cancel(ZDKeyEventArgs& args) { args.cancel = true; }
    void leave(ZDKeyEventArgs& /*event*/) { event->removeObservers(this); }
    void invite(ZDKeyEventArgs& /*event*/) { event->addObserver(this, &Listener::hear); }

    std::vector<std::string>& log;
    std::string name;
    ZDEvent<ZDKeyEventArgs>* event = nullptr;
};

class Events : public ::testing::Test {
  protected:
    bool raise() {
        ZDKeyEventArgs args;
        event.raise(args);
        return args.cancel;
    }

    std::vector<std::string> log;
    ZDEvent<ZDKeyEventArgs> event;
    Listener a{log, "a"};
    Listener b{log, "b"};
};

TEST_F(Events, ReachTheirListenersInOrderAndTellThemOfCancelling) {
    event.addObserver(&b, &Listener::hear);
    event.addObserver(&a, &Listener::cancel);
    event.addObserver(&a, &Listener::hear);
    EXPECT_TRUE(raise());
    EXPECT_THAT(log, ElementsAre("b", "a cancelled"));
}

TEST_F(Events, LoseOnlyTheFirstOfTwoEqualListeners) {
    event.addObserver(&a, &Listener::hear);
    event.addObserver(&b, &Listener::hear);
    event.addObserver(&a, &Listener::hear);
    event.removeObserver(&a, &Listener::hear);
    raise();
    EXPECT_THAT(log, ElementsAre("b", "a"));
}

TEST_F(Events, TellListenersApartByObserverAndOperation) {
    event.addObserver(&a, &Listener::hear);
    event.addObserver(&a, &Listener::hearToo);
    event.removeObserver(&b, &Listener::hear);
    event.removeObserver(&a, &Listener::hear);
    raise();
    EXPECT_THAT(log, ElementsAre("a too"));
}

TEST_F(Events, MayLoseListenersWhileTheyAreRaised) {
    a.event = &event;
    event.addObserver(&a, &Listener::leave);
    event.addObserver(&a, &Listener::hear);
    event.addObserver(&b, &Listener::hear);
    raise();
    EXPECT_THAT(log, ElementsAre("b"));
    raise();
    EXPECT_THAT(log, ElementsAre("b", "b"));
}

TEST_F(Events, TellNewListenersFromTheNextTimeOn) {
    a.event = &event;
    event.addObserver(&a, &Listener::invite);
    raise();
    EXPECT_THAT(log, IsEmpty());
    raise();
    EXPECT_THAT(log, ElementsAre("a"));
}

TEST_F(Events, OnTheMainThreadWaitTheirTurn) {
    std::vector<std::function<void()>> posted;
    event.addObserver(&a, &Listener::hear);
    event.addObserver(&b, &Listener::hear);
    event.raiseOnMainThread(std::make_shared<ZDKeyEventArgs>(),
                            [&](std::function<void()> call) { posted.push_back(std::move(call)); });
    EXPECT_THAT(log, IsEmpty());
    event.removeObservers(&a);
    for (const auto& call : posted) call();
    EXPECT_THAT(log, ElementsAre("b"));
}

}  // namespace
}  // namespace plume

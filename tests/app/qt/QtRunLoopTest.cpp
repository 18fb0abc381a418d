// Qt's event loop keeps what platform/RunLoop.h promises.
#include "app/qt/QtRunLoop.h"

#include <sys/eventfd.h>
#include <unistd.h>

#include <QEventLoop>

#include "tests/contract/ContractDesk.h"

namespace plume {

namespace {

class QtLoop final : public ContractLoop {
  public:
    RunLoop& runLoop() override { return loop_; }
    DescriptorLoop& descriptors() { return loop_; }
    void run(double seconds) override {
        QEventLoop events;
        const Timer end = loop_.performAfterDelay(seconds, [&events] { events.quit(); });
        events.exec();
    }

  private:
    QtRunLoop loop_;
};

const ContractPort<ContractLoop> Loop{"Qt", [] { return std::make_unique<QtLoop>(); }};

// One that ended is left alone, whether its descriptor is open or closed, also when the number is used again.
TEST(QtRunLoop, WakesForDescriptorsUntilTheirSubscriptionsEnd) {
    QtLoop loop;
    int drained = 0;
    int first = eventfd(1, EFD_NONBLOCK);
    const auto drain = [&](int descriptor) {
        eventfd_t count = 0;
        if (eventfd_read(descriptor, &count) == 0) ++drained;
    };
    Subscription source = loop.descriptors().addSource(first, [&] { drain(first); });
    loop.run(0.01);
    EXPECT_EQ(drained, 1);

    source.end();
    eventfd_write(first, 1);
    loop.run(0.01);
    EXPECT_EQ(drained, 1);
    close(first);

    const int second = eventfd(1, EFD_NONBLOCK);
    EXPECT_EQ(second, first);
    source = loop.descriptors().addSource(second, [&] { drain(second); });
    loop.run(0.01);
    EXPECT_EQ(drained, 2);
    source.end();
    close(second);
    loop.run(0.01);
}

}  // namespace

INSTANTIATE_TEST_SUITE_P(Qt, RunLoopContract, testing::Values(Loop));

}  // namespace plume

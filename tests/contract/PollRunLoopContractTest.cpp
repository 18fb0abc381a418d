// The run loop of real threads keeps what platform/RunLoop.h promises.
#include "ports/posix/PollRunLoop.h"
#include "tests/contract/ContractDesk.h"

namespace plume {

namespace {

class PollLoop final : public ContractLoop {
  public:
    RunLoop& runLoop() override { return loop_; }
    void run(double seconds) override {
        const Timer end = loop_.performAfterDelay(seconds, [this] { loop_.stop(); });
        loop_.run();
    }

  private:
    PollRunLoop loop_;
};

const ContractPort<ContractLoop> Loop{"Poll", [] { return std::make_unique<PollLoop>(); }};

}  // namespace

INSTANTIATE_TEST_SUITE_P(Poll, RunLoopContract, testing::Values(Loop));

}  // namespace plume

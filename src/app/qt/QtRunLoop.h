// Qt's event loop as the run loop of the main thread.
//
// Made on the main thread after the QApplication and destroyed before it. Calls run while the application's exec()
// does.
#pragma once

#include <QObject>
#include <QTimer>
#include <map>
#include <memory>

#include "ports/posix/DelayedCalls.h"
#include "ports/posix/DescriptorLoop.h"
#include "ports/posix/FileDescriptor.h"

namespace plume {

class QtRunLoop final : public DescriptorLoop {
  public:
    QtRunLoop();
    ~QtRunLoop() override;
    QtRunLoop(const QtRunLoop&) = delete;
    QtRunLoop& operator=(const QtRunLoop&) = delete;

    double now() const override;
    void perform(Call call) override;
    [[nodiscard]] Subscription addSource(int descriptor, Call drain) override;

  private:
    struct Source {
        Call drain;
        bool ended = false;
    };

    CallId schedule(double delay, Call call) override;
    void cancel(CallId id) override;
    void runDue();
    void wakeInTime();
    void drainSources();

    QObject context_;  // what is handed over is dropped when it goes
    QTimer timer_;
    DelayedCalls delayed_;
    // All descriptors behind one: the system forgets those that are closed, which Qt's own notifiers do not.
    FileDescriptor poll_;
    std::map<int, std::shared_ptr<Source>> sources_;
};

}  // namespace plume

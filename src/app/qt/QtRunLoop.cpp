#include "app/qt/QtRunLoop.h"

#include <sys/epoll.h>

#include <QMetaObject>
#include <QSocketNotifier>
#include <algorithm>
#include <array>
#include <cerrno>
#include <chrono>
#include <cmath>
#include <system_error>
#include <utility>

namespace plume {

namespace {

FileDescriptor makePoll() {
    FileDescriptor poll(epoll_create1(EPOLL_CLOEXEC));
    if (!poll.isOpen()) throw std::system_error(errno, std::generic_category(), "epoll_create1");
    return poll;
}

}  // namespace

QtRunLoop::QtRunLoop() : poll_(makePoll()) {
    timer_.setSingleShot(true);
    timer_.setTimerType(Qt::PreciseTimer);
    QObject::connect(&timer_, &QTimer::timeout, &context_, [this] { runDue(); });
    auto* notifier = new QSocketNotifier(poll_.get(), QSocketNotifier::Read, &context_);
    QObject::connect(notifier, &QSocketNotifier::activated, &context_, [this] { drainSources(); });
}

QtRunLoop::~QtRunLoop() = default;

double QtRunLoop::now() const {
    return std::chrono::duration<double>(std::chrono::steady_clock::now().time_since_epoch()).count();
}

void QtRunLoop::perform(Call call) {
    QMetaObject::invokeMethod(&context_, std::move(call), Qt::QueuedConnection);
}

RunLoop::CallId QtRunLoop::schedule(double delay, Call call) {
    const CallId id = delayed_.add(now() + std::max(delay, 0.0), std::move(call));
    wakeInTime();
    return id;
}

void QtRunLoop::cancel(CallId id) {
    delayed_.cancel(id);
    wakeInTime();
}

void QtRunLoop::wakeInTime() {
    const auto due = delayed_.firstDue();
    if (!due) return timer_.stop();
    // Waking up once a day for nothing harms nobody, and keeps the number small.
    constexpr double LongestWait = 86400;
    const double seconds = std::clamp(*due - now(), 0.0, LongestWait);
    // Rounded up: a call is never early.
    timer_.start(static_cast<int>(std::ceil(seconds * 1000)));
}

void QtRunLoop::runDue() {
    const CallId newest = delayed_.newest();
    const double moment = now();
    while (const auto call = delayed_.takeDue(moment, newest)) (*call)();
    wakeInTime();
}

Subscription QtRunLoop::addSource(int descriptor, Call drain) {
    auto source = std::make_shared<Source>(Source{.drain = std::move(drain)});
    sources_.insert_or_assign(descriptor, source);
    epoll_event event{};
    event.events = EPOLLIN;
    event.data.fd = descriptor;
    if (epoll_ctl(poll_.get(), EPOLL_CTL_ADD, descriptor, &event) != 0 && errno != EEXIST) {
        throw std::system_error(errno, std::generic_category(), "epoll_ctl");
    }
    return Subscription(std::shared_ptr<bool>(source, &source->ended));
}

void QtRunLoop::drainSources() {
    constexpr int AtOnce = 16;
    std::array<epoll_event, AtOnce> events{};
    const int count = epoll_wait(poll_.get(), events.data(), AtOnce, 0);
    for (int i = 0; i < count; ++i) {
        const int descriptor = events.at(static_cast<std::size_t>(i)).data.fd;
        const auto found = sources_.find(descriptor);
        const auto source = found == sources_.end() ? nullptr : found->second;
        if (source && !source->ended) {
            source->drain();
        } else {
            epoll_ctl(poll_.get(), EPOLL_CTL_DEL, descriptor, nullptr);
            sources_.erase(descriptor);
        }
    }
}

}  // namespace plume

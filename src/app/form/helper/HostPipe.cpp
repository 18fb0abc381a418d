#include "app/form/helper/HostPipe.h"

#include <fcntl.h>
#include <unistd.h>

#include <cerrno>
#include <csignal>
#include <utility>

namespace plume {

namespace {

constexpr int FirstFree = 3;

// A copy of the descriptor that other programs do not inherit; what is written there instead goes nowhere.
int takeOver(int descriptor) {
    const int own = fcntl(descriptor, F_DUPFD_CLOEXEC, FirstFree);
    const int nowhere = open("/dev/null", O_RDWR | O_CLOEXEC);
    dup2(nowhere, descriptor);
    close(nowhere);
    return own;
}

}  // namespace

HostPipe::HostPipe() : input_(takeOver(STDIN_FILENO)), output_(takeOver(STDOUT_FILENO)) {
    static_cast<void>(std::signal(SIGPIPE, SIG_IGN));
}

void HostPipe::listen(std::function<void(const FormOrder& order)> take, std::function<void()> end) {
    take_ = std::move(take);
    end_ = std::move(end);
    notifier_ = std::make_unique<QSocketNotifier>(input_, QSocketNotifier::Read);
    connect(notifier_.get(), &QSocketNotifier::activated, this, &HostPipe::hear);
}

void HostPipe::hear() {
    constexpr qsizetype Most = 1 << 16;
    QByteArray part(Most, Qt::Uninitialized);
    const ssize_t count = read(input_, part.data(), Most);
    if (count < 0 && (errno == EINTR || errno == EAGAIN)) return;
    lines_.append(part.first(std::max<ssize_t>(0, count)));
    while (const auto line = lines_.next()) {
        if (const auto order = orderIn(*line)) take_(*order);
    }
    if (count > 0 && !lines_.isTooLong()) return;
    notifier_->setEnabled(false);
    end_();
}

void HostPipe::tell(const FormReport& report) const {
    QByteArray line = lineOf(report);
    while (!line.isEmpty()) {
        const ssize_t count = write(output_, line.constData(), static_cast<std::size_t>(line.size()));
        if (count < 0 && errno == EINTR) continue;
        // Plume is gone; the end of the input follows.
        if (count < 0) return;
        line.remove(0, count);
    }
}

}  // namespace plume

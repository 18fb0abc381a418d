// The lines between Plume and this program: standard input and output, which nothing else here uses from then on.
//
// On the main thread. When Plume is gone the program ends.
#pragma once

#include <QObject>
#include <QSocketNotifier>
#include <functional>
#include <memory>

#include "app/form/FormMessages.h"

namespace plume {

class HostPipe final : public QObject {
    Q_OBJECT
  public:
    // Takes both for itself, so that neither what draws the pages nor its processes write or read there. Before the
    // application is made.
    HostPipe();

    // Starts to listen. `end` is called when nothing more comes.
    void listen(std::function<void(const FormOrder& order)> take, std::function<void()> end);
    void tell(const FormReport& report) const;

  private:
    void hear();

    const int input_;
    const int output_;
    MessageLines lines_;
    std::unique_ptr<QSocketNotifier> notifier_;
    std::function<void(const FormOrder& order)> take_;
    std::function<void()> end_;
};

}  // namespace plume

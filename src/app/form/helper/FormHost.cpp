#include "app/form/helper/FormHost.h"

#include <QCoreApplication>
#include <chrono>
#include <cstdlib>
#include <utility>

namespace plume {

namespace {

constexpr std::chrono::minutes LongestIdle{10};

}  // namespace

FormHost::FormHost(HostPipe& pipe) : pipe_(pipe) {
    idle_.setSingleShot(true);
    idle_.setInterval(LongestIdle);
    connect(&idle_, &QTimer::timeout, this, [] { QCoreApplication::exit(EXIT_SUCCESS); });
    idle_.start();
    pipe_.listen([this](const FormOrder& order) { take(order); }, [] { QCoreApplication::exit(EXIT_SUCCESS); });
    pipe_.tell(FormsReady{});
}

void FormHost::take(const FormOrder& order) {
    std::visit([this](const auto& each) { take(each); }, order);
}

void FormHost::take(const PrepareForm& order) {
    idle_.stop();
    PageWindow::Events events{.reported = [this](const FormReport& report) { pipe_.tell(report); },
                              // Plume has one way to go on: that this program has ended.
                              .died = [] { std::_Exit(EXIT_FAILURE); }};
    windows_[order.form] = std::make_unique<PageWindow>(profile_, order, std::move(events));
}

void FormHost::take(const ShowForm& order) {
    if (PageWindow* const window = windowOf(order.form)) window->place(order.place);
}

void FormHost::take(const UpdateForm& order) {
    if (PageWindow* const window = windowOf(order.form)) window->update(order);
}

void FormHost::take(const CloseForm& order) {
    closeWindow(order.form);
    if (windows_.empty()) idle_.start();
}

PageWindow* FormHost::windowOf(FormNumber form) const {
    const auto found = windows_.find(form);
    return found == windows_.end() ? nullptr : found->second.get();
}

void FormHost::closeWindow(FormNumber form) {
    const auto found = windows_.find(form);
    if (found == windows_.end()) return;
    found->second->hide();
    last_ = std::move(found->second);
    windows_.erase(found);
}

}  // namespace plume

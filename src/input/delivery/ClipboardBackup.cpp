#include "input/delivery/ClipboardBackup.h"

namespace plume {

namespace {
constexpr double RestoreDelay = 0.3;  // seconds
}

void ClipboardBackup::backup() {
    hasData_ = false;
    datas_.clear();
    const auto types = pasteboard_.types();
    if (types.empty()) return;
    datas_.reserve(types.size());
    for (const auto& type : types) {
        if (auto data = pasteboard_.data(type)) datas_.emplace_back(type, std::move(*data));
    }
    hasData_ = true;
}

void ClipboardBackup::restore() {
    if (!hasData_) return;
    hasData_ = false;
    std::vector<std::string> types;
    for (const auto& [type, data] : datas_) types.push_back(type);
    pasteboard_.declareTypes(types, nullptr);
    for (const auto& [type, data] : datas_) pasteboard_.setData(data, type);
}

void ClipboardBackup::restoreAfterDelay() {
    if (!hasData_) return;
    pendingRestore_ = runLoop_.performAfterDelay(RestoreDelay, [this] { restore(); });
}

void ClipboardBackup::cancelRestore() {
    pendingRestore_.cancel();
}

}  // namespace plume

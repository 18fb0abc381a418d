#include "app/ReportLog.h"

#include <algorithm>
#include <chrono>
#include <utility>

namespace plume {

void ReportLog::add(std::string sentence, LoggedReport::Action action) {
    const Date now = currentDate();
    const auto known = std::find_if(reports_.begin(), reports_.end(), [&](const LoggedReport& report) {
        return report.sentence == sentence && now - report.time < std::chrono::minutes(1);
    });
    if (known == reports_.end()) {
        reports_.push_back({++lastNumber_, now, std::move(sentence), std::move(action)});
        if (reports_.size() > MostReports) reports_.erase(reports_.begin());
    } else {
        known->time = now;
        known->action = std::move(action);
        ++known->count;
        std::rotate(known, known + 1, reports_.end());
    }
    tell();
}

void ReportLog::clear() {
    reports_.clear();
    tell();
}

void ReportLog::tell() {
    ReportLogEvent event;
    changedEvent.raise(event);
}

}  // namespace plume

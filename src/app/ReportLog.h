// What Plume has told the user lately, for who wants to read it again.
//
// Owned by whoever puts the application together; belongs to the main thread. It holds the last hundred reports, in
// memory alone: they are gone when the program ends.
#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "Foundation/Date.h"
#include "Foundation/ZDEvent.h"

namespace plume {

struct LoggedReport {
    // What the user can do about it; without a label there is nothing.
    struct Action {
        std::string label = {};
        std::function<void()> run = {};
    };

    std::uint64_t number = 0;  // tells reports apart; grows
    Date time;                 // of the last time
    std::string sentence;
    Action action = {};
    std::size_t count = 1;  // how often it was reported
};

struct ReportLogEvent {};

class ReportLog {
  public:
    static constexpr std::size_t MostReports = 100;

    // Now. A sentence that was reported within the last minute is counted, and is the newest one again; its action is
    // the latest one.
    void add(std::string sentence, LoggedReport::Action action = {});
    void clear();
    // The newest one last.
    const std::vector<LoggedReport>& reports() const { return reports_; }

    // Raised after every change.
    ZDEvent<ReportLogEvent> changedEvent;

  private:
    void tell();

    std::vector<LoggedReport> reports_;
    std::uint64_t lastNumber_ = 0;
};

}  // namespace plume

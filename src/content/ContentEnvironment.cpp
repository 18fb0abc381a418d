#include "content/ContentEnvironment.h"

#include <algorithm>
#include <deque>
#include <mutex>

#include "Foundation/Strings.h"

namespace plume {
namespace {

constexpr std::size_t RememberedReports = 64;
constexpr std::size_t LongestQuotation = 100;

bool isNew(const std::string& sentence) {
    static std::mutex mutex;
    static std::deque<std::string> reported;
    const std::lock_guard lock(mutex);
    if (std::find(reported.begin(), reported.end(), sentence) != reported.end()) return false;
    reported.push_back(sentence);
    if (reported.size() > RememberedReports) reported.pop_front();
    return true;
}

}  // namespace

void ContentEnvironment::reportOnce(const std::string& sentence) const {
    if (report && isNew(sentence)) report(sentence);
}

std::string quotedForReport(std::u16string_view text) {
    const bool tooLong = text.size() > LongestQuotation;
    return "\"" + toUtf8(text.substr(0, LongestQuotation)) + (tooLong ? "…\"" : "\"");
}

}  // namespace plume

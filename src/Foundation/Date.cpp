#include "Foundation/Date.h"

#include <utility>

namespace plume {

namespace {

Date systemDate() {
    return std::chrono::floor<std::chrono::microseconds>(std::chrono::system_clock::now());
}

std::function<Date()>& dateSource() {
    static std::function<Date()> source = systemDate;
    return source;
}

}  // namespace

Date currentDate() {
    return dateSource()();
}

ScopedDateSource::ScopedDateSource(std::function<Date()> source)
    : previous_(std::exchange(dateSource(), std::move(source))) {}

ScopedDateSource::~ScopedDateSource() {
    dateSource() = std::move(previous_);
}

}  // namespace plume

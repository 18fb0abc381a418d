#include "library/SnippetUses.h"

#include <algorithm>
#include <chrono>
#include <cmath>
#include <set>
#include <utility>
#include <vector>

#include "Foundation/Strings.h"

namespace plume {

namespace {

constexpr double DaysToHalf = 14;
// Beyond what anyone reaches: a use a second for a year gives some 1.7 million.
constexpr double MostCount = 1e7;
// Of a time that the settings can hold: beyond the year 9999 nothing is a time of use.
constexpr std::int64_t MostSeconds = 253'402'300'800;

double daysOf(Date::duration duration) {
    return std::chrono::duration<double, std::ratio<86'400>>(duration).count();
}

}  // namespace

SnippetUses::SnippetUses(WritableUserDefaults& settings) : settings_(settings) {
    read();
}

void SnippetUses::read() {
    const auto kept = settings_.objectForKey(Key);
    const auto* entries = kept ? kept->as<PropertyList::Dictionary>() : nullptr;
    if (!entries) return;
    for (const auto& [key, value] : *entries) readOne(key, value);
}

void SnippetUses::readOne(std::string_view key, const PropertyList& value) {
    const auto uuid = Uuid::parse(fromUtf8(key));
    const auto* pair = value.as<PropertyList::Array>();
    if (!uuid || !pair || pair->size() != 2) return;
    const auto* count = (*pair)[0].as<double>();
    const auto* seconds = (*pair)[1].as<std::int64_t>();
    if (!count || !(*count > 0 && *count <= MostCount)) return;
    if (!seconds || *seconds < 0 || *seconds > MostSeconds) return;
    const Use use{*count, Date(std::chrono::seconds(*seconds))};
    uses_.insert_or_assign(*uuid, use);
    if (!mostUsed_ || standing(use) > standing(*mostUsed_)) mostUsed_ = use;
}

void SnippetUses::note(const Uuid& uuid, Date now) {
    if (!isOn()) return;
    Use& use = uses_[uuid];
    use = {std::min(faded(use, now) + 1, MostCount), now};
    if (!mostUsed_ || standing(use) > standing(*mostUsed_)) mostUsed_ = use;
    isWritten_ = false;
    ++revision_;
}

double SnippetUses::weight(const Uuid& uuid, Date now) const {
    if (!mostUsed_) return 0;
    const double most = std::log2(1 + faded(*mostUsed_, now));
    return most > 0 ? std::min(1.0, std::log2(1 + count(uuid, now)) / most) : 0;
}

double SnippetUses::count(const Uuid& uuid, Date now) const {
    const auto found = uses_.find(uuid);
    return found != uses_.end() && isOn() ? faded(found->second, now) : 0;
}

std::uint64_t SnippetUses::revision() const {
    return revision_ * 2 + (isOn() ? 1 : 0);
}

void SnippetUses::dropAllBut(const SnippetGroups& living) {
    std::set<Uuid> known;
    for (const auto& group : living) {
        for (const auto& snippet : group->items()) {
            if (snippet->uuid()) known.insert(*snippet->uuid());
        }
    }
    const std::size_t dropped = std::erase_if(uses_, [&](const auto& entry) { return !known.contains(entry.first); });
    if (dropped == 0) return;
    mostUsed_.reset();
    for (const auto& [uuid, use] : uses_) {
        if (!mostUsed_ || standing(use) > standing(*mostUsed_)) mostUsed_ = use;
    }
    isWritten_ = false;
    ++revision_;
}

Result<void> SnippetUses::write() {
    if (isWritten_) return {};
    dropLeastUsed();
    PropertyList::Dictionary entries;
    for (const auto& [uuid, use] : uses_) {
        const auto seconds = std::chrono::floor<std::chrono::seconds>(use.time.time_since_epoch()).count();
        entries.emplace(toUtf8(uuid.toString()), PropertyList::Array{use.count, std::int64_t{seconds}});
    }
    auto written = settings_.setObject(Key, std::move(entries));
    isWritten_ = written.ok();
    return written;
}

Result<void> SnippetUses::forget() {
    uses_.clear();
    mostUsed_.reset();
    isWritten_ = true;
    ++revision_;
    return settings_.removeObject(Key);
}

void SnippetUses::dropLeastUsed() {
    if (uses_.size() <= MostKept) return;
    std::vector<std::pair<double, Uuid>> order;
    for (const auto& [uuid, use] : uses_) order.emplace_back(standing(use), uuid);
    const auto kept = order.begin() + static_cast<std::ptrdiff_t>(MostKept);
    std::nth_element(order.begin(), kept, order.end(), std::greater<>());
    for (auto dropped = kept; dropped != order.end(); ++dropped) uses_.erase(dropped->second);
    ++revision_;
}

double SnippetUses::faded(const Use& use, Date now) {
    // A clock that was set back makes nothing grow.
    return use.count * std::exp2(-std::max(0.0, daysOf(now - use.time)) / DaysToHalf);
}

double SnippetUses::standing(const Use& use) {
    return std::log2(use.count) + daysOf(use.time.time_since_epoch()) / DaysToHalf;
}

}  // namespace plume

#include "Foundation/archive/ReferenceDate.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <cstdio>

namespace plume {

namespace {

using namespace std::chrono_literals;

constexpr Date ReferenceDate = std::chrono::sys_days(2001y / 1 / 1);
constexpr double MicrosecondsPerSecond = 1e6;
// Within what 64 bits of microseconds hold, on both sides of the reference date.
constexpr double MostSeconds = 9e12;
// What the calendar reaches.
constexpr int LastYear = 32767;
constexpr Date FirstWritten = std::chrono::sys_days(std::chrono::year(-LastYear) / 1 / 1);
constexpr Date LastWritten = std::chrono::sys_days(std::chrono::year(LastYear) / 12 / 31);

// Takes a number and the mark behind it from the front; a mark of 0 stands for the end.
bool takeNumber(std::string_view& text, int& number, char mark) {
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    if (error != std::errc()) return false;
    text.remove_prefix(static_cast<std::size_t>(end - text.data()));
    if (mark == 0) return text.empty();
    if (!text.starts_with(mark)) return false;
    text.remove_prefix(1);
    return true;
}

bool isIn(int number, int first, int last) {
    return number >= first && number <= last;
}

}  // namespace

double referenceSeconds(Date date) {
    // In two parts, because a double does not hold the microseconds of far dates.
    const auto seconds = std::chrono::floor<std::chrono::seconds>(date);
    const auto rest = date - seconds;
    const auto whole = seconds - std::chrono::floor<std::chrono::seconds>(ReferenceDate);
    return static_cast<double>(whole.count()) + static_cast<double>(rest.count()) / MicrosecondsPerSecond;
}

std::optional<Date> dateFromReferenceSeconds(double seconds) {
    if (std::isnan(seconds)) return std::nullopt;
    if (seconds > MostSeconds) seconds = MostSeconds;
    if (seconds < -MostSeconds) seconds = -MostSeconds;
    const double whole = std::floor(seconds);
    const double microseconds = std::round((seconds - whole) * MicrosecondsPerSecond);
    return ReferenceDate + std::chrono::seconds(static_cast<std::int64_t>(whole)) +
           std::chrono::microseconds(static_cast<std::int64_t>(microseconds));
}

std::string isoDate(Date date) {
    date = std::clamp(date, FirstWritten, LastWritten);
    const auto day = std::chrono::floor<std::chrono::days>(date);
    const std::chrono::year_month_day calendar(day);
    const auto seconds = std::chrono::floor<std::chrono::seconds>(date - day).count();
    std::array<char, 48> text{};
    const int length = std::snprintf(text.data(), text.size(), "%04d-%02u-%02uT%02d:%02d:%02dZ",
                                     static_cast<int>(calendar.year()), static_cast<unsigned>(calendar.month()),
                                     static_cast<unsigned>(calendar.day()), static_cast<int>(seconds / 3600),
                                     static_cast<int>(seconds / 60 % 60), static_cast<int>(seconds % 60));
    return {text.data(), static_cast<std::size_t>(length)};
}

std::optional<Date> dateFromIsoDate(std::string_view text) {
    int year = 0;
    int month = 0;
    int day = 0;
    int hour = 0;
    int minute = 0;
    int second = 0;
    if (!text.ends_with('Z')) return std::nullopt;
    text.remove_suffix(1);
    const bool read = takeNumber(text, year, '-') && takeNumber(text, month, '-') && takeNumber(text, day, 'T') &&
                      takeNumber(text, hour, ':') && takeNumber(text, minute, ':') && takeNumber(text, second, 0);
    if (!read || !isIn(year, -LastYear, LastYear) || !isIn(hour, 0, 23) || !isIn(minute, 0, 59)) return std::nullopt;
    if (!isIn(second, 0, 60) || !isIn(month, 1, 12) || !isIn(day, 1, 31)) return std::nullopt;
    const std::chrono::year_month_day calendar{std::chrono::year(year),
                                               std::chrono::month(static_cast<unsigned>(month)),
                                               std::chrono::day(static_cast<unsigned>(day))};
    if (!calendar.ok()) return std::nullopt;
    return Date(std::chrono::sys_days(calendar)) + std::chrono::hours(hour) + std::chrono::minutes(minute) +
           std::chrono::seconds(second);
}

}  // namespace plume

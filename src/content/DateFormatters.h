// Formatting moments, and the calendar of a place, with what is costly to build kept for the next time.
//
// Every thread keeps its own (at most a few dozen kilobytes for each of a handful of formatters), so nothing is shared
// and nothing waits.
#pragma once

#include <unicode/gregocal.h>

#include <optional>
#include <string>

#include "Foundation/Date.h"
#include "content/ContentEnvironment.h"

namespace plume {

enum class DateTextKind { DayOnly, TimeOnly };

// The moment in a style ("short", "medium", "long", "full": of the date or of the time alone) or a date pattern, in a
// locale or the environment's, in the environment's time zone. Nothing when the pattern holds letters that mean
// nothing.
std::optional<std::u16string> formattedDate(Date date, DateTextKind kind, const std::u16string& format,
                                            const std::optional<std::u16string>& locale,
                                            const ContentEnvironment& environment);

// The Gregorian calendar in the environment's time zone, set to the present moment. Belongs to the thread; good until
// the next call.
icu::GregorianCalendar& calendarOfNow(const ContentEnvironment& environment);

// Moments that do not fit stop at the earliest or the latest that does.
Date dateFromMilliseconds(double milliseconds);
double millisecondsOf(Date date);

}  // namespace plume

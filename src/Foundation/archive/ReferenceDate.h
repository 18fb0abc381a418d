// Dates as property lists and archives keep them: seconds since the first of January 2001, UTC. Pure; from any thread.
#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "Foundation/Date.h"

namespace plume {

double referenceSeconds(Date date);
// Nothing for what is no number; seconds that no Date can hold give the first or the last one.
std::optional<Date> dateFromReferenceSeconds(double seconds);

// "2024-02-29T12:30:00Z", to the second, as XML property lists write it; dates that no calendar reaches give its ends.
std::string isoDate(Date date);
std::optional<Date> dateFromIsoDate(std::string_view text);

}  // namespace plume

#include "content/DateFormatters.h"

#include <unicode/smpdtfmt.h>
#include <unicode/timezone.h>

#include <algorithm>
#include <cmath>
#include <compare>
#include <list>
#include <memory>
#include <optional>

#include "Foundation/Strings.h"
#include "Foundation/UserLocale.h"

namespace plume {
namespace {

constexpr std::size_t KeptFormatters = 16;
// No locale identifier in use comes near.
constexpr std::size_t LongestLocale = 128;

struct FormatterKey {
    DateTextKind kind;
    std::u16string format;
    std::string locale;
    std::string timeZone;

    bool operator==(const FormatterKey&) const = default;
};

struct KeptFormatter {
    FormatterKey key;
    std::unique_ptr<icu::DateFormat> formatter;
};

std::u16string fromIcu(const icu::UnicodeString& text) {
    return {text.getBuffer(), static_cast<std::size_t>(text.length())};
}

icu::UnicodeString toIcu(std::u16string_view text) {
    return icu::UnicodeString(text.data(), static_cast<std::int32_t>(text.size()));
}

std::string nameOfZone(const ContentEnvironment& environment) {
    if (!environment.timeZone.empty()) return environment.timeZone;
    const std::unique_ptr<icu::TimeZone> zone(icu::TimeZone::createDefault());
    icu::UnicodeString id;
    std::string name;
    return zone->getID(id).toUTF8String(name);
}

std::unique_ptr<icu::TimeZone> zoneNamed(const std::string& name) {
    std::unique_ptr<icu::TimeZone> zone(icu::TimeZone::createTimeZone(icu::UnicodeString::fromUTF8(name)));
    if (*zone == icu::TimeZone::getUnknown()) zone.reset(icu::TimeZone::createDefault());
    return zone;
}

std::string nameOfLocale(const std::optional<std::u16string>& locale, const ContentEnvironment& environment) {
    if (locale && !locale->empty() && locale->size() <= LongestLocale) return toUtf8(*locale);
    return environment.locale.empty() ? userLocale(LocaleCategory::Dates) : environment.locale;
}

icu::Locale localeNamed(const std::string& name) {
    const icu::Locale locale = icu::Locale::createCanonical(name.c_str());
    return locale.isBogus() ? icu::Locale(userLocale(LocaleCategory::Dates).c_str()) : locale;
}

std::optional<icu::DateFormat::EStyle> styleNamed(std::u16string_view word) {
    if (word == u"short") return icu::DateFormat::kShort;
    if (word == u"medium") return icu::DateFormat::kMedium;
    if (word == u"long") return icu::DateFormat::kLong;
    if (word == u"full") return icu::DateFormat::kFull;
    return std::nullopt;
}

std::unique_ptr<icu::DateFormat> makeFormatter(const FormatterKey& key) {
    const icu::Locale locale = localeNamed(key.locale);
    UErrorCode status = U_ZERO_ERROR;
    std::unique_ptr<icu::DateFormat> formatter;
    if (const auto style = styleNamed(key.format)) {
        formatter.reset(key.kind == DateTextKind::DayOnly ? icu::DateFormat::createDateInstance(*style, locale)
                                                          : icu::DateFormat::createTimeInstance(*style, locale));
    } else {
        formatter = std::make_unique<icu::SimpleDateFormat>(toIcu(key.format), locale, status);
    }
    if (!formatter || U_FAILURE(status)) return nullptr;
    formatter->adoptTimeZone(zoneNamed(key.timeZone).release());
    return formatter;
}

// The formatter for the key, made or kept; null when the locale has none.
icu::DateFormat* formatterFor(FormatterKey key) {
    thread_local std::list<KeptFormatter> kept;  // the latest used first
    const auto found = std::find_if(kept.begin(), kept.end(), [&](const auto& entry) { return entry.key == key; });
    if (found != kept.end()) {
        kept.splice(kept.begin(), kept, found);
    } else {
        auto formatter = makeFormatter(key);
        if (!formatter) return nullptr;
        kept.push_front({std::move(key), std::move(formatter)});
        if (kept.size() > KeptFormatters) kept.pop_back();
    }
    return kept.front().formatter.get();
}

}  // namespace

std::optional<std::u16string> formattedDate(Date date, DateTextKind kind, const std::u16string& format,
                                            const std::optional<std::u16string>& locale,
                                            const ContentEnvironment& environment) {
    if (format.empty()) return std::u16string();
    auto* formatter = formatterFor({kind, format, nameOfLocale(locale, environment), nameOfZone(environment)});
    if (!formatter) return std::nullopt;
    icu::UnicodeString text;
    UErrorCode status = U_ZERO_ERROR;
    formatter->format(millisecondsOf(date), text, static_cast<icu::FieldPositionIterator*>(nullptr), status);
    if (U_FAILURE(status)) return std::nullopt;
    return fromIcu(text);
}

icu::GregorianCalendar& calendarOfNow(const ContentEnvironment& environment) {
    thread_local std::string zone;
    thread_local std::optional<icu::GregorianCalendar> calendar;
    std::string wanted = nameOfZone(environment);
    UErrorCode status = U_ZERO_ERROR;
    if (!calendar || zone != wanted) {
        calendar.emplace(zoneNamed(wanted).release(), icu::Locale::getRoot(), status);
        // A midnight that a change of clocks skips is the first moment of its day; of two, the first.
        calendar->setSkippedWallTimeOption(UCAL_WALLTIME_NEXT_VALID);
        calendar->setRepeatedWallTimeOption(UCAL_WALLTIME_FIRST);
        zone = std::move(wanted);
    }
    calendar->setTime(millisecondsOf(environment.now()), status);
    return *calendar;
}

Date dateFromMilliseconds(double milliseconds) {
    constexpr double Furthest = 9e15;
    return Date(
        std::chrono::microseconds(std::llround(std::clamp(milliseconds, -Furthest, Furthest)) * std::int64_t{1000}));
}

double millisecondsOf(Date date) {
    return static_cast<double>(std::chrono::floor<std::chrono::milliseconds>(date).time_since_epoch().count());
}

}  // namespace plume

#include "scenario/ScenarioSettingReader.h"

#include <unicode/ucal.h>

#include <array>
#include <chrono>
#include <optional>
#include <string_view>

#include "Foundation/Strings.h"
#include "input/delivery/ApplicationRow.h"

namespace plume {

namespace {

struct LocalTime {
    int year = 0;
    int month = 0;
    int day = 0;
    int hour = 0;
    int minute = 0;
    int second = 0;
};

std::optional<LocalTime> localTimeIn(const std::string& text) {
    constexpr std::string_view Pattern = "dddd-dd-ddTdd:dd:dd";
    if (text.size() != Pattern.size()) return std::nullopt;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const bool digit = text[i] >= '0' && text[i] <= '9';
        if (Pattern[i] == 'd' ? !digit : text[i] != Pattern[i]) return std::nullopt;
    }
    const auto number = [&](std::size_t at, std::size_t length) { return std::stoi(text.substr(at, length)); };
    return LocalTime{number(0, 4), number(5, 2), number(8, 2), number(11, 2), number(14, 2), number(17, 2)};
}

}  // namespace

std::shared_ptr<const ContextInputSetting> readApplicationSetting(const JsonNode& node) {
    return std::make_shared<const ContextInputSetting>(readApplicationRow(node, {}, {}));
}

std::string readTimeZone(const JsonNode& node) {
    const std::u16string name = node.string();
    std::array<UChar, 128> canonical{};
    UBool isSystemId = 0;
    UErrorCode status = U_ZERO_ERROR;
    ucal_getCanonicalTimeZoneID(name.data(), static_cast<std::int32_t>(name.size()), canonical.data(),
                                static_cast<std::int32_t>(canonical.size()), &isSystemId, &status);
    if (U_FAILURE(status) || !isSystemId) node.fail("expected the name of a time zone, such as Europe/Berlin");
    return toUtf8(name);
}

Date readNow(const JsonNode& node, const std::string& timeZone) {
    const std::optional<LocalTime> local = localTimeIn(toUtf8(node.string()));
    const std::u16string zone = fromUtf8(timeZone);
    UErrorCode status = U_ZERO_ERROR;
    const std::unique_ptr<UCalendar, decltype(&ucal_close)> calendar(
        ucal_open(zone.empty() ? nullptr : zone.data(), static_cast<std::int32_t>(zone.size()), "en_US", UCAL_GREGORIAN,
                  &status),
        &ucal_close);
    if (local && U_SUCCESS(status)) {
        ucal_setAttribute(calendar.get(), UCAL_LENIENT, 0);
        ucal_clear(calendar.get());
        ucal_setDateTime(calendar.get(), local->year, local->month - 1, local->day, local->hour, local->minute,
                         local->second, &status);
        const UDate milliseconds = ucal_getMillis(calendar.get(), &status);
        if (U_SUCCESS(status)) return Date(std::chrono::milliseconds(static_cast<std::int64_t>(milliseconds)));
    }
    node.fail("expected a moment that the time zone has, such as 2026-01-31T10:00:00");
}

}  // namespace plume

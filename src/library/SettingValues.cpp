#include "library/SettingValues.h"

#include <array>
#include <charconv>
#include <cstdio>

#include "Foundation/Strings.h"

namespace plume {

namespace {

using Json = nlohmann::ordered_json;

std::string textFrom(Date date) {
    const auto day = std::chrono::floor<std::chrono::days>(date);
    const std::chrono::year_month_day calendar(day);
    const std::chrono::hh_mm_ss time(std::chrono::floor<std::chrono::seconds>(date - day));
    std::array<char, 64> text{};
    (void)std::snprintf(text.data(), text.size(), "%04d-%02u-%02uT%02d:%02d:%02dZ", int(calendar.year()),
                        unsigned(calendar.month()), unsigned(calendar.day()), int(time.hours().count()),
                        int(time.minutes().count()), int(time.seconds().count()));
    return text.data();
}

// 0 for what is no number.
int numberAt(std::string_view text, std::size_t place, std::size_t length) {
    int number = 0;
    const std::string_view digits = text.substr(place, length);
    std::from_chars(digits.data(), digits.data() + digits.size(), number);
    return number;
}

struct AsJson {
    Json operator()(const std::u16string& text) const { return toUtf8(text); }
    Json operator()(const Date& date) const { return textFrom(date); }
    Json operator()(const ArchivedData& data) const { return std::to_string(data.bytes.size()) + " bytes"; }
    Json operator()(const PropertyList::Uid& reference) const { return reference.number; }
    Json operator()(const PropertyList::Array& array) const {
        Json list = Json::array();
        for (const PropertyList& element : array) list.push_back(settingAsJson(element));
        return list;
    }
    Json operator()(const PropertyList::Dictionary& dictionary) const {
        Json object = Json::object();
        for (const auto& [key, value] : dictionary) object[key] = settingAsJson(value);
        return object;
    }
    template <typename Scalar>
    Json operator()(const Scalar& scalar) const {
        return scalar;
    }
};

}  // namespace

PropertyList settingFromJson(const JsonNode& node) {
    const Json& value = node.value();
    if (value.is_boolean()) return node.boolean();
    if (value.is_number_integer()) return node.integer();
    if (value.is_number()) return value.get<double>();
    if (value.is_array()) {
        PropertyList::Array array;
        for (const JsonNode& element : node.elements()) array.push_back(settingFromJson(element));
        return array;
    }
    if (value.is_object()) {
        PropertyList::Dictionary dictionary;
        for (const auto& [key, member] : node.members()) dictionary.emplace(key, settingFromJson(member));
        return dictionary;
    }
    return node.string();
}

nlohmann::ordered_json settingAsJson(const PropertyList& value) {
    return std::visit(AsJson(), value.value);
}

std::optional<Date> dateFromText(std::string_view text) {
    constexpr std::size_t Length = 20;
    if (text.size() != Length) return std::nullopt;
    const auto year = std::chrono::year(numberAt(text, 0, 4));
    const auto month = std::chrono::month(static_cast<unsigned>(numberAt(text, 5, 2)));
    const auto day = std::chrono::day(static_cast<unsigned>(numberAt(text, 8, 2)));
    const std::chrono::year_month_day calendar{year, month, day};
    if (!calendar.ok()) return std::nullopt;
    const Date date = std::chrono::sys_days(calendar) + std::chrono::hours(numberAt(text, 11, 2)) +
                      std::chrono::minutes(numberAt(text, 14, 2)) + std::chrono::seconds(numberAt(text, 17, 2));
    // Another punctuation, or what is beyond an hour's or a minute's end, would be written differently.
    return textFrom(date) == text ? std::optional(date) : std::nullopt;
}

}  // namespace plume

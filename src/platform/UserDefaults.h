// The user's settings, by name ("SnippetAdaptToAbbreviationCaseOption").
//
// Names are ASCII. A setting that is not there, or whose value cannot be read as the type that is asked for, gives what
// each operation says. Answers come from memory: fit for any moment but the road of a keystroke, where settings are
// read ahead.
#pragma once

#include <cmath>
#include <cstdint>
#include <limits>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/Date.h"
#include "Foundation/Result.h"
#include "Foundation/ZDEvent.h"
#include "Foundation/archive/PropertyList.h"

namespace plume {

class UserDefaults {
  public:
    virtual ~UserDefaults() = default;
    // The user's own value, else the registered one.
    virtual std::optional<PropertyList> objectForKey(std::string_view key) const = 0;

    bool hasKey(std::string_view key) const { return objectForKey(key).has_value(); }
    // Numbers and booleans are read as one another; 0 and false without one. What is too large stops at the limits.
    std::int64_t integerForKey(std::string_view key) const;
    double doubleForKey(std::string_view key) const;
    bool boolForKey(std::string_view key) const { return doubleForKey(key) != 0; }
    std::optional<std::u16string> stringForKey(std::string_view key) const { return valueForKey<std::u16string>(key); }
    // Nothing when an element is no string.
    std::optional<std::vector<std::u16string>> stringArrayForKey(std::string_view key) const;
    std::optional<Date> dateForKey(std::string_view key) const { return valueForKey<Date>(key); }

  private:
    template <typename Type>
    std::optional<Type> valueForKey(std::string_view key) const {
        const auto object = objectForKey(key);
        const Type* value = object ? object->as<Type>() : nullptr;
        return value ? std::optional(*value) : std::nullopt;
    }
};

inline double UserDefaults::doubleForKey(std::string_view key) const {
    const auto object = objectForKey(key);
    if (!object) return 0;
    if (const auto* number = object->as<double>()) return std::isnan(*number) ? 0 : *number;
    if (const auto* integer = object->as<std::int64_t>()) return static_cast<double>(*integer);
    const auto* boolean = object->as<bool>();
    return boolean && *boolean ? 1 : 0;
}

inline std::int64_t UserDefaults::integerForKey(std::string_view key) const {
    if (const auto integer = valueForKey<std::int64_t>(key)) return *integer;
    constexpr double Beyond = 9223372036854775808.0;  // 2 to the power of 63
    const double number = doubleForKey(key);
    if (number >= Beyond) return std::numeric_limits<std::int64_t>::max();
    if (number <= -Beyond) return std::numeric_limits<std::int64_t>::min();
    return static_cast<std::int64_t>(number);
}

inline std::optional<std::vector<std::u16string>> UserDefaults::stringArrayForKey(std::string_view key) const {
    const auto array = valueForKey<PropertyList::Array>(key);
    if (!array) return std::nullopt;
    std::vector<std::u16string> strings;
    for (const PropertyList& element : *array) {
        const auto* string = element.as<std::u16string>();
        if (!string) return std::nullopt;
        strings.push_back(*string);
    }
    return strings;
}

// Settings that have another value than before.
struct UserDefaultsChange {
    std::vector<std::string> keys;
    bool byAnotherProcess = false;
};

// Settings that can be changed, and stay so. Belongs to the main thread.
class WritableUserDefaults : public UserDefaults {
  public:
    // What holds while the user has set nothing else; kept in memory alone.
    virtual void registerDefaults(const PropertyList::Dictionary& defaults) = 0;
    // The user's own value, on the disk when this returns. On failure the value that was there stays.
    virtual Result<void> setObject(std::string_view key, PropertyList value) = 0;
    // The registered value holds again. A key that is not there is no error.
    virtual Result<void> removeObject(std::string_view key) = 0;
    // The keys that the user has given a value.
    virtual std::vector<std::string> ownKeys() const = 0;

    // Raised after a change: at once for one made through this object, from the main loop for another process's.
    ZDEvent<UserDefaultsChange> changedEvent;
};

}  // namespace plume

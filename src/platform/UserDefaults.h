// The user's settings, by name ("SnippetAdaptToAbbreviationCaseOption").
//
// Names are ASCII. A setting that is not there, or whose value cannot be read as the type that is asked for, gives what
// each operation says. Answers come from memory: fit for any moment but the road of a keystroke, where settings are
// read ahead.
#pragma once

#include <cstdint>
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
    virtual bool hasKey(std::string_view key) const = 0;
    // Numbers and booleans are read as one another; 0 and false without one.
    virtual std::int64_t integerForKey(std::string_view key) const = 0;
    virtual double doubleForKey(std::string_view key) const = 0;
    virtual bool boolForKey(std::string_view key) const = 0;
    virtual std::optional<std::u16string> stringForKey(std::string_view key) const = 0;
    virtual std::optional<std::vector<std::u16string>> stringArrayForKey(std::string_view key) const = 0;
    virtual std::optional<PropertyList> objectForKey(std::string_view key) const = 0;
    std::optional<Date> dateForKey(std::string_view key) const {
        const auto object = objectForKey(key);
        const Date* date = object ? object->as<Date>() : nullptr;
        return date ? std::optional(*date) : std::nullopt;
    }
};

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

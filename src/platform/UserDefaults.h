// The user's settings, by name ("SnippetAdaptToAbbreviationCaseOption"); the reading side.
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
};

}  // namespace plume

// Settings in memory.
#pragma once

#include <functional>
#include <map>
#include <variant>

#include "platform/UserDefaults.h"

namespace plume {

class MemoryUserDefaults final : public UserDefaults {
  public:
    using Value = std::variant<bool, std::int64_t, double, std::u16string, std::vector<std::u16string>>;

    void set(std::string key, Value value);
    void remove(std::string_view key);

    bool hasKey(std::string_view key) const override;
    std::int64_t integerForKey(std::string_view key) const override;
    double doubleForKey(std::string_view key) const override;
    bool boolForKey(std::string_view key) const override;
    std::optional<std::u16string> stringForKey(std::string_view key) const override;
    std::optional<std::vector<std::u16string>> stringArrayForKey(std::string_view key) const override;
    std::optional<PropertyList> objectForKey(std::string_view key) const override;

  private:
    std::map<std::string, Value, std::less<>> values_;
};

}  // namespace plume

// Settings in memory, which nobody else changes.
#pragma once

#include <string>
#include <string_view>

#include "platform/UserDefaults.h"

namespace plume {

class MemoryUserDefaults final : public WritableUserDefaults {
  public:
    // setObject() for who knows that it cannot fail here.
    void set(std::string_view key, PropertyList value) { (void)setObject(key, std::move(value)); }

    std::optional<PropertyList> objectForKey(std::string_view key) const override;
    void registerDefaults(const PropertyList::Dictionary& defaults) override;
    Result<void> setObject(std::string_view key, PropertyList value) override;
    Result<void> removeObject(std::string_view key) override;
    std::vector<std::string> ownKeys() const override;

  private:
    void tellIfChanged(std::string_view key, const std::optional<PropertyList>& before);

    PropertyList::Dictionary own_;
    PropertyList::Dictionary registered_;
};

}  // namespace plume

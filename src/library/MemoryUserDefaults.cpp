#include "library/MemoryUserDefaults.h"

#include <utility>

namespace plume {

std::optional<PropertyList> MemoryUserDefaults::objectForKey(std::string_view key) const {
    for (const auto* values : {&own_, &registered_}) {
        if (const auto found = values->find(key); found != values->end()) return found->second;
    }
    return std::nullopt;
}

void MemoryUserDefaults::registerDefaults(const PropertyList::Dictionary& defaults) {
    for (const auto& [key, value] : defaults) registered_.insert_or_assign(key, value);
}

Result<void> MemoryUserDefaults::setObject(std::string_view key, PropertyList value) {
    const auto before = objectForKey(key);
    own_.insert_or_assign(std::string(key), std::move(value));
    tellIfChanged(key, before);
    return {};
}

Result<void> MemoryUserDefaults::removeObject(std::string_view key) {
    const auto before = objectForKey(key);
    if (const auto found = own_.find(key); found != own_.end()) own_.erase(found);
    tellIfChanged(key, before);
    return {};
}

std::vector<std::string> MemoryUserDefaults::ownKeys() const {
    std::vector<std::string> keys;
    for (const auto& [key, value] : own_) keys.push_back(key);
    return keys;
}

void MemoryUserDefaults::tellIfChanged(std::string_view key, const std::optional<PropertyList>& before) {
    if (objectForKey(key) == before) return;
    UserDefaultsChange change{.keys = {std::string(key)}};
    changedEvent.raise(change);
}

}  // namespace plume

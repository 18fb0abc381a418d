#include "library/MemoryUserDefaults.h"

#include <type_traits>
#include <utility>

namespace plume {

namespace {

using Values = std::map<std::string, MemoryUserDefaults::Value, std::less<>>;

template <typename Number>
Number numberIn(const Values& values, std::string_view key) {
    const auto found = values.find(key);
    if (found == values.end()) return {};
    return std::visit(
        [](const auto& value) -> Number {
            if constexpr (std::is_arithmetic_v<std::decay_t<decltype(value)>>) return static_cast<Number>(value);
            return {};
        },
        found->second);
}

template <typename Type>
std::optional<Type> valueIn(const Values& values, std::string_view key) {
    const auto found = values.find(key);
    if (found == values.end()) return std::nullopt;
    const Type* value = std::get_if<Type>(&found->second);
    return value ? std::optional<Type>(*value) : std::nullopt;
}

}  // namespace

void MemoryUserDefaults::set(std::string key, Value value) {
    values_.insert_or_assign(std::move(key), std::move(value));
}

void MemoryUserDefaults::remove(std::string_view key) {
    const auto found = values_.find(key);
    if (found != values_.end()) values_.erase(found);
}

bool MemoryUserDefaults::hasKey(std::string_view key) const {
    return values_.contains(key);
}

std::int64_t MemoryUserDefaults::integerForKey(std::string_view key) const {
    return numberIn<std::int64_t>(values_, key);
}

double MemoryUserDefaults::doubleForKey(std::string_view key) const {
    return numberIn<double>(values_, key);
}

bool MemoryUserDefaults::boolForKey(std::string_view key) const {
    return numberIn<bool>(values_, key);
}

std::optional<std::u16string> MemoryUserDefaults::stringForKey(std::string_view key) const {
    return valueIn<std::u16string>(values_, key);
}

std::optional<std::vector<std::u16string>> MemoryUserDefaults::stringArrayForKey(std::string_view key) const {
    return valueIn<std::vector<std::u16string>>(values_, key);
}

std::optional<PropertyList> MemoryUserDefaults::objectForKey(std::string_view key) const {
    const auto found = values_.find(key);
    if (found == values_.end()) return std::nullopt;
    return std::visit(
        [](const auto& value) -> PropertyList {
            if constexpr (std::is_same_v<std::decay_t<decltype(value)>, std::vector<std::u16string>>) {
                return PropertyList::Array(value.begin(), value.end());
            } else {
                return value;
            }
        },
        found->second);
}

}  // namespace plume

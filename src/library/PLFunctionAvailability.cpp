#include "library/PLFunctionAvailability.h"

#include <algorithm>

namespace plume {

namespace {

bool lists(const std::optional<std::vector<std::u16string>>& list, const std::optional<std::u16string>& identifier) {
    return list && identifier && std::find(list->begin(), list->end(), *identifier) != list->end();
}

}  // namespace

bool PLFunctionAvailability::admitsApplication(const std::optional<std::u16string>& bundleIdentifier) const {
    switch (availability) {
        case Everywhere:
            return true;
        case ExceptListed:
            return !lists(applications, bundleIdentifier);
        case OnlyListed:
            return lists(applications, bundleIdentifier);
        default:
            return false;
    }
}

bool PLFunctionAvailability::admitsInputSource(const std::optional<std::u16string>& identifier) const {
    if (inputMethodsOption == Everywhere) return true;
    return lists(inputMethods, identifier) != (inputMethodsOption == ExceptListed);
}

}  // namespace plume

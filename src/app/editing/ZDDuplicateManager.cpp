#include "app/editing/ZDDuplicateManager.h"

namespace plume {

bool ZDDuplicateManager::add(const Text& abbreviation) {
    if (!abbreviation || abbreviation->empty()) return false;
    return ++items_[*abbreviation] > 1;
}

bool ZDDuplicateManager::remove(const Text& abbreviation) {
    if (!abbreviation) return false;
    const auto found = items_.find(*abbreviation);
    if (found == items_.end()) return false;
    if (--found->second > 0) return true;
    items_.erase(found);
    return false;
}

bool ZDDuplicateManager::isDuplicated(const Text& abbreviation) const {
    if (!abbreviation) return false;
    const auto found = items_.find(*abbreviation);
    return found != items_.end() && found->second > 1;
}

}  // namespace plume

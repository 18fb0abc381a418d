// Counts abbreviations, to tell those that several snippets have.
//
// A plain object for one thread. Abbreviations count as different when their case differs.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <unordered_map>

namespace plume {

class ZDDuplicateManager {
  public:
    using Text = std::optional<std::u16string>;

    // True when it is a duplicate now. Nothing is counted for nil and for the empty text.
    bool add(const Text& abbreviation);
    // True when others of the same text remain counted.
    bool remove(const Text& abbreviation);
    bool isDuplicated(const Text& abbreviation) const;
    void clear() { items_.clear(); }

  private:
    std::unordered_map<std::u16string, std::size_t> items_;  // never 0
};

}  // namespace plume

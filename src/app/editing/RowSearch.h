// Finds rows of a list by words of theirs, at every key that is typed.
//
// Pure; one thread at a time has it. Letter case makes no difference. 10,000 rows take a few milliseconds.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace plume {

class RowSearch {
  public:
    void clear() { rows_.clear(); }
    // A row behind the others. What is found in its name comes before what is found in the rest of it.
    void add(std::u16string_view name, std::u16string_view rest);

    // The places of the rows that hold every word of the query: those whose name it is, those whose name begins with
    // it, those in which all words begin some word, then others; each in the order of the rows. All rows for a query
    // without words.
    std::vector<std::size_t> find(std::u16string_view query) const;

  private:
    struct Row {
        std::u16string name;
        std::u16string all;  // with the name
    };
    std::vector<Row> rows_;
};

}  // namespace plume

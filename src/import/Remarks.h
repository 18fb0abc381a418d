// What an importer tells about things that it could not carry over whole.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "library/Snippet.h"

namespace plume {

// No import makes more snippets; what is left of the file is told about in a remark.
inline constexpr std::size_t MostImportedSnippets = 250'000;

// Lines, up to a number that a list can show; further ones are counted.
class Remarks {
  public:
    void add(std::string line);
    // "btw": why
    void add(const Snippet& snippet, std::string_view why);
    // "btw": this; that, or line 3, "btw": this; that. Nothing when there are no reasons.
    void addAll(const Snippet& snippet, const std::vector<std::string>& reasons,
                std::optional<std::size_t> lineNumber = std::nullopt);
    // Unless there are none: "12 lines are no hotstrings". `one` holds for a single one: "1 line is no hotstring".
    void addCount(std::size_t count, std::string_view one, std::string_view many);

    // Entries of a list of snippets that are none.
    void addStrange(std::size_t count);
    // Snippets beyond MostImportedSnippets.
    void addTooMany(std::size_t count);

    std::vector<std::string> take();

  private:
    static constexpr std::size_t MostLines = 10'000;

    std::vector<std::string> lines_;
    std::size_t further_ = 0;
};

// How a remark calls a snippet: by its abbreviation, or its label, on one line and cut short where it is long.
std::string nameInRemarks(const Snippet& snippet);

}  // namespace plume

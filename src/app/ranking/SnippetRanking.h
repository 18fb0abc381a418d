// Which snippets a search finds, the best first.
//
// Keeps the searched texts of a library in a form in which accents, letter case and ligatures make no difference. All
// of it belongs to the main thread; what it answers is shared with the library. Nothing that is searched for is kept
// beyond the next search.
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/Strings.h"
#include "library/LibraryArchive.h"
#include "library/SnippetUses.h"

namespace plume {

// What a search looks at, as the settings "SnippetQuickSearchSearchBy" and "SnippetQuickSearchWildcardSearch" say.
struct SearchRule {
    static constexpr std::int64_t Abbreviation = 1;  // with its prefix
    static constexpr std::int64_t Content = 2;
    static constexpr std::int64_t Label = 4;

    std::int64_t searchBy = Abbreviation | Content | Label;
    bool isWildcard = false;  // * and ? stand for anything

    bool operator==(const SearchRule&) const = default;
};

struct RankedSnippet {
    std::shared_ptr<Snippet> snippet;
    std::shared_ptr<SnippetGroup> group;
    bool isLoose = false;  // only like what was searched for: below the divider
};

class SnippetRanking {
  public:
    // So many of the rows above the divider are in order; no more than these stand below it.
    static constexpr std::size_t SortedRows = 200;
    // Of an empty query.
    static constexpr std::size_t RecentRows = 50;

    SnippetRanking();
    ~SnippetRanking();
    SnippetRanking(const SnippetRanking&) = delete;
    SnippetRanking& operator=(const SnippetRanking&) = delete;

    // To be called again after any change of the library. What has changed is read with the next search.
    void setLibrary(const SnippetGroups& groups);
    // Not owned; null for none.
    void setUses(const SnippetUses* uses);

    // Best first. The first SortedRows above the divider are in order, the rest of those follow in library order. An
    // empty query gives the most used snippets, then the newest.
    std::vector<RankedSnippet> search(std::u16string_view query, const SearchRule& rule);

    // Does now what the next search would have to do first.
    void prepare();
    // Gives the memory back until the next search.
    void release();
    // Bytes that the searched texts take, about.
    std::size_t memory() const;

  private:
    class Implementation;
    std::unique_ptr<Implementation> implementation_;
};

// Where the query's terms stand in a text as it is shown, for marking; in order and apart from each other. `isLoose` as
// in the row.
std::vector<Range> highlights(std::u16string_view text, std::u16string_view query, const SearchRule& rule,
                              bool isLoose);

}  // namespace plume

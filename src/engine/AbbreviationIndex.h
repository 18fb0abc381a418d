// Finds the snippets whose abbreviation, with its group's prefix, could end a text, at a cost that does not grow with
// the library.
//
// An abbreviation is filed, together with its prefix, under the hash of its folded text and its length. Hashes grow to
// the left (library/AbbreviationHash.h), so one walk over the end of the typed text gives the hash of every suffix;
// each length that some abbreviation has costs one look into a filter. Abbreviations longer than LongestSuffix are
// filed under their last LongestSuffix units. There is one table for each way of triggering. For what is typed only in
// part there is one more table, of the beginnings of all.
//
// What comes out are candidates: equal hashes or first letters, and nothing else checked. Owned by the matcher, on its
// thread.
#pragma once

#include <array>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "Foundation/CharacterSet.h"
#include "engine/BeginningTable.h"
#include "engine/SuffixTable.h"
#include "library/SnippetGroup.h"

namespace plume {

class AbbreviationIndex final : public SnippetGroupObserver {
  public:
    using Groups = std::vector<std::shared_ptr<SnippetGroup>>;

    // The ways of triggering.
    enum class Trigger : std::uint8_t { Immediately, Delimiter, HotKey, Never };

    // A group of the library as the index knows it.
    struct IndexedGroup {
        std::shared_ptr<SnippetGroup> group;
        std::size_t order = 0;  // place in the library
        std::u16string prefix;
        bool prefixOverlapsItself = false;
        Trigger table = Trigger::Never;      // where its snippets are filed
        std::vector<std::uint32_t> records;  // of its items, in their order
        mutable bool ranksAreStale = false;  // they are brought up to date when somebody asks
    };

    struct Candidate {
        const IndexedGroup* group;
        const std::shared_ptr<Snippet>* snippet;
        std::size_t length;  // of prefix and abbreviation
        std::uint32_t rank;  // place in the group's items
    };

    class Visitor {
      public:
        virtual ~Visitor() = default;
        virtual void visit(const Candidate& candidate) = 0;
    };

    explicit AbbreviationIndex(const CharacterSet& defaultDelimiters);
    ~AbbreviationIndex() override;
    AbbreviationIndex(const AbbreviationIndex&) = delete;
    AbbreviationIndex& operator=(const AbbreviationIndex&) = delete;

    // Groups that were there before are not indexed again.
    void setGroups(const Groups& groups);

    // Some group expands after this delimiter.
    bool isDelimiter(char16_t unit) const { return delimiters_.contains(unit); }

    // Shows the visitor each snippet that could end the text, in no particular order.
    void visitCandidates(Trigger trigger, std::u16string_view text, Visitor& visitor) const;

    // Nothing when it is none of the groups.
    const IndexedGroup* indexedGroup(const SnippetGroup& group) const;
    // No abbreviation with its prefix is longer.
    std::size_t longest() const { return longest_; }
    // Shows the visitor each snippet, however it is triggered, whose prefix and abbreviation could begin with the text,
    // which is not empty, in no particular order.
    void visitBeginnings(std::u16string_view text, Visitor& visitor) const;

    void abbreviationChanged(SnippetGroup& group, Snippet& snippet,
                             const std::optional<std::u16string>& previous) override;
    void itemsAdded(SnippetGroup& group, std::size_t first, std::size_t count) override;
    void itemRemoved(SnippetGroup& group, Snippet& snippet, std::size_t index) override;
    void matchingSettingsChanged(SnippetGroup& group) override;

  private:
    static constexpr std::size_t LongestSuffix = 64;

    // One snippet of the library. Where it is filed, the table of the same number of entries knows.
    struct Record {
        std::shared_ptr<Snippet> snippet;
        IndexedGroup* group = nullptr;
        std::uint32_t length = 0;  // of prefix and abbreviation; 0: filed nowhere
        std::uint32_t rank = 0;
    };

    struct Table {
        std::uint64_t lengthsInUse = 0;  // bit n-1: some abbreviation is n units long, or longer for the last bit
        std::array<std::size_t, LongestSuffix> lengthCounts{};
        SuffixTable suffixes;
    };

    Table& tableOf(const IndexedGroup& group) { return tables_[static_cast<std::size_t>(group.table)]; }

    IndexedGroup* find(SnippetGroup& group);
    void addGroup(const std::shared_ptr<SnippetGroup>& group);
    void removeGroup(IndexedGroup& group);
    static void refreshSettings(IndexedGroup& group);
    void refreshDelimiters();

    std::uint32_t addRecord(IndexedGroup& group, const std::shared_ptr<Snippet>& snippet, std::size_t rank);
    void removeRecord(std::uint32_t index);
    void file(std::uint32_t index);
    void unfile(std::uint32_t index);
    std::uint32_t recordFiledUnder(IndexedGroup& group, const Snippet& snippet,
                                   const std::optional<std::u16string>& abbreviation);
    static std::uint64_t keyOf(std::u16string_view text);
    // Good until it is asked for the next one.
    const std::u16string& prefixed(const IndexedGroup& group, std::u16string_view abbreviation);
    void show(std::uint32_t record, Visitor& visitor) const;
    void refreshRanks(const IndexedGroup& group) const;

    CharacterSet defaultDelimiters_;
    CharacterSet delimiters_;
    std::unordered_map<const SnippetGroup*, std::unique_ptr<IndexedGroup>> groups_;
    mutable std::vector<Record> records_;  // ranks are brought up to date when they are asked for
    std::vector<std::uint32_t> freeRecords_;
    std::array<Table, 4> tables_;
    BeginningTable beginnings_;
    std::size_t longest_ = 0;
    std::u16string prefixed_;  // kept for its capacity
};

}  // namespace plume

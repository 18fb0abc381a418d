#include "engine/AbbreviationIndex.h"

#include <unicode/utf16.h>

#include <algorithm>
#include <bit>
#include <cstddef>

#include "Foundation/Strings.h"
#include "library/AbbreviationHash.h"

namespace plume {

namespace {

// The key under which a suffix of this hash and length is filed. Mixed, so that all its bits depend on all of the
// hash's.
constexpr std::uint64_t mixedKey(std::uint64_t hash, std::size_t length) {
    std::uint64_t key = hash + length * 0xd6e8feb86659fd93ULL;
    key = (key ^ (key >> 32)) * 0xd6e8feb86659fd93ULL;
    return key ^ (key >> 32);
}

// Reads a text from its end, each unit folded as part of the character it belongs to.
class FoldedUnitsFromEnd {
  public:
    explicit FoldedUnitsFromEnd(std::u16string_view text) : text_(text), position_(text.size()) {}

    // Must not be called more often than the text has units.
    char16_t next() {
        const char16_t unit = text_[--position_];
        if (unit < 0x80) return unit >= u'A' && unit <= u'Z' ? static_cast<char16_t>(unit + 0x20) : unit;
        if (U16_IS_TRAIL(unit) && position_ > 0 && U16_IS_LEAD(text_[position_ - 1])) {
            return U16_TRAIL(foldedPair(position_ - 1));
        }
        if (U16_IS_LEAD(unit) && position_ + 1 < text_.size() && U16_IS_TRAIL(text_[position_ + 1])) {
            return U16_LEAD(foldedPair(position_));
        }
        return static_cast<char16_t>(foldedCodePoint(unit));
    }

  private:
    char32_t foldedPair(std::size_t lead) const {
        return foldedCodePoint(static_cast<char32_t>(U16_GET_SUPPLEMENTARY(text_[lead], text_[lead + 1])));
    }

    std::u16string_view text_;
    std::size_t position_;
};

// Two occurrences of the text can share units: some proper start of it is also its end.
bool overlapsItself(std::u16string_view text) {
    for (std::size_t shift = 1; shift < text.size(); ++shift) {
        if (equalsIgnoringCase(text.substr(shift), text.substr(0, text.size() - shift))) return true;
    }
    return false;
}

AbbreviationIndex::Trigger tableFor(ExpandTrigger trigger) {
    switch (trigger) {
        case ExpandTrigger::Immediately:
            return AbbreviationIndex::Trigger::Immediately;
        case ExpandTrigger::DelimiterKept:
        case ExpandTrigger::DelimiterSwallowed:
            return AbbreviationIndex::Trigger::Delimiter;
        case ExpandTrigger::HotKey:
            return AbbreviationIndex::Trigger::HotKey;
        case ExpandTrigger::Never:
            break;
    }
    return AbbreviationIndex::Trigger::Never;
}

}  // namespace

AbbreviationIndex::AbbreviationIndex(const CharacterSet& defaultDelimiters) : defaultDelimiters_(defaultDelimiters) {}

AbbreviationIndex::~AbbreviationIndex() {
    for (const auto& [key, indexed] : groups_) indexed->group->removeGroupObserver(this);
}

void AbbreviationIndex::setGroups(const Groups& groups) {
    std::unordered_map<const SnippetGroup*, std::size_t> wanted;
    for (std::size_t i = 0; i < groups.size(); ++i) wanted.try_emplace(groups[i].get(), i);

    for (auto entry = groups_.begin(); entry != groups_.end();) {
        if (wanted.contains(entry->first)) {
            ++entry;
        } else {
            removeGroup(*entry->second);
            entry = groups_.erase(entry);
        }
    }
    std::size_t snippets = records_.size();
    for (const auto& group : groups) snippets += groups_.contains(group.get()) ? 0 : group->items().size();
    records_.reserve(snippets);
    beginnings_.reserve(snippets, snippets);
    for (const auto& [group, order] : wanted) {
        if (!groups_.contains(group)) addGroup(groups[order]);
        groups_[group]->order = order;
    }
    refreshDelimiters();
}

AbbreviationIndex::IndexedGroup* AbbreviationIndex::find(SnippetGroup& group) {
    const auto found = groups_.find(&group);
    return found == groups_.end() ? nullptr : found->second.get();
}

const AbbreviationIndex::IndexedGroup* AbbreviationIndex::indexedGroup(const SnippetGroup& group) const {
    const auto found = groups_.find(&group);
    return found == groups_.end() ? nullptr : found->second.get();
}

void AbbreviationIndex::addGroup(const std::shared_ptr<SnippetGroup>& group) {
    auto& indexed = groups_[group.get()] = std::make_unique<IndexedGroup>();
    indexed->group = group;
    refreshSettings(*indexed);
    itemsAdded(*group, 0, group->items().size());
    group->addGroupObserver(this);
}

void AbbreviationIndex::removeGroup(IndexedGroup& group) {
    group.group->removeGroupObserver(this);
    for (const std::uint32_t record : group.records) removeRecord(record);
}

void AbbreviationIndex::refreshSettings(IndexedGroup& group) {
    group.prefix = group.group->abbreviationPrefix().value_or(u"");
    group.prefixOverlapsItself = overlapsItself(group.prefix);
    group.table = tableFor(group.group->expandTrigger());
}

void AbbreviationIndex::refreshDelimiters() {
    delimiters_ = CharacterSet();
    for (const auto& [key, indexed] : groups_) {
        if (indexed->table != Trigger::Delimiter) continue;
        delimiters_ = delimiters_.united(indexed->group->delimiters().value_or(defaultDelimiters_));
    }
}

void AbbreviationIndex::matchingSettingsChanged(SnippetGroup& group) {
    IndexedGroup* indexed = find(group);
    if (!indexed) return;
    for (const std::uint32_t record : indexed->records) unfile(record);
    refreshSettings(*indexed);
    for (const std::uint32_t record : indexed->records) file(record);
    refreshDelimiters();
}

void AbbreviationIndex::itemsAdded(SnippetGroup& group, std::size_t first, std::size_t count) {
    IndexedGroup* indexed = find(group);
    if (!indexed) return;
    const auto& items = group.items();
    SuffixTable& suffixes = tableOf(*indexed).suffixes;
    suffixes.reserve(suffixes.size() + count, records_.size() + count);
    std::vector<std::uint32_t> added;
    added.reserve(count);
    for (std::size_t i = first; i < first + count; ++i) added.push_back(addRecord(*indexed, items[i], i));
    indexed->records.insert(indexed->records.begin() + static_cast<std::ptrdiff_t>(first), added.begin(), added.end());
    if (first + count < items.size()) indexed->ranksAreStale = true;
}

void AbbreviationIndex::itemRemoved(SnippetGroup& group, Snippet& /*snippet*/, std::size_t index) {
    IndexedGroup* indexed = find(group);
    if (!indexed) return;
    removeRecord(indexed->records[index]);
    indexed->records.erase(indexed->records.begin() + static_cast<std::ptrdiff_t>(index));
    // The ranks that stay are still in order among themselves, but the next appended snippet's would not be.
    indexed->ranksAreStale = true;
}

void AbbreviationIndex::abbreviationChanged(SnippetGroup& group, Snippet& snippet,
                                            const std::optional<std::u16string>& previous) {
    IndexedGroup* indexed = find(group);
    if (!indexed) return;
    const std::uint32_t record = recordFiledUnder(*indexed, snippet, previous);
    if (record == SuffixTable::None) return;
    unfile(record);
    file(record);
}

// The group's record of the snippet while its abbreviation was the given one, or None when the group does not list it.
std::uint32_t AbbreviationIndex::recordFiledUnder(IndexedGroup& group, const Snippet& snippet,
                                                  const std::optional<std::u16string>& abbreviation) {
    const auto isIt = [&](std::uint32_t record) {
        return records_[record].snippet.get() == &snippet && records_[record].group == &group;
    };
    if (!abbreviation || abbreviation->empty()) {  // it was filed nowhere
        const auto found = std::find_if(group.records.begin(), group.records.end(), isIt);
        return found == group.records.end() ? SuffixTable::None : *found;
    }
    const SuffixTable& suffixes = tableOf(group).suffixes;
    std::uint32_t record = suffixes.first(keyOf(prefixed(group, *abbreviation)));
    while (record != SuffixTable::None && !isIt(record)) record = suffixes.next(record);
    return record;
}

std::uint32_t AbbreviationIndex::addRecord(IndexedGroup& group, const std::shared_ptr<Snippet>& snippet,
                                           std::size_t rank) {
    std::uint32_t index;
    if (freeRecords_.empty()) {
        index = static_cast<std::uint32_t>(records_.size());
        records_.emplace_back();
    } else {
        index = freeRecords_.back();
        freeRecords_.pop_back();
    }
    Record& record = records_[index];
    record.snippet = snippet;
    record.group = &group;
    record.rank = static_cast<std::uint32_t>(rank);
    file(index);
    return index;
}

void AbbreviationIndex::removeRecord(std::uint32_t index) {
    unfile(index);
    records_[index] = Record{};
    freeRecords_.push_back(index);
}

std::uint64_t AbbreviationIndex::keyOf(std::u16string_view text) {
    const std::size_t length = std::min(text.size(), LongestSuffix);
    FoldedUnitsFromEnd units(text);
    std::uint64_t hash = EmptySuffixHash;
    for (std::size_t i = 0; i < length; ++i) hash = extendSuffixHash(hash, units.next());
    return mixedKey(hash, length);
}

const std::u16string& AbbreviationIndex::prefixed(const IndexedGroup& group, std::u16string_view abbreviation) {
    return prefixed_.assign(group.prefix).append(abbreviation);
}

void AbbreviationIndex::file(std::uint32_t index) {
    Record& record = records_[index];
    const auto& abbreviation = record.snippet->abbreviation();
    if (!abbreviation || abbreviation->empty()) return;
    const std::u16string& text = prefixed(*record.group, *abbreviation);
    record.length = static_cast<std::uint32_t>(text.size());
    longest_ = std::max(longest_, text.size());

    Table& table = tableOf(*record.group);
    const std::size_t lengthIndex = std::min<std::size_t>(record.length, LongestSuffix) - 1;
    ++table.lengthCounts[lengthIndex];
    table.lengthsInUse |= std::uint64_t{1} << lengthIndex;
    table.suffixes.add(index, keyOf(text));
    beginnings_.add(index, text);
}

void AbbreviationIndex::unfile(std::uint32_t index) {
    Record& record = records_[index];
    if (record.length == 0) return;
    Table& table = tableOf(*record.group);
    const std::size_t lengthIndex = std::min<std::size_t>(record.length, LongestSuffix) - 1;
    if (--table.lengthCounts[lengthIndex] == 0) table.lengthsInUse &= ~(std::uint64_t{1} << lengthIndex);
    table.suffixes.remove(index);
    beginnings_.remove(index);
    record.length = 0;
}

void AbbreviationIndex::visitCandidates(Trigger trigger, std::u16string_view text, Visitor& visitor) const {
    const Table& table = tables_[static_cast<std::size_t>(trigger)];
    const auto longest = static_cast<std::size_t>(std::bit_width(table.lengthsInUse));
    const std::size_t walked = std::min(longest, text.size());
    FoldedUnitsFromEnd units(text);
    std::uint64_t hash = EmptySuffixHash;
    for (std::size_t length = 1; length <= walked; ++length) {
        hash = extendSuffixHash(hash, units.next());
        if ((table.lengthsInUse >> (length - 1) & 1) == 0) continue;
        const std::uint64_t key = mixedKey(hash, length);
        if (!table.suffixes.mayContain(key)) continue;
        for (auto index = table.suffixes.first(key); index != SuffixTable::None; index = table.suffixes.next(index)) {
            if (records_[index].length <= text.size()) show(index, visitor);
        }
    }
}

void AbbreviationIndex::visitBeginnings(std::u16string_view text, Visitor& visitor) const {
    beginnings_.visit(text, [&](std::uint32_t index) {
        if (records_[index].length >= text.size()) show(index, visitor);
    });
}

void AbbreviationIndex::show(std::uint32_t record, Visitor& visitor) const {
    const Record& shown = records_[record];
    if (shown.group->ranksAreStale) refreshRanks(*shown.group);
    visitor.visit({shown.group, &shown.snippet, shown.length, shown.rank});
}

void AbbreviationIndex::refreshRanks(const IndexedGroup& group) const {
    std::uint32_t rank = 0;
    for (const std::uint32_t record : group.records) records_[record].rank = rank++;
    group.ranksAreStale = false;
}

}  // namespace plume

#include "app/ranking/SearchCorpus.h"

#include <algorithm>
#include <unordered_map>
#include <utility>

#include "Foundation/CharacterSet.h"
#include "app/ranking/NormalisedText.h"
#include "app/ranking/SnippetRanking.h"

namespace plume {

namespace {

using Entry = SearchCorpus::Entry;

std::size_t letterFrom(std::u16string_view units, std::size_t from) {
    const auto isLetter = [](char16_t unit) { return CharacterSet::alphanumerics().contains(unit); };
    const auto start = units.begin() + static_cast<std::ptrdiff_t>(from);
    const auto found = std::find_if(start, units.end(), isLetter);
    // An abbreviation of nothing but punctuation begins with it.
    return found == units.end() ? from : static_cast<std::size_t>(found - units.begin());
}

void readTexts(Entry& entry, LetterMasks& masks) {
    const Snippet& snippet = *entry.snippet;
    const bool hasAbbreviation = !snippet.abbreviation().value_or(u"").empty();
    const std::u16string typed = hasAbbreviation ? entry.prefix + *snippet.abbreviation() : u"";
    NormalisedField abbreviation = normalisedField(typed);
    const NormalisedField label = normalisedField(snippet.label().value_or(u""));
    const std::u16string content = normalised(snippet.plainTextContent().value_or(u""));
    masks = {letterMask(abbreviation.units), letterMask(label.units), letterMask(content)};
    const std::size_t bare = std::min(normalised(entry.prefix).size(), abbreviation.units.size());
    entry.beginnings = {0, bare, letterFrom(abbreviation.units, bare)};
    if (bare < abbreviation.starts.size()) abbreviation.starts[bare] = FirstOfWord;
    entry.abbreviationLength = abbreviation.units.size();
    entry.labelLength = label.units.size();
    entry.units.reserve(abbreviation.units.size() + label.units.size() + content.size());
    entry.units.append(abbreviation.units).append(label.units).append(content);
    entry.starts = abbreviation.starts + label.starts;
}

bool isUpToDate(const Entry& entry, const Snippet& snippet, const std::u16string& prefix) {
    return entry.snippet.get() == &snippet && entry.revision == snippet.revision() && entry.prefix == prefix;
}

// What was read before, to be taken over where it still holds.
class EarlierEntries {
  public:
    EarlierEntries(std::vector<Entry>& entries, std::vector<LetterMasks>& masks) : entries_(entries), masks_(masks) {}

    bool take(const Snippet& snippet, const std::u16string& prefix, Entry& entry, LetterMasks& masks) {
        const std::size_t found = indexOf(snippet);
        if (found >= entries_.size() || !isUpToDate(entries_[found], snippet, prefix)) return false;
        entry = std::move(entries_[found]);
        masks = masks_[found];
        next_ = found + 1;
        return true;
    }

  private:
    // Most snippets stand where they stood: behind the one before.
    std::size_t indexOf(const Snippet& snippet) {
        if (next_ < entries_.size() && entries_[next_].snippet.get() == &snippet) return next_;
        if (places_.empty()) {
            for (std::size_t i = 0; i < entries_.size(); ++i) {
                if (entries_[i].snippet) places_.emplace(entries_[i].snippet.get(), i);
            }
        }
        const auto found = places_.find(&snippet);
        return found == places_.end() ? entries_.size() : found->second;
    }

    std::vector<Entry>& entries_;
    std::vector<LetterMasks>& masks_;
    std::unordered_map<const Snippet*, std::size_t> places_;
    std::size_t next_ = 0;
};

}  // namespace

void SearchCorpus::read(const SnippetGroups& groups) {
    std::vector<Entry> oldEntries = std::exchange(entries_, {});
    std::vector<LetterMasks> oldLetterMasks = std::exchange(masks_, {});
    EarlierEntries earlier(oldEntries, oldLetterMasks);
    std::size_t count = 0;
    for (const auto& group : groups) count += group->items().size();
    entries_.reserve(count);
    masks_.reserve(count);
    for (const auto& group : groups) {
        const std::u16string prefix = group->abbreviationPrefix().value_or(u"");
        for (const auto& snippet : group->items()) {
            Entry& entry = entries_.emplace_back();
            LetterMasks& masks = masks_.emplace_back();
            if (!earlier.take(*snippet, prefix, entry, masks)) {
                entry.snippet = snippet;
                entry.revision = snippet->revision();
                entry.prefix = prefix;
                readTexts(entry, masks);
            }
            entry.group = group;
        }
    }
}

void SearchCorpus::clear() {
    entries_ = std::vector<Entry>();
    masks_ = std::vector<LetterMasks>();
}

LetterMasks SearchCorpus::masks(std::size_t index, std::int64_t searchBy) const {
    LetterMasks masks = masks_[index];
    if ((searchBy & SearchRule::Abbreviation) == 0) masks.abbreviation = 0;
    if ((searchBy & SearchRule::Content) == 0) masks.content = 0;
    if ((searchBy & SearchRule::Label) == 0) masks.label = 0;
    return masks;
}

SearchedTexts SearchCorpus::texts(std::size_t index, std::int64_t searchBy) const {
    const Entry& entry = entries_[index];
    const std::u16string_view units = entry.units;
    const std::string_view starts = entry.starts;
    SearchedTexts texts;
    texts.masks = masks(index, searchBy);
    if (searchBy & SearchRule::Abbreviation) {
        texts.abbreviation = {units.substr(0, entry.abbreviationLength), starts.substr(0, entry.abbreviationLength)};
        texts.beginnings = entry.beginnings;
    }
    if (searchBy & SearchRule::Label) {
        texts.label = {units.substr(entry.abbreviationLength, entry.labelLength),
                       starts.substr(entry.abbreviationLength)};
    }
    if (searchBy & SearchRule::Content) texts.content = units.substr(entry.abbreviationLength + entry.labelLength);
    return texts;
}

std::size_t SearchCorpus::memory() const {
    std::size_t bytes = entries_.capacity() * sizeof(Entry) + masks_.capacity() * sizeof(LetterMasks);
    for (const Entry& entry : entries_) {
        bytes += entry.units.capacity() * sizeof(char16_t) + entry.starts.capacity();
    }
    return bytes;
}

}  // namespace plume

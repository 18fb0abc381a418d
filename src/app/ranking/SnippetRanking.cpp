#include "app/ranking/SnippetRanking.h"

#include <algorithm>
#include <bit>
#include <chrono>
#include <limits>
#include <optional>
#include <tuple>
#include <utility>

#include "app/ranking/SearchCorpus.h"
#include "app/ranking/SearchQuery.h"
#include "engine/SnippetSearch.h"

namespace plume {

namespace {

// With fewer rows than these, typing slips are forgiven.
constexpr std::size_t FewRows = 3;
constexpr std::chrono::minutes WeightsHold{1};

constexpr double TierWorth = 1000;
constexpr double QualityWorth = 400;
constexpr double UseWorth = 300;

struct Hit {
    double score = 0;
    std::uint32_t length = 0;  // of the abbreviation
    std::uint32_t index = 0;
};

bool isBetter(const Hit& one, const Hit& other) {
    return std::tuple(-one.score, one.length, one.index) < std::tuple(-other.score, other.length, other.index);
}

// How well the whole query fits: as well as its worst term, or as all of it in one piece.
class QueryFit {
  public:
    void add(const TermFit& fit) {
        worst_ = std::min(worst_, fit.tier);
        sum_ += fit.quality;
        ++count_;
    }
    TermFit result() const {
        if (count_ == 0) return {Tier::InContent, 0};
        return {worst_, sum_ / static_cast<double>(count_)};
    }

  private:
    double worst_ = std::numeric_limits<double>::max();
    double sum_ = 0;
    std::size_t count_ = 0;
};

void sortBest(std::vector<Hit>& hits) {
    const std::size_t count = std::min(SnippetRanking::SortedRows, hits.size());
    const auto sorted = hits.begin() + static_cast<std::ptrdiff_t>(count);
    std::nth_element(hits.begin(), sorted, hits.end(), isBetter);
    std::sort(hits.begin(), sorted, isBetter);
    std::sort(sorted, hits.end(), [](const Hit& one, const Hit& other) { return one.index < other.index; });
}

}  // namespace

class SnippetRanking::Implementation {
  public:
    void setLibrary(const SnippetGroups& groups);
    void setUses(const SnippetUses* uses);
    std::vector<RankedSnippet> search(std::u16string_view text, const SearchRule& rule);
    void prepare();
    void release();
    std::size_t memory() const { return corpus_.memory(); }

  private:
    void refreshWeights();
    std::vector<RankedSnippet> recent();
    std::vector<RankedSnippet> matchingWildcards(std::u16string_view text, const SearchRule& rule) const;
    std::vector<RankedSnippet> ranked(const SearchQuery& query, const SearchRule& rule);
    std::vector<Hit> whole(const SearchQuery& query, const SearchRule& rule);
    std::vector<Hit> loose(const SearchQuery& query, std::int64_t fields, const std::vector<Hit>& better,
                           bool withSlips) const;
    TermFit queryFit(std::size_t index, const SearchQuery& query, std::int64_t fields) const;
    TermFit looseQueryFit(std::size_t index, const SearchQuery& query, std::int64_t fields, bool withSlips) const;
    Hit hitOf(std::size_t index, const TermFit& fit) const;
    void append(std::vector<RankedSnippet>& rows, const std::vector<Hit>& hits, bool isLoose) const;

    SnippetGroups groups_;
    bool isRead_ = true;
    SearchCorpus corpus_;

    const SnippetUses* uses_ = nullptr;
    std::vector<float> weights_;  // of every entry; empty until they are needed
    std::uint64_t weightsRevision_ = 0;
    Date weightsDate_;

    // What the last search found above the divider: all that a narrower one can find.
    struct Last {
        SearchQuery query;
        SearchRule rule;
        std::vector<std::uint32_t> found;
    };
    std::optional<Last> last_;
};

void SnippetRanking::Implementation::setLibrary(const SnippetGroups& groups) {
    groups_ = groups;
    isRead_ = false;
}

void SnippetRanking::Implementation::setUses(const SnippetUses* uses) {
    uses_ = uses;
    weights_.clear();
}

void SnippetRanking::Implementation::prepare() {
    if (isRead_) return;
    corpus_.read(groups_);
    isRead_ = true;
    weights_.clear();
    last_.reset();
}

void SnippetRanking::Implementation::release() {
    corpus_.clear();
    weights_ = std::vector<float>();
    last_.reset();
    isRead_ = false;
}

void SnippetRanking::Implementation::refreshWeights() {
    if (!uses_) {
        weights_.assign(corpus_.size(), 0);
        return;
    }
    const Date now = currentDate();
    const bool isFresh =
        weightsRevision_ == uses_->revision() && now >= weightsDate_ && now - weightsDate_ < WeightsHold;
    if (isFresh && weights_.size() == corpus_.size()) return;
    weights_.resize(corpus_.size());
    for (std::size_t i = 0; i < corpus_.size(); ++i) {
        const auto& uuid = corpus_.entry(i).snippet->uuid();
        weights_[i] = uuid ? static_cast<float>(uses_->weight(*uuid, now)) : 0;
    }
    weightsRevision_ = uses_->revision();
    weightsDate_ = now;
}

std::vector<RankedSnippet> SnippetRanking::Implementation::search(std::u16string_view text, const SearchRule& rule) {
    if (isWildcardSearch(text, rule)) return matchingWildcards(text, rule);
    prepare();
    refreshWeights();
    const SearchQuery query = searchQuery(text);
    return query.isBlank ? recent() : ranked(query, rule);
}

std::vector<RankedSnippet> SnippetRanking::Implementation::recent() {
    last_.reset();
    using Place = std::tuple<float, Date::rep, std::size_t>;
    std::vector<Place> places;
    places.reserve(corpus_.size());
    for (std::size_t index = 0; index < corpus_.size(); ++index) {
        const Snippet& snippet = *corpus_.entry(index).snippet;
        const auto& date = snippet.dateModified() ? snippet.dateModified() : snippet.dateCreated();
        places.emplace_back(-weights_[index], -date.value_or(Date()).time_since_epoch().count(), index);
    }
    const std::size_t count = std::min(RecentRows, places.size());
    std::partial_sort(places.begin(), places.begin() + static_cast<std::ptrdiff_t>(count), places.end());
    std::vector<RankedSnippet> rows;
    for (std::size_t i = 0; i < count; ++i) {
        const SearchCorpus::Entry& entry = corpus_.entry(std::get<std::size_t>(places[i]));
        rows.push_back({entry.snippet, entry.group, false});
    }
    return rows;
}

std::vector<RankedSnippet> SnippetRanking::Implementation::matchingWildcards(std::u16string_view text,
                                                                             const SearchRule& rule) const {
    SnippetGroups groups;
    const auto found = SnippetSearch::filter(std::u16string(text), groups_, true, rule.searchBy, &groups);
    std::vector<RankedSnippet> rows;
    for (const auto& group : groups) {
        for (const auto& snippet : found->at(group)) rows.push_back({snippet, group, false});
    }
    return rows;
}

std::vector<RankedSnippet> SnippetRanking::Implementation::ranked(const SearchQuery& query, const SearchRule& rule) {
    const std::int64_t fields = searchedFields(rule);
    std::vector<Hit> above = whole(query, rule);
    std::vector<Hit> below = loose(query, fields, above, false);
    if (above.size() + below.size() < FewRows) below = loose(query, fields, above, true);
    sortBest(above);
    sortBest(below);
    if (below.size() > SortedRows) below.resize(SortedRows);
    std::vector<RankedSnippet> rows;
    rows.reserve(above.size() + below.size());
    append(rows, above, false);
    append(rows, below, true);
    return rows;
}

std::vector<Hit> SnippetRanking::Implementation::whole(const SearchQuery& query, const SearchRule& rule) {
    const std::int64_t fields = searchedFields(rule);
    std::vector<Hit> hits;
    const auto tryOne = [&](std::size_t index) {
        const TermFit fit = queryFit(index, query, fields);
        if (fit.tier != Tier::None) hits.push_back(hitOf(index, fit));
    };
    if (last_ && last_->rule == rule && query.isNarrowerThan(last_->query)) {
        for (const std::uint32_t index : last_->found) tryOne(index);
    } else {
        for (std::size_t index = 0; index < corpus_.size(); ++index) tryOne(index);
    }
    Last last{query, rule, {}};
    last.found.reserve(hits.size());
    for (const Hit& hit : hits) last.found.push_back(static_cast<std::uint32_t>(hit.index));
    last_ = std::move(last);
    return hits;
}

TermFit SnippetRanking::Implementation::queryFit(std::size_t index, const SearchQuery& query,
                                                 std::int64_t fields) const {
    const std::uint64_t letters = corpus_.masks(index, fields).all();
    for (const SearchTerm& term : query.terms) {
        if ((term.mask & ~letters) != 0) return {};
    }
    const SearchedTexts texts = corpus_.texts(index, fields);
    QueryFit all;
    for (const SearchTerm& term : query.terms) {
        const TermFit fit = wholeFit(texts, term);
        if (fit.tier == Tier::None) return {};
        all.add(fit);
    }
    const TermFit result = all.result();
    if (!query.whole) return result;
    const TermFit inOnePiece = fieldFit(texts, *query.whole);
    return inOnePiece.tier > result.tier ? inOnePiece : result;
}

std::vector<Hit> SnippetRanking::Implementation::loose(const SearchQuery& query, std::int64_t fields,
                                                       const std::vector<Hit>& better, bool withSlips) const {
    std::vector<Hit> hits;
    if (query.terms.empty()) return hits;
    auto known = better.begin();
    for (std::size_t index = 0; index < corpus_.size(); ++index) {
        if (known != better.end() && known->index == index) {
            ++known;
            continue;
        }
        const TermFit fit = looseQueryFit(index, query, fields, withSlips);
        if (fit.tier != Tier::None) hits.push_back(hitOf(index, fit));
    }
    return hits;
}

TermFit SnippetRanking::Implementation::looseQueryFit(std::size_t index, const SearchQuery& query, std::int64_t fields,
                                                      bool withSlips) const {
    // What has the only term whole is above the divider.
    const bool isWholeKnown = query.terms.size() == 1;
    const LetterMasks masks = corpus_.masks(index, fields);
    const std::uint64_t letters = isWholeKnown ? masks.abbreviation | masks.label : masks.all();
    // A slip brings at most one letter into the term that is nowhere else.
    const auto isTooFar = [&](const SearchTerm& term) {
        const auto strange = static_cast<std::size_t>(std::popcount(term.mask & ~letters));
        return strange > (withSlips ? forgivenSlips(term.units.size()) : 0);
    };
    if (std::any_of(query.terms.begin(), query.terms.end(), isTooFar)) return {};
    const SearchedTexts texts = corpus_.texts(index, fields);
    QueryFit all;
    for (const SearchTerm& term : query.terms) {
        TermFit fit = isWholeKnown ? TermFit{} : wholeFit(texts, term);
        if (fit.tier == Tier::None) fit = looseFit(texts, term, withSlips);
        if (fit.tier == Tier::None) return {};
        all.add(fit);
    }
    return all.result();
}

Hit SnippetRanking::Implementation::hitOf(std::size_t index, const TermFit& fit) const {
    const double score = TierWorth * fit.tier + QualityWorth * fit.quality + UseWorth * weights_[index];
    const std::size_t length = corpus_.entry(index).abbreviationLength;
    // One without an abbreviation comes after those that have one.
    constexpr auto Longest = std::numeric_limits<std::uint32_t>::max();
    return {score, length == 0 ? Longest : static_cast<std::uint32_t>(length), static_cast<std::uint32_t>(index)};
}

void SnippetRanking::Implementation::append(std::vector<RankedSnippet>& rows, const std::vector<Hit>& hits,
                                            bool isLoose) const {
    for (const Hit& hit : hits) {
        const SearchCorpus::Entry& entry = corpus_.entry(hit.index);
        rows.push_back({entry.snippet, entry.group, isLoose});
    }
}

SnippetRanking::SnippetRanking() : implementation_(std::make_unique<Implementation>()) {}

SnippetRanking::~SnippetRanking() = default;

void SnippetRanking::setLibrary(const SnippetGroups& groups) {
    implementation_->setLibrary(groups);
}

void SnippetRanking::setUses(const SnippetUses* uses) {
    implementation_->setUses(uses);
}

std::vector<RankedSnippet> SnippetRanking::search(std::u16string_view query, const SearchRule& rule) {
    return implementation_->search(query, rule);
}

void SnippetRanking::prepare() {
    implementation_->prepare();
}

void SnippetRanking::release() {
    implementation_->release();
}

std::size_t SnippetRanking::memory() const {
    return implementation_->memory();
}

}  // namespace plume

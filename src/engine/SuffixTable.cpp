#include "engine/SuffixTable.h"

#include <algorithm>

namespace plume {

namespace {
// So many entries may be gone before the filter is built anew without them.
constexpr std::size_t RemovedTolerated = 1000;
}  // namespace

void SuffixTable::reserve(std::size_t count, std::size_t end) {
    if (end > links_.size()) links_.resize(end);
    if (count > buckets_.size()) rebuild(count);
}

void SuffixTable::add(std::uint32_t entry, std::uint64_t key) {
    reserve(size_ + 1, std::size_t{entry} + 1);
    links_[entry].key = key;
    chain(entry);
    filter_.add(key);
    ++size_;
}

void SuffixTable::remove(std::uint32_t entry) {
    const Link& link = links_[entry];
    if (link.next != None) links_[link.next].previous = link.previous;
    if (link.previous != None) {
        links_[link.previous].next = link.next;
    } else {
        buckets_[bucketOf(link.key)] = link.next;
    }
    --size_;
    if (++removed_ > size_ / 2 + RemovedTolerated) rebuild(size_);
}

void SuffixTable::chain(std::uint32_t entry) {
    std::uint32_t& head = buckets_[bucketOf(links_[entry].key)];
    links_[entry].next = head;
    links_[entry].previous = None;
    if (head != None) links_[head].previous = entry;
    head = entry;
}

void SuffixTable::rebuild(std::size_t room) {
    std::vector<std::uint32_t> entries;
    entries.reserve(size_);
    for (std::uint32_t head : buckets_) {
        for (; head != None; head = links_[head].next) entries.push_back(head);
    }
    buckets_.assign(std::bit_ceil(std::max(room, buckets_.size())), None);
    filter_.reset(buckets_.size());
    removed_ = 0;
    for (const std::uint32_t entry : entries) {
        chain(entry);
        filter_.add(links_[entry].key);
    }
}

}  // namespace plume

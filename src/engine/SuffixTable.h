// Entries filed under 64-bit keys, several under one key if need be: chains through one array, with a filter in front
// that answers most questions.
//
// Entries are numbers from 0 that the owner gives out; each is filed at most once. Filing and removing take constant
// time.
#pragma once

#include <bit>
#include <cstddef>
#include <cstdint>
#include <vector>

namespace plume {

// A small, fast "certainly not" for the ends of what is typed, so that a key that completes nothing hardly ever touches
// the tables behind it, whatever their size. It never denies a key that was added; it may admit a few others.
class SuffixFilter {
  public:
    SuffixFilter() { reset(0); }

    // Empties the filter and makes room for `count` keys; more may be added, at the price of more wrong admissions.
    void reset(std::size_t count) {
        const std::size_t words = std::bit_ceil(count * BitsPerKey / 64 + 1);
        words_.assign(words, 0);
        shift_ = 64 - std::countr_zero(words);
    }
    void add(std::uint64_t key) { words_[wordOf(key)] |= bitsOf(key); }
    bool mayContain(std::uint64_t key) const {
        const std::uint64_t bits = bitsOf(key);
        return (words_[wordOf(key)] & bits) == bits;
    }

  private:
    static constexpr std::size_t BitsPerKey = 16;

    // The upper bits of a key choose the word, the lower ones four bits in it.
    std::size_t wordOf(std::uint64_t key) const { return shift_ == 64 ? 0 : static_cast<std::size_t>(key >> shift_); }
    static std::uint64_t bitsOf(std::uint64_t key) {
        return (std::uint64_t{1} << (key & 63)) | (std::uint64_t{1} << (key >> 6 & 63)) |
               (std::uint64_t{1} << (key >> 12 & 63)) | (std::uint64_t{1} << (key >> 18 & 63));
    }

    std::vector<std::uint64_t> words_;
    int shift_ = 64;
};

class SuffixTable {
  public:
    static constexpr std::uint32_t None = 0xffffffff;

    SuffixTable() : buckets_(1, None) {}

    std::size_t size() const { return size_; }
    // Makes room for `count` entries in all, numbered below `end`.
    void reserve(std::size_t count, std::size_t end);
    void add(std::uint32_t entry, std::uint64_t key);
    void remove(std::uint32_t entry);

    bool mayContain(std::uint64_t key) const { return filter_.mayContain(key); }
    // The entries under the key: the first one, and the one after another; None at the end.
    std::uint32_t first(std::uint64_t key) const { return skipTo(key, buckets_[bucketOf(key)]); }
    std::uint32_t next(std::uint32_t entry) const { return skipTo(links_[entry].key, links_[entry].next); }

  private:
    struct Link {
        std::uint64_t key = 0;
        std::uint32_t next = None;
        std::uint32_t previous = None;
    };

    std::size_t bucketOf(std::uint64_t key) const { return static_cast<std::size_t>(key & (buckets_.size() - 1)); }
    std::uint32_t skipTo(std::uint64_t key, std::uint32_t entry) const {
        while (entry != None && links_[entry].key != key) entry = links_[entry].next;
        return entry;
    }
    void chain(std::uint32_t entry);
    void rebuild(std::size_t room);

    std::vector<std::uint32_t> buckets_;  // a power of two
    std::vector<Link> links_;             // by entry
    SuffixFilter filter_;
    std::size_t size_ = 0;
    std::size_t removed_ = 0;  // since the filter was built: it still admits their keys
};

}  // namespace plume

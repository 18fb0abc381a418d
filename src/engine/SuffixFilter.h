// A small, fast "certainly not" for the ends of what is typed, so that a key that completes nothing hardly ever touches
// the tables behind it, whatever their size. It never denies a key that was added; it may admit a few others.
#pragma once

#include <bit>
#include <cstddef>
#include <cstdint>
#include <vector>

namespace plume {

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

}  // namespace plume

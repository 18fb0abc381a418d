#include "engine/BeginningTable.h"

#include <unicode/utf16.h>

#include <limits>

#include "Foundation/Strings.h"

namespace plume {

namespace {

constexpr std::size_t UnitsKept = 4;
constexpr unsigned BitsPerUnit = 16;
constexpr char32_t SurrogateMask = 0xfc00;
// So many entries may be gone before the array is made anew without them.
constexpr std::size_t RemovedBeginningsTolerated = 1000;

// The case of a character beyond the basic plane is in the second half of its pair, which is not looked at.
std::uint64_t packedUnits(std::u16string_view text) {
    std::uint64_t units = 0;
    for (std::size_t i = 0; i < UnitsKept; ++i) {
        const char16_t unit = i < text.size() ? text[i] : u'\0';
        units = units << BitsPerUnit | (U16_IS_TRAIL(unit) ? unit & SurrogateMask : foldedCodePoint(unit));
    }
    return units;
}

}  // namespace

void BeginningTable::reserve(std::size_t count, std::size_t end) {
    filed_.reserve(count + removed_);
    versions_.reserve(end);
}

void BeginningTable::add(std::uint32_t entry, std::u16string_view text) {
    if (entry >= versions_.size()) versions_.resize(std::size_t{entry} + 1);
    filed_.push_back({packedUnits(text), entry, ++versions_[entry]});
}

void BeginningTable::remove(std::uint32_t entry) {
    ++versions_[entry];
    if (++removed_ > filed_.size() / 2 + RemovedBeginningsTolerated) dropRemoved();
}

void BeginningTable::dropRemoved() {
    const auto isRemoved = [this](const Filed& filed) { return !isCurrent(filed); };
    const auto added = filed_.begin() + static_cast<std::ptrdiff_t>(sorted_);
    sorted_ -= static_cast<std::size_t>(std::count_if(filed_.begin(), added, isRemoved));
    std::erase_if(filed_, isRemoved);
    removed_ = 0;
}

void BeginningTable::mergeAdded() const {
    const auto isBefore = [](const Filed& a, const Filed& b) { return a.units < b.units; };
    const auto added = filed_.begin() + static_cast<std::ptrdiff_t>(sorted_);
    std::sort(added, filed_.end(), isBefore);
    std::inplace_merge(filed_.begin(), added, filed_.end(), isBefore);
    sorted_ = filed_.size();
}

BeginningTable::Limits BeginningTable::limitsOf(std::u16string_view beginning) {
    const std::uint64_t first = packedUnits(beginning);
    if (beginning.size() >= UnitsKept) return {first, first};
    const auto open = static_cast<unsigned>(UnitsKept - beginning.size()) * BitsPerUnit;
    return {first, first | (std::numeric_limits<std::uint64_t>::max() >> (UnitsKept * BitsPerUnit - open))};
}

}  // namespace plume

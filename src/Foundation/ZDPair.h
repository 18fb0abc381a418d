// A plain pair, used for match results: a snippet and the text as typed for it.
#pragma once

namespace plume {

template <typename First, typename Second>
struct ZDPair {
    First first;
    Second second;

    bool operator==(const ZDPair&) const = default;
};

}  // namespace plume

// Counts this program's allocations, for the promises that something allocates nothing.
#pragma once

#include <cstddef>

namespace plume {

// How often `operator new` was called so far, by any thread.
std::size_t allocationCount();

}  // namespace plume

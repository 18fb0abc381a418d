#pragma once

#include <cstdlib>
#include <memory>

namespace plume::rig {

struct FreeDeleter {
    void operator()(void* memory) const { std::free(memory); }
};

// Owns an XCB reply or event.
template <typename Type>
using XcbOwned = std::unique_ptr<Type, FreeDeleter>;

template <typename Type>
XcbOwned<Type> own(Type* reply) {
    return XcbOwned<Type>(reply);
}

}  // namespace plume::rig

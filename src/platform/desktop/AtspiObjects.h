// Owners of what libatspi hands out, and the small questions that several files ask. All on the accessibility thread.
#pragma once

#include <atspi/atspi.h>

#include <memory>
#include <string>

namespace plume {

struct GObjectUnref {
    void operator()(void* object) const { g_object_unref(object); }
};
template <typename Type>
using GObjectOwned = std::unique_ptr<Type, GObjectUnref>;

struct GlibFree {
    void operator()(void* memory) const { g_free(memory); }
};
template <typename Type>
using GlibOwned = std::unique_ptr<Type, GlibFree>;

// What a call reports besides its result. Some calls that fail report nothing.
class AtspiError {
  public:
    AtspiError() = default;
    ~AtspiError() { g_clear_error(&error_); }
    AtspiError(const AtspiError&) = delete;
    AtspiError& operator=(const AtspiError&) = delete;

    GError** out() { return &error_; }
    bool isSet() const { return error_ != nullptr; }

  private:
    GError* error_ = nullptr;
};

// A part of a program's user interface. May be copied and let go of on any thread; asked on the accessibility thread.
using AtspiPart = std::shared_ptr<AtspiAccessible>;

// As they are now: libatspi keeps copies that nobody keeps up to date.
inline GObjectOwned<AtspiStateSet> statesOf(AtspiAccessible* part) {
    part->cached_properties &= ~static_cast<guint>(ATSPI_CACHE_STATES);
    return GObjectOwned<AtspiStateSet>(atspi_accessible_get_state_set(part));
}

inline bool hasState(AtspiAccessible* part, AtspiStateType state) {
    const auto states = statesOf(part);
    return states && atspi_state_set_contains(states.get(), state) != 0;
}

inline bool areOfSameProgram(AtspiAccessible* a, AtspiAccessible* b) {
    return a != nullptr && b != nullptr && a->parent.app == b->parent.app;
}

}  // namespace plume

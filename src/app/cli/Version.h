#pragma once

namespace plume {

// Set by the build.
inline constexpr const char* Version = PLUME_VERSION;

}  // namespace plume

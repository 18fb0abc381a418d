// Programs that need a while, after they have come to the front again, until they take keys.
#pragma once

#include <optional>
#include <string>

namespace plume {

inline constexpr double ActivationDelay = 0.5;  // seconds

inline bool losesKeysWhileActivated(const std::optional<std::u16string>& bundleIdentifier) {
    return bundleIdentifier == u"com.citrix.XenAppViewer";
}

}  // namespace plume

// Where a group of snippets, or auto-correction, is active: in which applications, with which keyboard input sources.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace plume {

// A plain record; copies are independent. Values outside those named below are kept as they are: an `availability` of
// another value means nowhere, any other non-zero `inputMethodsOption` means only the listed ones.
struct PLFunctionAvailability {
    enum : std::int64_t { Everywhere = 0, ExceptListed = 1, OnlyListed = 2 };

    std::int64_t availability = Everywhere;
    std::optional<std::vector<std::u16string>> applications;  // bundle identifiers
    std::int64_t inputMethodsOption = Everywhere;
    std::optional<std::vector<std::u16string>> inputMethods;  // input source identifiers

    // Nothing as identifier (no application, no input source) is on no list.
    bool admitsApplication(const std::optional<std::u16string>& bundleIdentifier) const;
    bool admitsInputSource(const std::optional<std::u16string>& identifier) const;

    bool operator==(const PLFunctionAvailability&) const = default;
};

}  // namespace plume

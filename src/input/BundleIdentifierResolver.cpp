#include "input/BundleIdentifierResolver.h"

#include <utility>

namespace plume {

const std::optional<std::u16string>& BundleIdentifierResolver::getBundleIdentifier(ProcessSerialNumber process) {
    static const std::optional<std::u16string> unknown;

    const std::int64_t number = processSerialNumberToNumber(process);
    const auto known = processSerialNumbersAndIdentifiers_.find(number);
    if (known != processSerialNumbersAndIdentifiers_.end()) return known->second;

    std::optional<RunningApplication> application = processManager_.runningApplication(process);
    if (!application) return unknown;
    // Programs that are no bundles ("wine") are listed by their plain names.
    auto& identifier = application->bundleIdentifier ? application->bundleIdentifier : application->localizedName;
    if (!identifier) return unknown;
    return processSerialNumbersAndIdentifiers_.emplace(number, std::move(identifier)).first->second;
}

std::int64_t BundleIdentifierResolver::processSerialNumberToNumber(ProcessSerialNumber process) {
    const std::uint64_t high = process.highLongOfPSN;
    return static_cast<std::int64_t>(high << 32 | process.lowLongOfPSN);
}

ProcessSerialNumber BundleIdentifierResolver::numberToProcessSerialNumber(std::optional<std::int64_t> number) {
    const auto bits = static_cast<std::uint64_t>(number.value_or(0));
    return {static_cast<std::uint32_t>(bits >> 32), static_cast<std::uint32_t>(bits)};
}

std::optional<RunningApplication> foregroundApplication(const ProcessManager& processManager) {
    const std::optional<ProcessSerialNumber> front = processManager.frontProcess();
    if (!front) return std::nullopt;
    return processManager.runningApplication(*front);
}

}  // namespace plume

// Which application a process is, under the name that settings and application lists know it by.
//
// Owned by the engine's composition root; used on the thread that delivers the key events, where nearly every question
// is answered from the cache. Failures are answered with nothing and are asked again the next time.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <unordered_map>

#include "platform/ProcessManager.h"

namespace plume {

class BundleIdentifierResolver {
  public:
    // The process manager is not owned and outlives the resolver.
    explicit BundleIdentifierResolver(const ProcessManager& processManager) : processManager_(processManager) {}

    // The bundle identifier, or the localized name of an application without one, or nothing when it has neither. The
    // reference is good as long as the resolver. An answer once given stays, also when the process is gone.
    const std::optional<std::u16string>& getBundleIdentifier(ProcessSerialNumber process);

    // A serial number as one number: the high half in the upper 32 bits.
    static std::int64_t processSerialNumberToNumber(ProcessSerialNumber process);
    // Nothing gives the serial number that names no process.
    static ProcessSerialNumber numberToProcessSerialNumber(std::optional<std::int64_t> number);

  private:
    const ProcessManager& processManager_;
    std::unordered_map<std::int64_t, std::optional<std::u16string>> processSerialNumbersAndIdentifiers_;
};

// The application that has the keyboard, or nothing.
std::optional<RunningApplication> foregroundApplication(const ProcessManager& processManager);

}  // namespace plume

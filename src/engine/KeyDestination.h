// Where a key went: the application and the input source, named only when somebody asks.
//
// Made for one question on the thread that delivers the key events; what it refers to outlives it.
#pragma once

#include <optional>
#include <string>

#include "input/BundleIdentifierResolver.h"
#include "library/PLFunctionAvailability.h"
#include "platform/InputSources.h"

namespace plume {

class KeyDestination {
  public:
    KeyDestination(BundleIdentifierResolver& resolver, const InputSources& inputSources, ProcessSerialNumber process)
        : resolver_(resolver), inputSources_(inputSources), process_(process) {}

    // Nothing when the process has no name. Good as long as the resolver.
    const std::optional<std::u16string>& bundleIdentifier() const { return resolver_.getBundleIdentifier(process_); }

    // Cost nothing where there are no limits.
    bool isAdmittedBy(const PLFunctionAvailability& where) const {
        return isApplicationAdmittedBy(where) && isInputSourceAdmittedBy(where);
    }
    bool isApplicationAdmittedBy(const PLFunctionAvailability& where) const {
        return where.availability == PLFunctionAvailability::Everywhere || where.admitsApplication(bundleIdentifier());
    }
    bool isInputSourceAdmittedBy(const PLFunctionAvailability& where) const {
        return where.inputMethodsOption == PLFunctionAvailability::Everywhere ||
               where.admitsInputSource(inputSources_.currentInputSourceIdentifier());
    }

  private:
    BundleIdentifierResolver& resolver_;
    const InputSources& inputSources_;
    ProcessSerialNumber process_;
};

}  // namespace plume

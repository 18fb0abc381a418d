// Settings from a JSON object, over the registered defaults.
#pragma once

#include <memory>
#include <string>
#include <string_view>

#include "Foundation/Result.h"
#include "Foundation/json/JsonNode.h"
#include "platform/UserDefaults.h"

namespace plume {

class SettingsFile {
  public:
    // Every setting as it is when the user has changed none.
    static std::shared_ptr<const UserDefaults> registeredDefaults();
    // Only settings that Plume knows, each of its own type. The error names the file, the place in it and what was
    // expected.
    static Result<std::shared_ptr<const UserDefaults>> read(std::string_view text, const std::string& fileName);
    // Throws JsonError.
    static std::shared_ptr<const UserDefaults> readFrom(const JsonNode& node);
};

}  // namespace plume

#include "library/SettingsFile.h"

#include "library/KnownSettings.h"
#include "library/MemoryUserDefaults.h"

namespace plume {

namespace {

std::shared_ptr<MemoryUserDefaults> makeDefaults() {
    auto defaults = std::make_shared<MemoryUserDefaults>();
    defaults->registerDefaults(registeredSettings());
    return defaults;
}

}  // namespace

std::shared_ptr<const UserDefaults> SettingsFile::registeredDefaults() {
    return makeDefaults();
}

Result<std::shared_ptr<const UserDefaults>> SettingsFile::read(std::string_view text, const std::string& fileName) {
    return readingJson([&] { return readFrom(JsonNode::parse(text, fileName)); });
}

std::shared_ptr<const UserDefaults> SettingsFile::readFrom(const JsonNode& node) {
    const auto defaults = makeDefaults();
    for (const auto& [name, value] : node.members()) {
        const KnownSetting* setting = findKnownSetting(name);
        if (!setting) value.fail("unknown setting; expected one of those that Plume knows");
        defaults->set(name, setting->read(value));
    }
    return defaults;
}

}  // namespace plume

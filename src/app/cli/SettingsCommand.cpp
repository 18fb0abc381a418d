#include "app/cli/SettingsCommand.h"

#include <algorithm>
#include <ostream>
#include <utility>

#include "app/cli/CommandLine.h"
#include "app/cli/Files.h"
#include "library/KnownSettings.h"
#include "library/SettingValues.h"
#include "ports/posix/store/SqliteStore.h"

namespace plume {

namespace {

using Json = nlohmann::ordered_json;

// A text that stands alone needs no quotes.
std::string shown(const PropertyList& value) {
    const Json json = settingAsJson(value);
    return json.is_string() ? json.get<std::string>() : json.dump();
}

void showAll(const WritableUserDefaults& settings, std::ostream& output) {
    const auto own = settings.ownKeys();
    std::size_t width = 0;
    for (const KnownSetting& setting : knownSettings()) width = std::max(width, setting.name.size());
    for (const KnownSetting& setting : knownSettings()) {
        const bool isOwn = std::find(own.begin(), own.end(), setting.name) != own.end();
        const auto value = settings.objectForKey(setting.name);
        output << (isOwn ? "* " : "  ") << setting.name;
        if (value) output << std::string(width - setting.name.size() + 2, ' ') << settingAsJson(*value).dump();
        output << '\n';
    }
    output << "A star marks the values that you have set.\n";
}

class Session {
  public:
    Session(const SettingsRequest& request, WritableUserDefaults& settings, std::ostream& output, std::ostream& error)
        : request_(request), settings_(settings), output_(output), error_(error) {}

    int run() {
        if (!request_.key) return showAll(settings_, output_), ExitStatus::Success;
        const KnownSetting* setting = findKnownSetting(*request_.key);
        if (!setting) {
            return refuse("there is no setting \"" + *request_.key + R"("; "plume settings" shows all)",
                          ExitStatus::WrongInput);
        }
        if (request_.toDefault) return ended(settings_.removeObject(setting->name));
        if (request_.value) return set(*setting);
        if (const auto value = settings_.objectForKey(setting->name)) output_ << shown(*value) << '\n';
        return ExitStatus::Success;
    }

  private:
    int set(const KnownSetting& setting) {
        auto value = settingFromText(setting, *request_.value);
        if (!value) return refuse(value.error().message, ExitStatus::WrongInput);
        return ended(settings_.setObject(setting.name, std::move(value).value()));
    }

    int ended(const Result<void>& written) {
        return written ? ExitStatus::Success : refuse(written.error().message, ExitStatus::Failure);
    }

    int refuse(const std::string& reason, int status) {
        error_ << "plume: " << reason << '\n';
        return status;
    }

    const SettingsRequest& request_;
    WritableUserDefaults& settings_;
    std::ostream& output_;
    std::ostream& error_;
};

}  // namespace

int runSettingsCommand(const SettingsRequest& request, const std::filesystem::path& folder, std::ostream& output,
                       std::ostream& error) {
    const auto opened = SqliteStore::open(folder, nullptr);
    if (!opened) {
        error << "plume: " << opened.error().message << '\n';
        return ExitStatus::Failure;
    }
    for (const std::string& problem : opened.value().problems) error << "plume: " << problem << '\n';
    WritableUserDefaults& settings = opened.value().store->settings();
    settings.registerDefaults(registeredSettings(backupFolder()));
    return Session(request, settings, output, error).run();
}

}  // namespace plume

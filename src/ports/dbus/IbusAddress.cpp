#include "ports/dbus/IbusAddress.h"

#include <dbus/dbus.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <memory>

namespace plume {

namespace {

std::filesystem::path settingsFolder() {
    const char* const folder = std::getenv("XDG_CONFIG_HOME");
    if (folder != nullptr && *folder != '\0') return folder;
    const char* const home = std::getenv("HOME");
    return std::filesystem::path(home != nullptr ? home : "/") / ".config";
}

// "unix-0" for ":0" and ":0.0".
std::string fileEnding(const std::string& display) {
    const std::size_t colon = display.find(':');
    if (colon == std::string::npos) return {};
    const std::string host = colon == 0 ? "unix" : display.substr(0, colon);
    return host + "-" + display.substr(colon + 1, display.find('.', colon) - colon - 1);
}

}  // namespace

std::string ibusAddress(const std::string& display) {
    const std::unique_ptr<char, void (*)(void*)> machine(dbus_get_local_machine_id(), dbus_free);
    if (!machine) return {};
    std::ifstream file(settingsFolder() / "ibus" / "bus" / (std::string(machine.get()) + "-" + fileEnding(display)));
    constexpr std::string_view Name = "IBUS_ADDRESS=";
    for (std::string line; std::getline(file, line);) {
        if (line.starts_with(Name)) return line.substr(Name.size());
    }
    return {};
}

}  // namespace plume

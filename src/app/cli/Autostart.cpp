#include "app/cli/Autostart.h"

#include <filesystem>
#include <string>

#include "app/cli/Files.h"

namespace plume {

namespace {

std::filesystem::path entry() {
    const std::filesystem::path own = configurationFolder();
    return own.empty() ? own : own.parent_path() / "autostart" / "org.plume.Plume.desktop";
}

// As the desktop entry format wants an argument with special characters.
std::string quoted(const std::string& text) {
    std::string result = "\"";
    for (const char c : text) {
        if (c == '"' || c == '`' || c == '$' || c == '\\') result += "\\\\";
        if (c == '%') result += '%';
        result += c;
    }
    return result + "\"";
}

}  // namespace

bool Autostart::isOn() const {
    const auto text = files_.read(entry());
    return text && text.value().find("\nHidden=true") == std::string::npos;
}

Result<void> Autostart::set(bool on) {
    const std::filesystem::path file = entry();
    if (file.empty()) return Error{"there is no home folder to keep this in: set HOME"};
    if (!on) return files_.exists(file) ? files_.remove(file) : Result<void>();
    if (const auto made = files_.createFolder(file.parent_path()); !made) return made;
    return files_.write(file, "[Desktop Entry]\nType=Application\nName=Plume\nIcon=org.plume.Plume\nExec=" +
                                  quoted((programFolder() / "plume").string()) +
                                  "\nX-GNOME-Autostart-Delay=2\nX-KDE-autostart-after=panel\n");
}

}  // namespace plume

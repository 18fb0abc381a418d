#include "ports/x11/windows/DesktopFiles.h"

#include <algorithm>
#include <cstdlib>
#include <fstream>
#include <set>
#include <sstream>
#include <system_error>

namespace plume {

namespace {

namespace fs = std::filesystem;

constexpr std::string_view Suffix = ".desktop";
constexpr std::size_t LargestFile = std::size_t{1} << 20;  // bytes; real ones have a few thousand
constexpr int DeepestFolder = 8;

std::string lowercasedAscii(std::string_view text) {
    std::string result(text);
    for (char& c : result) {
        if (c >= 'A' && c <= 'Z') c = static_cast<char>(c - 'A' + 'a');
    }
    return result;
}

// "de_DE.UTF-8@euro" and "de_DE" look for Name[de_DE] first, then for Name[de].
std::vector<std::string> nameKeysFor(std::string_view locale) {
    const std::string_view region = locale.substr(0, locale.find_first_of(".@"));
    const std::string_view language = region.substr(0, region.find('_'));
    std::vector<std::string> keys;
    for (const std::string_view place : {region, language}) {
        if (!place.empty()) keys.push_back("Name[" + std::string(place) + "]");
    }
    keys.emplace_back("Name");
    return keys;
}

// The file name of the program in a command line, past an "env" and its settings.
std::string programOf(const std::string& command) {
    std::istringstream words(command);
    std::string word;
    while (words >> word) {
        std::erase(word, '"');
        std::string name = word.substr(word.find_last_of('/') + 1);
        const bool isSetting = word.find('=') != std::string::npos;
        if (!isSetting && name != "env") return name;
    }
    return {};
}

using Entries = std::map<std::string, std::string, std::less<>>;

// The keys of the section that describes the application.
Entries entriesOf(std::istream& file) {
    Entries entries;
    std::string line;
    bool isInSection = false;
    while (std::getline(file, line)) {
        if (line.starts_with('[')) {
            if (isInSection) break;
            isInSection = line.starts_with("[Desktop Entry]");
        }
        const auto equals = line.find('=');
        if (!isInSection || equals == std::string::npos || line.starts_with('#')) continue;
        const auto keyEnd = line.find_last_not_of(' ', equals - 1);
        const auto valueStart = line.find_first_not_of(' ', equals + 1);
        if (equals == 0 || keyEnd == std::string::npos || valueStart == std::string::npos) continue;
        entries.emplace(line.substr(0, keyEnd + 1), line.substr(valueStart));
    }
    return entries;
}

std::string valueOf(const Entries& entries, std::string_view key) {
    const auto found = entries.find(key);
    return found == entries.end() ? std::string() : found->second;
}

DesktopFile desktopFileOf(std::string identifier, const Entries& entries, std::string_view locale) {
    DesktopFile file;
    file.identifier = std::move(identifier);
    for (const std::string& key : nameKeysFor(locale)) {
        if (file.name.empty()) file.name = valueOf(entries, key);
    }
    file.startupWMClass = valueOf(entries, "StartupWMClass");
    file.program = programOf(valueOf(entries, "Exec"));
    file.icon = valueOf(entries, "Icon");
    file.isHidden = valueOf(entries, "NoDisplay") == "true" || valueOf(entries, "Hidden") == "true";
    return file;
}

// "kde/konsole.desktop" is known as "kde-konsole".
std::string identifierOf(const fs::path& file, const fs::path& folder) {
    std::string identifier = file.lexically_relative(folder).string();
    identifier.resize(identifier.size() - Suffix.size());
    std::replace(identifier.begin(), identifier.end(), '/', '-');
    return identifier;
}

std::vector<fs::path> desktopFilesIn(const fs::path& folder) {
    std::vector<fs::path> found;
    std::error_code error;
    fs::recursive_directory_iterator next(
        folder, fs::directory_options::follow_directory_symlink | fs::directory_options::skip_permission_denied, error);
    for (; !error && next != fs::recursive_directory_iterator(); next.increment(error)) {
        if (next.depth() >= DeepestFolder) next.disable_recursion_pending();
        const std::string name = next->path().filename().string();
        std::error_code ignored;
        if (name.size() <= Suffix.size() || !name.ends_with(Suffix)) continue;
        if (next->is_regular_file(ignored) && next->file_size(ignored) <= LargestFile) found.push_back(next->path());
    }
    std::sort(found.begin(), found.end());
    return found;
}

std::string environment(const char* name, const std::string& otherwise) {
    const char* const value = std::getenv(name);
    return value && *value ? value : otherwise;
}

}  // namespace

DesktopFiles::DesktopFiles(const std::vector<fs::path>& folders, std::string_view locale) {
    for (const fs::path& folder : folders) readFolder(folder / "applications", locale);
    makeIndexes();
}

std::shared_ptr<const DesktopFiles> DesktopFiles::ofEnvironment() {
    std::vector<fs::path> folders = {environment("XDG_DATA_HOME", environment("HOME", "/") + "/.local/share")};
    std::istringstream list(environment("XDG_DATA_DIRS", "/usr/local/share:/usr/share"));
    for (std::string folder; std::getline(list, folder, ':');) {
        if (!folder.empty()) folders.emplace_back(folder);
    }
    const std::string locale = environment("LC_ALL", environment("LC_MESSAGES", environment("LANG", "C")));
    return std::make_shared<const DesktopFiles>(folders, locale);
}

void DesktopFiles::readFolder(const fs::path& folder, std::string_view locale) {
    for (const fs::path& path : desktopFilesIn(folder)) {
        std::string identifier = identifierOf(path, folder);
        std::string key = lowercasedAscii(identifier);
        if (files_.contains(key)) continue;  // a more important folder says what it is
        std::ifstream file(path);
        const Entries entries = entriesOf(file);
        files_.emplace(std::move(key), desktopFileOf(std::move(identifier), entries, locale));
    }
}

void DesktopFiles::makeIndexes() {
    std::set<std::string> shared;
    for (const auto& [key, file] : files_) {
        if (!file.startupWMClass.empty()) byStartupClass_.emplace(lowercasedAscii(file.startupWMClass), &file);
        if (file.program.empty()) continue;
        if (!byProgram_.emplace(lowercasedAscii(file.program), &file).second) {
            shared.insert(lowercasedAscii(file.program));
        }
    }
    // An interpreter, or an office suite: its name does not tell which application it is.
    for (const std::string& program : shared) byProgram_.erase(program);
}

std::vector<DesktopFile> DesktopFiles::shown() const {
    std::vector<DesktopFile> files;
    for (const auto& [key, file] : files_) {
        if (!file.isHidden && !file.name.empty()) files.push_back(file);
    }
    return files;
}

const DesktopFile* DesktopFiles::find(const WindowIdentity& window) const {
    const auto in = [](const Index& index, std::string_view name) -> const DesktopFile* {
        const auto found = index.find(lowercasedAscii(name));
        return found == index.end() ? nullptr : found->second;
    };
    const auto byIdentifier = [this](std::string_view name) -> const DesktopFile* {
        const auto found = files_.find(lowercasedAscii(name));
        return found == files_.end() ? nullptr : &found->second;
    };
    if (const auto* file = in(byStartupClass_, window.windowClass)) return file;
    if (const auto* file = in(byStartupClass_, window.windowInstance)) return file;
    if (const auto* file = byIdentifier(window.gtkApplicationId)) return file;
    if (const auto* file = byIdentifier(window.windowClass)) return file;
    if (const auto* file = byIdentifier(window.windowInstance)) return file;
    return in(byProgram_, window.program);
}

}  // namespace plume

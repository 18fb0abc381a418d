// What the installed applications say of themselves: their desktop files, found by what a window tells of its program.
//
// Read once, then never changed: any thread may ask.
#pragma once

#include <filesystem>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace plume {

struct DesktopFile {
    std::string identifier;      // the file's name below its folder, without the suffix
    std::string name;            // in the user's language
    std::string startupWMClass;  // empty when not told
    std::string program;         // the file name of what it runs
    std::string icon;            // of an icon theme, or a path
    bool isHidden = false;       // not for menus
};

// What a window and its process tell; empty where they tell nothing.
struct WindowIdentity {
    std::string windowClass;
    std::string windowInstance;
    std::string gtkApplicationId;
    std::string program;  // the file name of the running program
};

class DesktopFiles {
  public:
    // `folders` are the data folders, the most important first; `locale` as in LANG. Unreadable files are left out.
    DesktopFiles(const std::vector<std::filesystem::path>& folders, std::string_view locale);
    // The user's and the system's applications, as the environment names them. Reads a few hundred small files.
    static std::shared_ptr<const DesktopFiles> ofEnvironment();

    // The application that a window belongs to; null when none fits. Letter case makes no difference.
    const DesktopFile* find(const WindowIdentity& window) const;
    // Those that menus show.
    std::vector<DesktopFile> shown() const;

  private:
    using Index = std::map<std::string, const DesktopFile*, std::less<>>;

    void readFolder(const std::filesystem::path& folder, std::string_view locale);
    void makeIndexes();

    std::map<std::string, DesktopFile, std::less<>> files_;  // by lowercased identifier
    Index byStartupClass_;
    Index byProgram_;  // only programs that one file alone runs
};

}  // namespace plume

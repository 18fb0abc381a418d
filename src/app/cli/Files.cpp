#include "app/cli/Files.h"

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <fstream>
#include <system_error>

namespace plume {

namespace {

constexpr std::uintmax_t LargestFile = std::uintmax_t{256} * 1024 * 1024;

Error cannotRead(const std::filesystem::path& path, const std::string& reason) {
    return Error{path.string() + " cannot be read: " + reason};
}

// Plume's own in the folder that the variable names, or in that one below the home.
std::filesystem::path ownFolder(const char* variable, const char* belowHome) {
    const char* const named = std::getenv(variable);
    if (named && *named == '/') return std::filesystem::path(named) / "plume";
    const char* const home = std::getenv("HOME");
    return home && *home ? std::filesystem::path(home) / belowHome / "plume" : std::filesystem::path();
}

}  // namespace

Result<std::string> readWholeFile(const std::filesystem::path& path) {
    std::error_code problem;
    const auto status = std::filesystem::status(path, problem);
    if (std::filesystem::is_directory(status)) return cannotRead(path, "it is a folder");
    errno = 0;
    std::ifstream file(path, std::ios::binary);
    if (!file) return cannotRead(path, errno != 0 ? std::strerror(errno) : "it cannot be opened");
    std::string bytes;
    constexpr std::size_t PieceLength = std::size_t{64} * 1024;
    std::string piece(PieceLength, '\0');
    while (file.read(piece.data(), static_cast<std::streamsize>(piece.size())), file.gcount() > 0) {
        bytes.append(piece, 0, static_cast<std::size_t>(file.gcount()));
        if (bytes.size() > LargestFile) return cannotRead(path, "it is larger than 256 MiB");
    }
    if (file.bad()) return cannotRead(path, "the system cannot read it to its end");
    return bytes;
}

std::filesystem::path configurationFolder() {
    return ownFolder("XDG_CONFIG_HOME", ".config");
}

std::filesystem::path backupFolder() {
    const auto data = ownFolder("XDG_DATA_HOME", ".local/share");
    return data.empty() ? data : data / "Backups";
}

std::filesystem::path programFolder() {
    std::error_code problem;
    return std::filesystem::read_symlink("/proc/self/exe", problem).parent_path();
}

std::filesystem::path dataFolder() {
    return programFolder().parent_path() / "share" / "plume";
}

std::filesystem::path soundFolder() {
    return dataFolder() / "sounds";
}

std::filesystem::path translationFolder() {
    return dataFolder() / "translations";
}

}  // namespace plume

// The library of a file that may change while it is used.
#pragma once

#include <filesystem>
#include <functional>
#include <memory>
#include <string>

#include "Foundation/Result.h"
#include "library/LibraryArchive.h"
#include "platform/FileWatcher.h"
#include "platform/Files.h"

namespace plume {

class FollowedLibrary {
  public:
    // The error names the file, and the place in it.
    static Result<std::unique_ptr<FollowedLibrary>> open(const std::filesystem::path& file, const Files& files);

    const SnippetGroups& groups() const { return groups_; }
    const std::filesystem::path& path() const { return file_; }
    // From now on `changed` is called when the file holds another library. One with a mistake is reported, and the one
    // before stays. Everything outlives this.
    void follow(FileWatcher& watcher, std::function<void()> changed,
                std::function<void(const std::string& sentence)> report);

  private:
    FollowedLibrary(std::filesystem::path file, const Files& files) : file_(std::move(file)), files_(files) {}
    Result<void> read();

    const std::filesystem::path file_;
    const Files& files_;
    std::string bytes_;
    SnippetGroups groups_;
    Subscription watch_;
};

}  // namespace plume

// The system's files.
//
// A file is written to another name in the same folder, brought to the disk and put in the place of the old one; a
// symbolic link stays, and what it leads to is written. Folders that are made are the user's alone (0700).
#pragma once

#include <functional>

#include "platform/Files.h"

namespace plume {

class PosixFiles final : public Files {
  public:
    bool exists(const Path& path) const override;
    bool isFolder(const Path& path) const override;
    Result<std::string> read(const Path& path) const override;
    Result<void> write(const Path& path, std::string_view bytes) override;
    Result<bool> replace(const Path& path, const std::optional<std::string>& expected, std::string_view bytes) override;
    Result<void> createFolder(const Path& path) override;
    Result<std::vector<Entry>> list(const Path& folder) const override;
    Result<void> remove(const Path& path) override;
    Result<void> moveToTrash(const Path& path) override;

  private:
    // Asked when everything is written that can be written before.
    Result<bool> writeIf(const std::function<Result<bool>()>& wanted, const Path& path, std::string_view bytes) const;
};

}  // namespace plume

// Files and folders in memory, which fail when they are told to.
#pragma once

#include <cstdint>
#include <functional>
#include <map>
#include <mutex>
#include <string>
#include <string_view>
#include <vector>

#include "platform/Files.h"

namespace plume {

// From any thread. There is a folder at the root; files carry the currentDate() of their last write.
class SimulatedFiles final : public Files {
  public:
    struct TrashedFile {
        Path path;  // where it was
        std::string bytes;
    };

    bool exists(const Path& path) const override;
    bool isFolder(const Path& path) const override;
    Result<std::string> read(const Path& path) const override;
    Result<void> write(const Path& path, std::string_view bytes) override;
    Result<bool> replace(const Path& path, const std::optional<std::string>& expected, std::string_view bytes) override;
    Result<void> createFolder(const Path& path) override;
    // In the order in which they came to be.
    Result<std::vector<Entry>> list(const Path& folder) const override;
    Result<void> remove(const Path& path) override;
    Result<void> moveToTrash(const Path& path) override;

    // How the system fails.
    // So many more bytes can be written; what does not fit fails as a whole. Nothing: the disk never gets full.
    void setFreeBytes(std::optional<std::size_t> bytes);
    // A file or a folder that can neither be read nor listed.
    void setUnreadable(const Path& path, bool unreadable);
    // Everything at this path and below is gone, as when a disk is taken out.
    void vanish(const Path& path);
    // Nothing: the system does not tell.
    void setModified(const Path& path, std::optional<Date> modified);

    std::vector<TrashedFile> trash() const;
    // Called on the writer's thread with the path of what has changed. Set while nothing else uses the files.
    void setListener(std::function<void(const Path&)> listener) { listener_ = std::move(listener); }
    // Called once, in the last moment before the next replace() looks at the file.
    void setBeforeReplace(std::function<void()> call) { beforeReplace_ = std::move(call); }

  private:
    struct Node {
        bool isFolder = false;
        std::string bytes = {};
        std::optional<Date> modified = {};
        bool unreadable = false;
        std::uint64_t number = 0;  // grows in the order in which they are made
    };

    // With the lock held.
    const Node* find(const Path& path) const;
    bool isFolderAt(const Path& path) const;
    Result<void> addFolders(const Path& path, std::vector<Path>& made);
    Result<void> removeAt(const Path& path, const char* verb);

    Result<void> told(Result<void> result, const Path& path) const;

    mutable std::mutex mutex_;
    std::map<Path, Node> nodes_;  // guarded by mutex_, as is all below but the listener
    std::vector<TrashedFile> trash_;
    std::optional<std::size_t> freeBytes_;
    std::uint64_t lastNumber_ = 0;
    std::function<void(const Path&)> listener_;
    std::function<void()> beforeReplace_;
};

}  // namespace plume

#include "app/cli/FollowedLibrary.h"

#include <utility>

#include "import/Importers.h"

namespace plume {

Result<std::unique_ptr<FollowedLibrary>> FollowedLibrary::open(const std::filesystem::path& file, const Files& files) {
    std::unique_ptr<FollowedLibrary> library(new FollowedLibrary(file, files));
    if (const auto read = library->read(); !read) return read.error();
    return library;
}

Result<void> FollowedLibrary::read() {
    auto bytes = files_.read(file_);
    if (!bytes) return bytes.error();
    if (bytes.value() == bytes_) return {};
    auto imported = importFile(file_, bytes.value());
    bytes_ = std::move(bytes).value();
    if (!imported) return imported.error();
    groups_ = std::move(imported.value().groups);
    return {};
}

void FollowedLibrary::follow(FileWatcher& watcher, std::function<void()> changed,
                             std::function<void(const std::string&)> report) {
    watch_ = watcher.watch(file_, [this, changed = std::move(changed), report = std::move(report)] {
        // An editor may have taken the file away for a moment.
        if (!files_.exists(file_)) return;
        const SnippetGroups before = groups_;
        const auto read = this->read();
        if (!read) {
            report(read.error().message + "; the library before stays in force");
        } else if (groups_ != before) {
            changed();
        }
    });
}

}  // namespace plume

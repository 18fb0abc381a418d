// A machine with a library, on simulated files and virtual time; several of them can share files, or a store.
#pragma once

#include <chrono>
#include <cmath>
#include <memory>
#include <optional>
#include <stdexcept>
#include <string>
#include <vector>

#include "Foundation/Strings.h"
#include "Foundation/json/JsonNode.h"
#include "library/DataManager.h"
#include "library/KnownSettings.h"
#include "library/LibraryFile.h"
#include "library/MemoryUserDefaults.h"
#include "ports/simulated/SimulatedFileWatcher.h"
#include "ports/simulated/SimulatedFiles.h"
#include "ports/simulated/SimulatedLibraryStorage.h"
#include "ports/simulated/SimulatedRunLoop.h"

namespace plume::test {

// What machines share: the time, and the files. It is 2026-01-31 10:00:00 UTC at first.
struct SharedWorld {
    SimulatedRunLoop loop;
    ScopedDateSource dates{[this] {
        return Date(std::chrono::sys_days(std::chrono::year(2026) / 1 / 31)) + std::chrono::hours(10) +
               std::chrono::microseconds(std::llround(loop.now() * 1e6));
    }};
    SimulatedFiles files;
    SimulatedFileWatcher watcher{files, loop};
};

// Groups as "name: abbreviation=content, …", in order.
inline std::vector<std::string> described(const SnippetGroups& groups) {
    std::vector<std::string> lines;
    for (const auto& group : groups) {
        std::string line = toUtf8(group->name().value_or(u"?")) + ":";
        for (const auto& snippet : group->items()) {
            line += " " + toUtf8(snippet->abbreviation().value_or(u"?")) + "=" +
                    toUtf8(snippet->plainTextContent().value_or(u"?"));
        }
        lines.push_back(line);
    }
    return lines;
}

class Machine {
  public:
    using Disk = std::shared_ptr<SimulatedLibraryStorage::Disk>;

    // Nothing is loaded yet.
    explicit Machine(SharedWorld& world, const std::string& name = "one",
                     Disk disk = std::make_shared<SimulatedLibraryStorage::Disk>())
        : world_(world), name_(name), storage(world.loop, std::move(disk)) {
        settings.registerDefaults(registeredSettings("/" + name + "/Backups"));
        restart();
    }

    // A new process on the same store and settings; what the old one had not written is gone.
    void restart() {
        manager.reset();
        manager = std::make_unique<DataManager>(DataManager::Dependencies{
            .settings = settings,
            .storage = storage,
            .files = world_.files,
            .watcher = world_.watcher,
            .loop = world_.loop,
            .places = places,
            .import = [this](const Files::Path& path) { return import(path); },
            .convertOldSnippet = [](Snippet& snippet) { convert(snippet); },
            .report = [this](const std::string& sentence) { reports.push_back(sentence); },
            .inBackground = {},
            .loadPreferences = [this] { ++preferencesLoaded; },
            .offerBackup = [this](const std::optional<Files::Path>& backup) { offered.push_back(backup); },
            .askFirst = askFirst,
        });
    }
    void load() {
        if (const auto loaded = manager->loadAutoTextData(); !loaded) throw std::runtime_error(loaded.error().message);
    }

    std::shared_ptr<Snippet> add(const std::u16string& abbreviation, const std::u16string& content = u"text") {
        auto& groups = manager->snippetGroups();
        if (groups.empty()) manager->generateSnippetGroupSamples(u"Mine", {});
        auto snippet = std::make_shared<Snippet>(abbreviation, content);
        groups.front()->addItem(snippet);
        manager->notifyDataChanged();
        return snippet;
    }
    void syncWith(const std::string& folder) {
        settings.set("SyncEnabled", true);
        settings.set("SyncDirectory", fromUtf8(folder));
        manager->sync().loadSyncPreferences(false);
    }

    std::vector<std::string> library() const { return described(manager->snippetGroups()); }
    // The library that a backup holds.
    std::vector<std::string> libraryIn(const Files::Path& path) const {
        const auto bytes = world_.files.read(path);
        const auto contents = bytes ? readLibraryArchive(bytes.value(), {}) : Result<LibraryContents>(bytes.error());
        return contents ? described(contents.value().snippetGroups)
                        : std::vector<std::string>{contents.error().message};
    }
    std::vector<std::string> backupNames() const {
        std::vector<std::string> names;
        for (const auto& backup : manager->backups().backups()) names.push_back(backup.path.filename().string());
        return names;
    }

  private:
    SharedWorld& world_;
    const std::string name_;

    static void convert(Snippet& snippet) {
        if (snippet.abbreviation() == u"bad") throw std::runtime_error("cannot be converted");
        snippet.setPlainTextContent(u"converted");
    }
    Result<ImportedLibrary> import(const Files::Path& path) const {
        const auto bytes = world_.files.read(path);
        if (!bytes) return bytes.error();
        if (path.extension() == ".json") {
            auto groups = LibraryFile::read(bytes.value(), path.string());
            if (!groups) return groups.error();
            return ImportedLibrary{std::move(groups).value(), {}};
        }
        auto contents = readLibraryArchive(bytes.value(), &Machine::convert);
        if (!contents) return Error{path.string() + ": " + contents.error().message};
        return ImportedLibrary{std::move(contents.value().snippetGroups), {}};
    }

  public:
    MemoryUserDefaults settings;
    SimulatedLibraryStorage storage;
    DataManager::Places places{.damagedFiles = "/damaged"};  // counts from the next restart() on
    std::function<void(const std::string&)> askFirst;        // the same
    std::unique_ptr<DataManager> manager;
    std::vector<std::string> reports;
    std::vector<std::optional<Files::Path>> offered;
    int preferencesLoaded = 0;
};

}  // namespace plume::test

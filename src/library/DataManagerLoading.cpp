// How the library comes to be at the start.
#include <utility>

#include "Foundation/Uuid.h"
#include "Foundation/archive/PropertyListReader.h"
#include "library/DataManager.h"
#include "library/FileNameTime.h"

namespace plume {

Result<void> DataManager::loadAutoTextData(bool storeWasDamaged) {
    if (auto read = readStored(storeWasDamaged); !read) return read;
    if (auto completed = completeIdentity(); !completed) return completed;
    otherProcesses_ = around_.storage.addObserver([this] { reportOnce(stored_.takeOver(library_)); });
    return {};
}

Result<void> DataManager::readStored(bool storeWasDamaged) {
    auto loaded = stored_.load();
    if (!loaded) return loaded.error();
    library_ = std::move(loaded.value().contents);
    stored_.record(library_);
    if (!library_.dateInstalled) library_.dateInstalled = currentDate();
    if (loaded.value().damagedArchive) {
        keepDamagedArchive(*loaded.value().damagedArchive, loaded.value().damage);
    } else if (!loaded.value().damage.empty()) {
        around_.report("The last changes of the library cannot be read: " + loaded.value().damage);
    } else if (storeWasDamaged) {
        offerBackup();
    } else if (library_.snippetGroups.empty() && !migrateSandboxedLibrary()) {
        return makeFirstLibrary();
    }
    return {};
}

// The bytes stay for whoever can read them; the backups have what was there before.
void DataManager::keepDamagedArchive(const std::string& bytes, const std::string& damage) {
    const Path file = around_.places.damagedFiles / ("Damaged Library " + fileNameTime(currentDate()) + ".plume");
    const auto made = around_.files.createFolder(file.parent_path());
    const auto kept = made ? around_.files.write(file, bytes) : made;
    around_.report("The library cannot be read: " + damage + ". " +
                   (kept ? "It is kept in " + file.string() + "." : kept.error().message));
    offerBackup();
}

void DataManager::offerBackup() {
    if (around_.offerBackup) around_.offerBackup(backups_.newestBackup());
}

bool DataManager::migrateSandboxedLibrary() {
    const Path& file = around_.places.sandboxedPreferences;
    if (file.empty() || !around_.files.exists(file)) return false;
    const auto bytes = around_.files.read(file);
    const auto preferences = bytes ? readPropertyList(bytes.value()) : Result<PropertyList>(bytes.error());
    const auto* data = preferences ? preferences.value().find<ArchivedData>("Data") : nullptr;
    if (!data) return true;
    auto contents = readLibraryArchive(data->bytes, around_.convertOldSnippet);
    if (!contents) {
        around_.report(file.string() + ": " + contents.error().message);
        return true;
    }
    const auto installed = library_.dateInstalled;
    library_ = std::move(contents).value();
    if (!library_.dateInstalled) library_.dateInstalled = installed;
    return true;
}

Result<void> DataManager::makeFirstLibrary() {
    emptyData_ = true;
    const Path& own = around_.places.ownEarlierLibrary;
    if (!own.empty() && around_.files.exists(own)) {
        // With a mistake in it, nothing else takes its place.
        const auto imported = importDataFromFile(own);
        if (!imported) return imported.error();
    } else {
        generateSnippetSamples();
    }
    importAtFirstStart(around_.places.textExpanderSettings);
    importAtFirstStart(around_.places.systemSubstitutions);
    return {};
}

void DataManager::generateSnippetSamples() {
    importAtFirstStart(around_.places.sampleLibrary);
}

void DataManager::importAtFirstStart(const Path& path) {
    if (path.empty() || !around_.files.exists(path)) return;
    const auto imported = around_.import(path);
    if (!imported) return around_.report(imported.error().message);
    append(imported.value());
    for (const std::string& remark : imported.value().remarks) around_.report(path.string() + ": " + remark);
}

Result<void> DataManager::completeIdentity() {
    const auto fresh = [](std::optional<std::u16string>& identity) {
        if (identity) return false;
        identity = Uuid::random().toString();
        return true;
    };
    const bool madeLibrary = fresh(library_.uuidString);
    const bool madeVersion = fresh(library_.versionUUIDString);
    if (library_.dateCreated && !madeLibrary && !madeVersion) return {};
    if (!library_.dateCreated) library_.dateCreated = currentDate();
    return saveData();
}

}  // namespace plume

#include "library/LibrarySync.h"

#include <utility>

#include "Foundation/Strings.h"
#include "library/LibraryPreferences.h"

namespace plume {

namespace {

// Seconds.
constexpr double UploadDelay = 10;
constexpr double DelayOfRepeatedUpload = 60;
constexpr double DownloadDelay = 1;
constexpr double MonitorDelayAfterChange = 2;
constexpr double MonitorDelayAfterUpload = 1;

constexpr const char* SyncEnabled = "SyncEnabled";
constexpr std::int64_t ChosenFolder = 0;
// The version that both this machine and the file have had last.
constexpr const char* SyncedVersion = "SyncedVersionUUID";

}  // namespace

LibrarySync::LibrarySync(Dependencies dependencies) : around_(std::move(dependencies)) {}

std::optional<Files::Path> LibrarySync::syncDirectory() const {
    if (!around_.settings.boolForKey(SyncEnabled)) return std::nullopt;
    if (around_.settings.integerForKey("SyncDirectoryType") != ChosenFolder) return std::nullopt;
    const Files::Path folder = toUtf8(around_.settings.stringForKey("SyncDirectory").value_or(u""));
    if (!folder.is_absolute() || !around_.files.isFolder(folder)) return std::nullopt;
    return folder;
}

void LibrarySync::loadSyncPreferences(bool interactive) {
    const auto folder = syncDirectory();
    if (folder && folder == directory_ && watching_) return;
    stopSync();
    watching_ = false;
    directory_ = folder;
    lastReport_.clear();
    if (directory_) {
        startSync(interactive);
    } else {
        upload_.cancel();
        download_.cancel();
        monitor_.cancel();
        waitForFolder();
    }
}

// A folder on a disk that is not there yet: its coming starts the synchronisation.
void LibrarySync::waitForFolder() {
    if (!around_.settings.boolForKey(SyncEnabled)) return;
    if (around_.settings.integerForKey("SyncDirectoryType") != ChosenFolder) return;
    const Files::Path folder = toUtf8(around_.settings.stringForKey("SyncDirectory").value_or(u""));
    if (!folder.is_absolute()) return;
    reportOnce("The sync folder " + folder.string() + " is not there; the library is sent when it comes.");
    watch_ = around_.watcher.watch(folder / "Plume" / "Data.plume", [this] {
        if (syncDirectory()) loadSyncPreferences(false);
    });
}

void LibrarySync::startSync(bool interactive) {
    if (around_.files.exists(syncDataFile())) {
        const auto file = readFile();
        const bool isLater = file && file->contents.dateCreated && around_.library().dateCreated &&
                             *around_.library().dateCreated > *file->contents.dateCreated;
        if (isLater && interactive && around_.askFirst) {
            previousVersionUUIDStrings_.clear();
            around_.askFirst(directory_->filename().string());
            return;
        }
        if (file) compareWithFile(isLater);
    } else {
        if (!makeFolder()) return;
        send(false);
    }
    monitorSyncDataFile();
}

void LibrarySync::compareWithFile(bool localIsLater) {
    if (localIsLater) {
        send(false);
    } else {
        syncDownload();
    }
}

bool LibrarySync::makeFolder() {
    const Files::Path folder = syncDataFile().parent_path();
    if (around_.files.isFolder(folder)) return true;
    if (around_.files.exists(folder)) {
        if (const auto gone = around_.files.moveToTrash(folder); !gone) {
            reportOnce("Could not delete file " + folder.string());
            return false;
        }
    }
    if (const auto made = around_.files.createFolder(folder); !made) {
        reportOnce("Could not create directory " + folder.string());
        return false;
    }
    return true;
}

void LibrarySync::initalSyncSheetDidEnd(int returnCode) {
    if (returnCode == Cancelled) {
        if (const auto kept = around_.settings.setObject(SyncEnabled, false); !kept) reportOnce(kept.error().message);
        return;
    }
    if (!directory_) return;
    if (returnCode == TakeFoldersLibrary) {
        syncDownload();
    } else {
        send(false);
    }
    monitorSyncDataFile();
}

void LibrarySync::libraryChanged(const std::u16string& previousVersion) {
    previousVersionUUIDStrings_.insert(previousVersion);
    if (!directory_) return;
    download_.cancel();
    monitor_.cancel();
    upload_ = around_.loop.performAfterDelay(UploadDelay, [this] { syncUpload(); });
}

void LibrarySync::syncUpload() {
    stopSync();
    watching_ = false;
    // The folder has gone: nothing is made where a disk was mounted, say.
    if (!syncDirectory()) return loadSyncPreferences(false);
    const bool sent = makeFolder() && send(around_.settings.boolForKey("SyncPreferences"));
    if (!sent && !fileIsUnreadable_) {
        upload_ = around_.loop.performAfterDelay(DelayOfRepeatedUpload, [this] { syncUpload(); });
    }
    monitor_ = around_.loop.performAfterDelay(MonitorDelayAfterUpload, [this] { monitorSyncDataFile(); });
}

// Looks again and again at what another machine may have written meanwhile.
bool LibrarySync::send(bool includingPreferences) {
    constexpr int MostAttempts = 8;
    const std::string archive = around_.archive(includingPreferences);
    for (int attempt = 0; attempt < MostAttempts; ++attempt) {
        const auto known = keepUnknownVersion();
        if (!known) return false;
        const auto written = around_.files.replace(syncDataFile(), known->bytes, archive);
        if (!written) {
            reportOnce("The library was not sent to the sync folder: " + written.error().message);
            return false;
        }
        if (written.value()) {
            lastReport_.clear();
            return true;
        }
    }
    reportOnce("The library was not sent to the sync folder: another machine writes it all the time");
    return false;
}

// Another machine's version that this one has not taken over goes into the backups before it is written over. Nothing
// when the file must not be written over now.
std::optional<LibrarySync::WrittenOver> LibrarySync::keepUnknownVersion() {
    if (!around_.files.exists(syncDataFile())) return WrittenOver{};
    auto file = readFile();
    if (!file) return std::nullopt;
    if (!isKnown(file->contents)) {
        const auto kept = around_.backups.backup(file->bytes);
        if (!kept) {
            reportOnce("The library is not sent, because the other one in the sync folder cannot be kept: " +
                       kept.error().message);
            return std::nullopt;
        }
        around_.report("Another machine had changed the library meanwhile; its version is kept in " +
                       kept.value().string() + ".");
    }
    return WrittenOver{std::move(file->bytes)};
}

std::optional<LibrarySync::SyncFile> LibrarySync::readFile() {
    fileIsUnreadable_ = false;
    if (!around_.files.exists(syncDataFile())) return std::nullopt;
    auto bytes = around_.files.read(syncDataFile());
    // Downloads are taken as they are: other machines convert what is old.
    auto contents = bytes ? readLibraryArchive(bytes.value(), {}) : Result<LibraryContents>(bytes.error());
    if (!contents) {
        fileIsUnreadable_ = true;
        reportOnce("The library in the sync folder cannot be read and is left alone: " + syncDataFile().string() +
                   ": " + contents.error().message);
        return std::nullopt;
    }
    return SyncFile{std::move(bytes).value(), std::move(contents).value()};
}

bool LibrarySync::isKnown(const LibraryContents& contents) const {
    const auto& version = contents.versionUUIDString;
    return version &&
           (version == around_.library().versionUUIDString || previousVersionUUIDStrings_.contains(*version) ||
            version == around_.settings.stringForKey(SyncedVersion));
}

void LibrarySync::monitorSyncDataFile() {
    if (watching_ || !directory_) return;
    if (!syncDirectory()) return loadSyncPreferences(false);
    watch_ = around_.watcher.watch(syncDataFile(), [this] { syncDispatchSourceEventHandler(); });
    watching_ = true;
    // While nobody watched, the file may have become another.
    syncDownload();
}

void LibrarySync::syncDispatchSourceEventHandler() {
    if (!watching_) return;
    stopSync();
    watching_ = false;
    download_ = around_.loop.performAfterDelay(DownloadDelay, [this] { syncDownload(); });
    monitor_ = around_.loop.performAfterDelay(MonitorDelayAfterChange, [this] { monitorSyncDataFile(); });
}

void LibrarySync::syncDownload() {
    if (!directory_) return;
    const auto file = readFile();
    if (!file) return;
    const auto& version = file->contents.versionUUIDString;
    if (version && version == around_.library().versionUUIDString) markSynced();
    if (version && previousVersionUUIDStrings_.contains(*version)) return;
    previousVersionUUIDStrings_.clear();
    if (!version || version == around_.library().versionUUIDString) return;
    takeOver(*file);
}

void LibrarySync::takeOver(const SyncFile& file) {
    if (hasUnsentChanges()) {
        const auto kept = around_.backups.backup();
        if (!kept) {
            reportOnce("The library in the sync folder is not taken over, because this machine's cannot be kept: " +
                       kept.error().message);
            return;
        }
        around_.report(
            "The library was replaced by another machine's. What it held, with changes that were not sent "
            "yet, is in " +
            kept.value().string() + ".");
    }
    upload_.cancel();
    around_.replace(file.contents);
    markSynced();
    takeOverPreferences(file.contents);
}

// Only those that travel with a library: nobody else is to change other settings of this machine.
void LibrarySync::takeOverPreferences(const LibraryContents& contents) {
    if (!around_.settings.boolForKey("SyncPreferences") || !contents.preferences) return;
    updatingPreferences_ = true;
    for (const char* key : PreferencesOfLibrary) {
        const auto found = contents.preferences->find(std::string_view(key));
        if (found == contents.preferences->end()) continue;
        if (const auto kept = around_.settings.setObject(key, found->second); !kept) reportOnce(kept.error().message);
    }
    updatingPreferences_ = false;
    if (around_.loadPreferences) around_.loadPreferences();
}

void LibrarySync::markSynced() {
    const auto& version = around_.library().versionUUIDString;
    if (!version || version == around_.settings.stringForKey(SyncedVersion)) return;
    if (const auto kept = around_.settings.setObject(SyncedVersion, *version); !kept) reportOnce(kept.error().message);
}

bool LibrarySync::hasUnsentChanges() const {
    return around_.library().versionUUIDString != around_.settings.stringForKey(SyncedVersion);
}

void LibrarySync::reportOnce(const std::string& sentence) {
    if (sentence != lastReport_) around_.report(sentence);
    lastReport_ = sentence;
}

}  // namespace plume

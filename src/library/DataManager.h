// Owns the library for the life of the process: loads it, keeps what changes, exports, imports, restores, and tells
// when it becomes another as a whole.
//
// Belongs to the main thread. What is changed in the records is kept only after notifyDataChanged(): within half a
// second in the journal of the store, five seconds after the last change as a whole archive. Nothing here throws; what
// goes wrong is told by the results and, where nobody waits for one, by Dependencies::report.
#pragma once

#include <filesystem>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "Foundation/Result.h"
#include "Foundation/ZDEvent.h"
#include "library/ImportedLibrary.h"
#include "library/LibraryArchive.h"
#include "library/LibraryBackups.h"
#include "library/LibrarySync.h"
#include "library/StoredLibrary.h"
#include "platform/FileWatcher.h"
#include "platform/Files.h"
#include "platform/LibraryStorage.h"
#include "platform/RunLoop.h"
#include "platform/UserDefaults.h"

namespace plume {

// The library as a whole becomes another, or has become so.
struct LibraryEvent {};

class DataManager {
  public:
    using Path = Files::Path;

    // Where things lie that are looked for at the first start, and where damaged ones are put. An empty path: nowhere.
    struct Places {
        Path sampleLibrary = {};
        Path ownEarlierLibrary = {};     // a readable library, which then stands in place of the sample
        Path sandboxedPreferences = {};  // a property list with a library under "Data"
        Path textExpanderSettings = {};
        Path systemSubstitutions = {};
        Path damagedFiles = {};  // a folder
    };

    struct Dependencies {
        WritableUserDefaults& settings;
        LibraryStorage& storage;
        Files& files;
        FileWatcher& watcher;
        RunLoop& loop;
        Places places;
        std::function<Result<ImportedLibrary>(const Path&)> import;
        ConvertOldSnippet convertOldSnippet;
        std::function<void(const std::string& sentence)> report;
        // Does the work on another thread, then calls back on the main loop; one at a time. Empty: at once, here.
        std::function<void(std::function<void()> work, std::function<void()> done)> inBackground = {};
        // Gives changed settings to whom they concern.
        std::function<void()> loadPreferences = {};
        // The stored library was damaged and is kept aside; this backup is the newest one, if there is any.
        std::function<void(const std::optional<Path>& newestBackup)> offerBackup = {};
        // See LibrarySync.
        std::function<void(const std::string& folderName)> askFirst = {};
    };

    // All that is referred to outlives it. Nothing happens before loadAutoTextData().
    explicit DataManager(Dependencies dependencies);
    DataManager(const DataManager&) = delete;
    DataManager& operator=(const DataManager&) = delete;

    // Reads the library from the store, or makes the first one. `storeWasDamaged`: the store itself was set aside just
    // now, so that an empty one is no first start. An error when the store cannot be read: there is no library then.
    Result<void> loadAutoTextData(bool storeWasDamaged = false);
    // The library was made at this start.
    bool emptyData() const { return emptyData_; }

    SnippetGroups& snippetGroups() { return library_.snippetGroups; }
    const SnippetGroups& snippetGroups() const { return library_.snippetGroups; }
    const LibraryContents& library() const { return library_; }
    // Null when no group has exactly this name.
    std::shared_ptr<SnippetGroup> groupWithName(std::u16string_view name) const;

    // To be called after every change of the library.
    void notifyDataChanged();
    // Puts what has changed into the store's journal now.
    Result<void> writeJournal();
    // Writes the whole library into the store now. While a save is on its way in the background, the journal alone is
    // written, and the save follows.
    Result<void> saveData();
    // At the end: saves if anything was changed since the last time.
    Result<void> saveRest();

    std::string archivedDataIncludingPreferences(bool includingPreferences) const;
    // The settings that travel with a library.
    PropertyList::Dictionary preferences() const;
    std::string dataFromSnippetGroup(const std::shared_ptr<SnippetGroup>& group) const;
    // By the ending of the path: "plume" is an archive, "csv" a list, "json" the readable form; others are an error.
    Result<void> backupToFile(const Path& path, bool includePrefs = false);
    Result<void> saveGroup(const std::shared_ptr<SnippetGroup>& group, const Path& toFile);

    // Groups are appended to the library; the list of the system's substitutions takes the place of the former one.
    // Returns what could not be carried over whole. After an error nothing was imported. The caller tells of the change
    // by notifyDataChanged().
    Result<std::vector<std::string>> importDataFromFile(const Path& path);
    // The same for what was read already.
    void append(const ImportedLibrary& imported);
    void generateSnippetSamples();
    // Pairs of abbreviation and content; one without a content is left out.
    std::shared_ptr<SnippetGroup> generateSnippetGroupSamples(const std::u16string& name,
                                                              const std::vector<std::u16string>& snippetSamples);
    void convertDataToNewFormat();

    // The library of the file in place of this one. After an error nothing has changed. The caller calls
    // notifyDataChanged().
    Result<std::vector<std::string>> restoreFromFile(const Path& path);
    // The same with a backup of the library of now before it, whose path is returned, and with notifyDataChanged().
    Result<Path> restoreFile(const Path& path);
    // These groups in place of the library's, as restoreFile() does.
    Result<Path> replaceGroups(const SnippetGroups& groups);

    LibraryBackups& backups() { return backups_; }
    LibrarySync& sync() { return sync_; }

    // The library has changed, in parts or as a whole.
    ZDEvent<LibraryEvent> didChangeDataEvent;
    ZDEvent<LibraryEvent> willClearDataEvent;
    ZDEvent<LibraryEvent> didImportDataEvent;
    ZDEvent<LibraryEvent> willSyncDataEvent;
    ZDEvent<LibraryEvent> didSyncDataEvent;

  private:
    Result<void> readStored(bool storeWasDamaged);
    void keepDamagedArchive(const std::string& bytes, const std::string& damage);
    void offerBackup();
    bool migrateSandboxedLibrary();
    Result<void> makeFirstLibrary();
    void importAtFirstStart(const Path& path);
    Result<void> completeIdentity();

    void setGroups(const SnippetGroups& groups);
    void takeDownload(LibraryContents file);
    void replaceLibrary(LibraryContents contents);
    void stampVersion();
    void scheduleSave(double delay);
    void saveInBackground();
    void saveEnded(const LibraryStorage::Written& written);
    void reportOnce(const Result<void>& done);
    static void raise(ZDEvent<LibraryEvent>& event);

    const Dependencies around_;
    LibraryContents library_;
    StoredLibrary stored_;
    LibraryBackups backups_;
    LibrarySync sync_;
    Subscription otherProcesses_;
    Timer journalTimer_;
    Timer saveTimer_;
    bool emptyData_ = false;
    bool saving_ = false;
    bool saveAgain_ = false;
    std::string lastReport_;
};

}  // namespace plume

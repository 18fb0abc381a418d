// Keeps the library in step with other machines through one file in a folder that they share.
//
// The whole library moves in one direction at a time; which side wins is told by the identities of the versions and, at
// the start, by dates. What would get lost by that is put into the backups first: changes of this machine that a
// download replaces, and another machine's version that this one never took over and is about to write over.
// Owned by the library's owner, on its thread.
#pragma once

#include <filesystem>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_set>

#include "library/LibraryArchive.h"
#include "library/LibraryBackups.h"
#include "platform/FileWatcher.h"
#include "platform/Files.h"
#include "platform/RunLoop.h"
#include "platform/UserDefaults.h"

namespace plume {

class LibrarySync {
  public:
    // Whether it says if, and in which folder, the library is kept in step.
    static bool isFolderSetting(std::string_view key) {
        return key == "SyncEnabled" || key == "SyncDirectory" || key == "SyncDirectoryType";
    }

    struct Dependencies {
        WritableUserDefaults& settings;
        Files& files;
        FileWatcher& watcher;
        RunLoop& loop;
        LibraryBackups& backups;
        std::function<const LibraryContents&()> library;
        std::function<std::string(bool includingPreferences)> archive;
        // Puts the file's groups and version in place of the library's, and saves.
        std::function<void(LibraryContents)> replace;
        std::function<void()> loadPreferences;
        // Shows the question whether the folder's library or this machine's is to be kept, for the folder of this name;
        // its answer goes to initalSyncSheetDidEnd(). Empty: there is no window, and the folder's file is written over.
        std::function<void(const std::string& folderName)> askFirst;
        std::function<void(const std::string& sentence)> report;
    };

    // What initalSyncSheetDidEnd() is told.
    enum ReturnCode { Cancelled = 0, TakeFoldersLibrary = 1, ReplaceFoldersLibrary = 2 };

    explicit LibrarySync(Dependencies dependencies);

    // Where the settings lead to; nothing when synchronisation is off, and while the folder does not exist.
    std::optional<Files::Path> syncDirectory() const;
    // Applies the settings: starts, stops, or goes on when nothing has changed. `interactive`: the user is asked which
    // library is to be kept when this machine's is the later one.
    void loadSyncPreferences(bool interactive);
    void initalSyncSheetDidEnd(int returnCode);
    // The library has got a new version in place of this one: it is uploaded 10 seconds later.
    void libraryChanged(const std::u16string& previousVersion);
    // Preferences that came with a download are being written; whoever hears of changed settings leaves them alone
    // then.
    bool updatingPreferences() const { return updatingPreferences_; }

  private:
    struct SyncFile {
        std::string bytes;
        LibraryContents contents;
    };

    Files::Path syncDataFile() const { return *directory_ / "Plume" / "Data.plume"; }
    void startSync(bool interactive);
    bool makeFolder();
    void compareWithFile(bool localIsLater);
    void syncUpload();
    void syncDownload();
    void takeOver(const SyncFile& file);
    void takeOverPreferences(const LibraryContents& contents);
    void monitorSyncDataFile();
    void waitForFolder();
    void stopSync() { watch_.end(); }
    void syncDispatchSourceEventHandler();

    // What stands in the way of this machine's library and may be written over: nothing, or these bytes.
    struct WrittenOver {
        std::optional<std::string> bytes;
    };

    bool send(bool includingPreferences);
    std::optional<WrittenOver> keepUnknownVersion();
    // The file, or nothing when there is none or it cannot be read, which is reported.
    std::optional<SyncFile> readFile();
    bool isKnown(const LibraryContents& contents) const;
    void markSynced();
    bool hasUnsentChanges() const;
    void reportOnce(const std::string& sentence);

    const Dependencies around_;
    std::optional<Files::Path> directory_;  // in use
    std::unordered_set<std::u16string> previousVersionUUIDStrings_;
    Subscription watch_;
    bool watching_ = false;
    Timer upload_;
    Timer download_;
    Timer monitor_;
    bool fileIsUnreadable_ = false;
    bool updatingPreferences_ = false;
    std::string lastReport_;
};

}  // namespace plume

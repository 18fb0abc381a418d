// Backups of the library: made by the clock, kept in a folder, thrown away when there are too many.
//
// Owned by the library's owner, on its thread.
#pragma once

#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "Foundation/Date.h"
#include "Foundation/Result.h"
#include "platform/Files.h"
#include "platform/RunLoop.h"
#include "platform/UserDefaults.h"

namespace plume {

class LibraryBackups {
  public:
    struct Dependencies {
        WritableUserDefaults& settings;
        Files& files;
        RunLoop& loop;
        std::function<std::string()> archive;  // of the library now, without preferences
        std::function<bool()> isEmpty;         // there is nothing to keep: the clock makes no backup of it
        std::function<void(const std::string& sentence)> report;
    };

    struct Backup {
        Files::Path path;
        std::optional<Date> modified;
    };

    explicit LibraryBackups(Dependencies dependencies);

    // Checks at once and every 60 seconds from now on.
    void startAutoBackupTimer();
    // Checks, and again every hour.
    void startAutoBackup();
    void stopAutoBackup() {}
    // Makes a backup when the last one is as old as "AutoBackupInterval" says.
    void autoBackup();

    // Writes a backup of now, then throws away those that are too many; returns where it is.
    Result<Files::Path> backup();
    // The same with bytes of another library archive.
    Result<Files::Path> backup(const std::string& archive);
    // Erases the oldest of Plume's own backups, and puts other .plume files into the trash, until as many are left as
    // "BackupQuantity" says.
    void deleteOldBackups();

    Files::Path directory() const;
    // All .plume files in the folder, in the order in which the system tells them; none when it cannot be listed.
    std::vector<Backup> backups() const;
    // Of Plume's own ones.
    std::optional<Files::Path> newestBackup() const;

    // "Plume Backup 2026-01-31 10-00-00.plume": the local time in such a name; nothing for other names.
    static std::optional<std::string> timeInName(const std::string& fileName);

  private:
    Files::Path unusedPath() const;

    const Dependencies around_;
    Timer timer_;
    Timer hourlyTimer_;
};

}  // namespace plume

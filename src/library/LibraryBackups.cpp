#include "library/LibraryBackups.h"

#include <algorithm>
#include <cctype>
#include <chrono>
#include <string_view>
#include <utility>

#include "Foundation/Strings.h"
#include "library/FileNameTime.h"

namespace plume {

namespace {

using namespace std::chrono_literals;

constexpr double TimerInterval = 60;  // seconds
constexpr double HourlyInterval = 3600;
constexpr const char* LastBackupTime = "LastBackupTime";
constexpr std::string_view Prefix = "Plume Backup ";
constexpr std::string_view TimePattern = "dddd-dd-dd dd-dd-dd";  // d stands for a digit
constexpr std::string_view Suffix = ".plume";

std::string fileNameFor(Date date) {
    return std::string(Prefix) + fileNameTime(date) + std::string(Suffix);
}

// The time between two backups; nothing when there are to be none.
std::optional<std::chrono::seconds> period(std::int64_t interval) {
    switch (interval) {
        case 1:
            return 1h;
        case 2:
            return 24h;
        case 3:
            return 7 * 24h;
        case 4:
            return 30 * 24h;
        default:
            return std::nullopt;
    }
}

bool byAge(const LibraryBackups::Backup& a, const LibraryBackups::Backup& b) {
    return a.modified < b.modified;
}

}  // namespace

LibraryBackups::LibraryBackups(Dependencies dependencies) : around_(std::move(dependencies)) {}

void LibraryBackups::startAutoBackupTimer() {
    autoBackup();
    timer_ = around_.loop.performAfterDelay(TimerInterval, [this] { startAutoBackupTimer(); });
}

void LibraryBackups::startAutoBackup() {
    autoBackup();
    hourlyTimer_ = around_.loop.performAfterDelay(HourlyInterval, [this] { startAutoBackup(); });
}

void LibraryBackups::autoBackup() {
    const Date now = currentDate();
    const auto last = around_.settings.dateForKey(LastBackupTime);
    const auto keepTime = [&] {
        if (const auto kept = around_.settings.setObject(LastBackupTime, now); !kept) {
            around_.report(kept.error().message);
        }
    };
    // A time to come is one of a clock that was wrong.
    if (!last || *last > now) return keepTime();
    const auto wait = period(around_.settings.integerForKey("AutoBackupInterval"));
    if (!wait || now - *last < *wait) return;
    keepTime();
    // After damage, say: full backups must not make room for empty ones.
    if (around_.isEmpty()) return;
    if (const auto written = backup(); !written) around_.report("No backup was made: " + written.error().message);
}

Result<Files::Path> LibraryBackups::backup() {
    return backup(around_.archive());
}

Result<Files::Path> LibraryBackups::backup(const std::string& archive) {
    if (const auto made = around_.files.createFolder(directory()); !made) return made.error();
    const Files::Path path = unusedPath();
    if (const auto written = around_.files.write(path, archive); !written) return written.error();
    deleteOldBackups();
    return path;
}

// Two backups of one second do not take each other's place: the second one gets the next second's name.
Files::Path LibraryBackups::unusedPath() const {
    Date date = currentDate();
    Files::Path path = directory() / fileNameFor(date);
    while (around_.files.exists(path)) {
        date += 1s;
        path = directory() / fileNameFor(date);
    }
    return path;
}

void LibraryBackups::deleteOldBackups() {
    const std::int64_t quantity = around_.settings.integerForKey("BackupQuantity");
    if (quantity < 1) return;
    std::vector<Backup> all = backups();
    if (all.size() <= static_cast<std::size_t>(quantity)) return;
    const std::size_t tooMany = all.size() - static_cast<std::size_t>(quantity);
    // Behind one whose date is not known, nothing is known to be old.
    const auto unknown = std::find_if(all.begin(), all.end(), [](const Backup& each) { return !each.modified; });
    all.erase(unknown, all.end());
    std::stable_sort(all.begin(), all.end(), byAge);
    if (all.size() > tooMany) all.resize(tooMany);
    for (const Backup& old : all) {
        const bool own = timeInName(old.path.filename().string()).has_value();
        const auto gone = own ? around_.files.remove(old.path) : around_.files.moveToTrash(old.path);
        if (!gone) around_.report("An old backup stays: " + gone.error().message);
    }
}

Files::Path LibraryBackups::directory() const {
    return toUtf8(around_.settings.stringForKey("BackupDirectory").value_or(u""));
}

std::vector<LibraryBackups::Backup> LibraryBackups::backups() const {
    std::vector<Backup> result;
    const auto entries = around_.files.list(directory());
    if (!entries) return result;
    for (const Files::Entry& entry : entries.value()) {
        if (!entry.isFolder && entry.name.ends_with(Suffix))
            result.push_back({directory() / entry.name, entry.modified});
    }
    return result;
}

std::optional<Files::Path> LibraryBackups::newestBackup() const {
    std::optional<Files::Path> newest;
    for (const Backup& backup : backups()) {
        const bool own = timeInName(backup.path.filename().string()).has_value();
        if (own && (!newest || newest->filename() < backup.path.filename())) newest = backup.path;
    }
    return newest;
}

std::optional<std::string> LibraryBackups::timeInName(const std::string& fileName) {
    if (fileName.size() != Prefix.size() + TimePattern.size() + Suffix.size()) return std::nullopt;
    if (!fileName.starts_with(Prefix) || !fileName.ends_with(Suffix)) return std::nullopt;
    std::string time = fileName.substr(Prefix.size(), TimePattern.size());
    const bool matches = std::equal(time.begin(), time.end(), TimePattern.begin(), [](char c, char pattern) {
        return pattern == 'd' ? std::isdigit(static_cast<unsigned char>(c)) != 0 : c == pattern;
    });
    return matches ? std::optional(std::move(time)) : std::nullopt;
}

}  // namespace plume

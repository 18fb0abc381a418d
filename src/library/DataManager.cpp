#include "library/DataManager.h"

#include <algorithm>
#include <utility>

#include "Foundation/Uuid.h"
#include "library/LibraryExport.h"
#include "library/LibraryFile.h"
#include "library/LibraryMerge.h"
#include "library/LibraryPreferences.h"

namespace plume {

namespace {

// Seconds.
constexpr double JournalDelay = 0.4;
constexpr double SaveDelay = 5;
constexpr double DelayOfRepeatedSave = 60;

// Who edits without a pause keeps the save from coming: at this length of the journal it is made all the same.
constexpr std::size_t LongestJournal = std::size_t{4} * 1024 * 1024;

constexpr const char16_t* SystemSubstitutionsGroup = u"System's Symbol And Text Substitutions";

}  // namespace

DataManager::DataManager(Dependencies dependencies)
    : around_(std::move(dependencies)),
      stored_(around_.storage, around_.convertOldSnippet,
              [this](LibraryContents contents) { replaceLibrary(std::move(contents)); }),
      backups_({around_.settings, around_.files, around_.loop,
                [this] { return archivedDataIncludingPreferences(false); },
                [this] { return library_.snippetGroups.empty(); }, around_.report}),
      sync_({around_.settings, around_.files, around_.watcher, around_.loop, backups_,
             [this]() -> const LibraryContents& { return library_; },
             [this](bool preferences) { return archivedDataIncludingPreferences(preferences); },
             [this](LibraryContents file) { takeDownload(std::move(file)); }, around_.loadPreferences, around_.askFirst,
             around_.report}) {}

std::shared_ptr<SnippetGroup> DataManager::groupWithName(std::u16string_view name) const {
    const auto& groups = library_.snippetGroups;
    const auto found =
        std::find_if(groups.begin(), groups.end(), [&](const auto& group) { return group->name() == name; });
    return found == groups.end() ? nullptr : *found;
}

// ---- Changes ----

void DataManager::notifyDataChanged() {
    stampVersion();
    // Not put off by further changes: each is in the journal in time.
    if (!journalTimer_) {
        journalTimer_ = around_.loop.performAfterDelay(JournalDelay, [this] {
            journalTimer_.cancel();
            reportOnce(writeJournal());
        });
    }
    scheduleSave(SaveDelay);
    raise(didChangeDataEvent);
}

void DataManager::stampVersion() {
    const auto previous = library_.versionUUIDString;
    library_.dateCreated = currentDate();
    library_.versionUUIDString = Uuid::random().toString();
    if (previous) sync_.libraryChanged(*previous);
}

void DataManager::scheduleSave(double delay) {
    saveTimer_ = around_.loop.performAfterDelay(delay, [this] { saveInBackground(); });
}

Result<void> DataManager::writeJournal() {
    auto written = stored_.recordChanges(library_);
    if (written && stored_.journalLength() > LongestJournal) saveInBackground();
    return written;
}

Result<void> DataManager::saveData() {
    constexpr int MostAttempts = 8;
    for (int attempt = 0; attempt < MostAttempts; ++attempt) {
        if (auto recorded = stored_.recordChanges(library_); !recorded) return recorded;
        if (saving_) {
            saveAgain_ = true;
            return {};
        }
        const auto written = stored_.beginSave().run();
        if (!written) return written.error();
        stored_.endSave(written);
        if (!std::holds_alternative<LibraryStorage::Outdated>(written.value())) {
            saveTimer_.cancel();
            return {};
        }
        if (auto merged = stored_.takeOver(library_); !merged) return merged;
    }
    return Error{"the store is written by another process all the time"};
}

Result<void> DataManager::saveRest() {
    // Nobody waits for what is under way any more.
    saving_ = false;
    if (auto recorded = stored_.recordChanges(library_); !recorded) return recorded;
    return stored_.journalLength() > 0 ? saveData() : Result<void>();
}

void DataManager::saveInBackground() {
    saveTimer_.cancel();
    if (saving_) {
        saveAgain_ = true;
        return;
    }
    if (const auto recorded = stored_.recordChanges(library_); !recorded) {
        reportOnce(recorded);
        return scheduleSave(DelayOfRepeatedSave);
    }
    struct Work {
        explicit Work(StoredLibrary::Save begun) : save(std::move(begun)) {}
        StoredLibrary::Save save;
        LibraryStorage::Written written = LibraryStorage::Outcome(LibraryStorage::Outdated());
    };
    const auto work = std::make_shared<Work>(stored_.beginSave());
    const auto save = [work] { work->written = work->save.run(); };
    const auto ended = [this, work] { saveEnded(work->written); };
    saving_ = true;
    if (around_.inBackground) return around_.inBackground(save, ended);
    save();
    ended();
}

void DataManager::saveEnded(const LibraryStorage::Written& written) {
    saving_ = false;
    stored_.endSave(written);
    if (!written) {
        reportOnce(written.error());
        scheduleSave(DelayOfRepeatedSave);
    } else if (std::holds_alternative<LibraryStorage::Outdated>(written.value())) {
        reportOnce(stored_.takeOver(library_));
        scheduleSave(SaveDelay);
    } else if (std::exchange(saveAgain_, false)) {
        scheduleSave(SaveDelay);
    }
}

void DataManager::reportOnce(const Result<void>& done) {
    const std::string sentence = done ? std::string() : "The library was not saved: " + done.error().message;
    if (!sentence.empty() && sentence != lastReport_) around_.report(sentence);
    lastReport_ = sentence;
}

// Another process's library, or one with what was done here on top of it.
void DataManager::replaceLibrary(LibraryContents contents) {
    const auto previous = library_.versionUUIDString;
    raise(willSyncDataEvent);
    library_ = std::move(contents);
    raise(didSyncDataEvent);
    if (previous && previous != library_.versionUUIDString) sync_.libraryChanged(*previous);
}

void DataManager::takeDownload(LibraryContents file) {
    raise(willSyncDataEvent);
    keepRecords(library_, file);
    setGroups(file.snippetGroups);
    library_.versionUUIDString = file.versionUUIDString;
    raise(didSyncDataEvent);
    reportOnce(saveData());
}

void DataManager::raise(ZDEvent<LibraryEvent>& event) {
    LibraryEvent argument;
    event.raise(argument);
}

// ---- Files ----

std::string DataManager::archivedDataIncludingPreferences(bool includingPreferences) const {
    LibraryContents contents = library_;
    if (includingPreferences) contents.preferences = preferences();
    return libraryArchive(contents);
}

PropertyList::Dictionary DataManager::preferences() const {
    return preferencesOfLibrary(around_.settings);
}

std::string DataManager::dataFromSnippetGroup(const std::shared_ptr<SnippetGroup>& group) const {
    return groupArchive(group, library_.dateInstalled);
}

Result<void> DataManager::backupToFile(const Path& path, bool includePrefs) {
    const std::string extension = extensionOf(path.filename().string());
    if (extension == "plume") return around_.files.write(path, archivedDataIncludingPreferences(includePrefs));
    if (extension == "csv") return around_.files.write(path, csvFromLibrary(library_.snippetGroups));
    if (extension == "json") return around_.files.write(path, LibraryFile::write(library_.snippetGroups));
    return Error{path.string() + ": a library can be written to files that end with .plume, .csv or .json"};
}

Result<void> DataManager::saveGroup(const std::shared_ptr<SnippetGroup>& group, const Path& toFile) {
    const std::string extension = extensionOf(toFile.filename().string());
    if (extension == "plume") return around_.files.write(toFile, dataFromSnippetGroup(group));
    if (extension == "csv") return around_.files.write(toFile, csvFromGroup(*group));
    return {};
}

Result<std::vector<std::string>> DataManager::importDataFromFile(const Path& path) {
    auto imported = around_.import(path);
    if (imported) append(imported.value());
    raise(didImportDataEvent);
    if (!imported) return imported.error();
    return std::move(imported).value().remarks;
}

void DataManager::append(const ImportedLibrary& imported) {
    for (const auto& group : imported.groups) {
        const auto known =
            group->name() == SystemSubstitutionsGroup ? groupWithName(SystemSubstitutionsGroup) : nullptr;
        if (known) {
            known->replaceItems(group->items());
        } else {
            library_.snippetGroups.push_back(group);
        }
    }
}

std::shared_ptr<SnippetGroup> DataManager::generateSnippetGroupSamples(
    const std::u16string& name, const std::vector<std::u16string>& snippetSamples) {
    auto group = SnippetGroup::make();
    group->setName(name);
    for (std::size_t i = 0; i + 1 < snippetSamples.size(); i += 2) {
        group->addItem(std::make_shared<Snippet>(snippetSamples[i], snippetSamples[i + 1]));
    }
    library_.snippetGroups.push_back(group);
    return group;
}

void DataManager::convertDataToNewFormat() {
    convertOldSnippets(library_.snippetGroups, around_.convertOldSnippet);
}

void DataManager::setGroups(const SnippetGroups& groups) {
    library_.snippetGroups = groups;
}

// ---- Restoring ----

Result<std::vector<std::string>> DataManager::restoreFromFile(const Path& path) {
    auto imported = around_.import(path);
    if (!imported) return imported.error();
    raise(willClearDataEvent);
    library_.snippetGroups.clear();
    append(imported.value());
    raise(didImportDataEvent);
    return std::move(imported).value().remarks;
}

Result<Files::Path> DataManager::restoreFile(const Path& path) {
    // Read before the backup is made: making one may throw this very file away.
    const auto imported = around_.import(path);
    if (!imported) return imported.error();
    return replaceGroups(imported.value().groups);
}

Result<Files::Path> DataManager::replaceGroups(const SnippetGroups& groups) {
    auto kept = backups_.backup();
    if (!kept) return Error{"nothing was replaced, because the library of now cannot be kept: " + kept.error().message};
    raise(willClearDataEvent);
    setGroups(groups);
    raise(didImportDataEvent);
    notifyDataChanged();
    return kept;
}

}  // namespace plume

#include "library/StoredLibrary.h"

#include <algorithm>
#include <utility>
#include <variant>

#include "Foundation/Uuid.h"
#include "library/LibraryJournal.h"
#include "library/LibraryMerge.h"

namespace plume {

namespace {

// How often another process may be faster in a row before the change waits for the next occasion.
constexpr int MostAttempts = 8;

}  // namespace

LibraryStorage::Written StoredLibrary::Save::run() const {
    return storage->save(libraryArchive(contents), basedOn);
}

StoredLibrary::StoredLibrary(LibraryStorage& storage, ConvertOldSnippet convertOldSnippet,
                             std::function<void(LibraryContents)> replace)
    : storage_(storage), convertOldSnippet_(std::move(convertOldSnippet)), replace_(std::move(replace)) {}

StoredLibrary::Loaded StoredLibrary::decoded(LibraryStorage::Stored stored) const {
    Loaded loaded;
    loaded.found = stored.archive.has_value() || !stored.journal.empty();
    if (stored.archive) {
        auto contents = readLibraryArchive(*stored.archive, convertOldSnippet_);
        if (!contents) {
            loaded.damage = contents.error().message;
            loaded.damagedArchive = std::move(stored.archive);
            return loaded;
        }
        loaded.contents = std::move(contents).value();
    }
    for (const std::string& entry : stored.journal) {
        const auto applied = applyJournalEntry(entry, loaded.contents);
        if (applied) continue;
        // Those behind it build on it.
        loaded.damage = applied.error().message;
        break;
    }
    return loaded;
}

Result<StoredLibrary::Loaded> StoredLibrary::load() {
    auto stored = storage_.load();
    if (!stored) return stored.error();
    generation_ = stored.value().generation;
    journalLength_ = 0;
    for (const std::string& entry : stored.value().journal) journalLength_ += entry.size();
    return decoded(std::move(stored).value());
}

Result<void> StoredLibrary::recordChanges(LibraryContents& library) {
    for (int attempt = 0; attempt < MostAttempts; ++attempt) {
        const LibraryDelta delta = recorded_.changesTo(library);
        if (delta.isEmpty()) return {};
        const std::string entry = journalEntry(library, delta);
        const auto written = storage_.append(entry, generation_);
        if (!written) return written.error();
        if (const auto* generation = std::get_if<LibraryStorage::Generation>(&written.value())) {
            generation_ = *generation;
            journalLength_ += entry.size();
            recorded_.record(library, delta);
            return {};
        }
        if (auto merged = mergeWithStored(library, delta); !merged) return merged;
    }
    return Error{"the store is written by another process all the time"};
}

Result<void> StoredLibrary::takeOver(LibraryContents& library) {
    const LibraryDelta delta = recorded_.changesTo(library);
    if (auto merged = mergeWithStored(library, delta); !merged) return merged;
    return recordChanges(library);
}

Result<void> StoredLibrary::mergeWithStored(LibraryContents& library, const LibraryDelta& delta) {
    const auto before = generation_;
    auto loaded = load();
    if (!loaded) return loaded.error();
    if (generation_ == before) return {};
    if (!loaded.value().damage.empty()) {
        generation_ = before;
        return Error{"what another process has stored cannot be read: " + loaded.value().damage};
    }
    LibraryContents theirs = std::move(loaded.value().contents);
    if (delta.isEmpty()) keepRecords(library, theirs);
    const RecordedLibrary previously = std::exchange(recorded_, RecordedLibrary());
    recorded_.record(theirs);
    if (!delta.isEmpty()) {
        mergeLibraries(previously, library, delta, theirs);
        theirs.versionUUIDString = Uuid::random().toString();
        theirs.dateCreated = currentDate();
    }
    replace_(std::move(theirs));
    return {};
}

void StoredLibrary::endSave(const LibraryStorage::Written& written) {
    if (!written) return;
    if (const auto* generation = std::get_if<LibraryStorage::Generation>(&written.value())) {
        generation_ = std::max(generation_, *generation);
        journalLength_ = 0;
    }
}

}  // namespace plume

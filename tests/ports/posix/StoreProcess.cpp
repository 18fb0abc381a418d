// A process of its own that works with a store until it is killed: plume_store_process FOLDER.
//
// It counts: an entry of the journal is one, the archive says how many entries it has taken in. Every count that is
// kept is told on a line of its own.
#include <iostream>
#include <string>

#include "ports/posix/store/SqliteStore.h"

int main(int argc, char** argv) {
    using plume::LibraryStorage;
    constexpr int EntriesUntilSaved = 7;
    const std::string folder = argc > 1 ? argv[1] : "";
    const auto opened = plume::SqliteStore::open(folder, nullptr);
    if (!opened || !opened.value().problems.empty()) {
        std::cerr << (opened ? opened.value().problems.front() : opened.error().message) << '\n';
        return 1;
    }
    LibraryStorage& library = opened.value().store->library();
    const auto stored = library.load().value();
    std::int64_t count = std::stoll(stored.archive.value_or("0")) + static_cast<std::int64_t>(stored.journal.size());
    for (LibraryStorage::Generation generation = stored.generation;;) {
        const bool saves = count % EntriesUntilSaved == EntriesUntilSaved - 1;
        const auto appended = library.append(std::string(500, 'e'), generation);
        if (!appended || !std::holds_alternative<LibraryStorage::Generation>(appended.value())) return 2;
        generation = std::get<LibraryStorage::Generation>(appended.value());
        std::cout << ++count << std::endl;
        if (!saves) continue;
        const auto saved = library.save(std::to_string(count), generation);
        if (!saved || !std::holds_alternative<LibraryStorage::Generation>(saved.value())) return 3;
        generation = std::get<LibraryStorage::Generation>(saved.value());
        if (!opened.value().store->settings().setObject("count", count)) return 4;
    }
}

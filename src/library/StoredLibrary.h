// The library in its store: read at start, every change put into the journal, and the whole written as one archive now
// and then.
//
// Works with other processes on the same store: what another one has written is taken over, with the changes made here
// on top. Owned by the library's owner, on its thread, but for Save::run().
#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "Foundation/Result.h"
#include "library/LibraryArchive.h"
#include "library/RecordedLibrary.h"
#include "platform/LibraryStorage.h"

namespace plume {

class StoredLibrary {
  public:
    struct Loaded {
        LibraryContents contents;
        bool found = false;  // something was stored, readable or not
        // The stored archive that cannot be read, and why. The contents are those of no library then.
        std::optional<std::string> damagedArchive;
        std::string damage;
    };

    // One save of the state that was recorded last. run() may be called from another thread, once.
    struct Save {
        LibraryContents contents;
        LibraryStorage::Generation basedOn = 0;
        LibraryStorage* storage = nullptr;

        LibraryStorage::Written run() const;
    };

    // Both outlive it. `replace` gets a library that takes the place of the one here.
    StoredLibrary(LibraryStorage& storage, ConvertOldSnippet convertOldSnippet,
                  std::function<void(LibraryContents)> replace);

    // An error when the store cannot be read at all.
    Result<Loaded> load();
    // Takes the library of now for what is stored; nothing is written.
    void record(const LibraryContents& library) { recorded_.record(library); }

    // Puts into the journal what has changed since the last time. Calls `replace` when another process has written
    // meanwhile, and puts down the changes on top of that. After an error the changes are still to be put down.
    Result<void> recordChanges(LibraryContents& library);
    // Another process has written: takes over what it wrote.
    Result<void> takeOver(LibraryContents& library);
    // The next recordChanges() comes on top of this generation.
    Save beginSave() const { return {recorded_.contents(), generation_, &storage_}; }
    // What the save returned. Refused ones are taken over by the next change or takeOver().
    void endSave(const LibraryStorage::Written& written);
    // Bytes put into the journal since the last save.
    std::size_t journalLength() const { return journalLength_; }

  private:
    Loaded decoded(LibraryStorage::Stored stored) const;
    Result<void> mergeWithStored(LibraryContents& library, const LibraryDelta& delta);

    LibraryStorage& storage_;
    const ConvertOldSnippet convertOldSnippet_;
    const std::function<void(LibraryContents)> replace_;
    RecordedLibrary recorded_;
    LibraryStorage::Generation generation_ = 0;
    std::size_t journalLength_ = 0;
};

}  // namespace plume

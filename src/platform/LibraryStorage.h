// Where the library is kept: one archive, and a journal of what has changed since it was written.
//
// Safe with several processes that work with the same library: every write names the state that it builds on, and is
// refused when another process was faster. Belongs to the main thread, but for save(), which may be called from one
// other thread at a time.
#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

#include "Foundation/Result.h"
#include "Foundation/Subscription.h"

namespace plume {

class LibraryStorage {
  public:
    // Grows with every write of any process.
    using Generation = std::int64_t;

    struct Stored {
        std::optional<std::string> archive;  // none was ever saved
        std::vector<std::string> journal;    // entries in the order they were appended
        Generation generation = 0;
    };

    // Refused: another process has written since, or a newer archive of this one is there already. Nothing was changed.
    struct Outdated {};
    using Outcome = std::variant<Generation, Outdated>;
    using Written = Result<Outcome>;

    virtual ~LibraryStorage() = default;
    virtual Result<Stored> load() = 0;
    // Outlives the process, however that ends, once this returns; a power cut may take the entries of the last seconds.
    virtual Written append(std::string_view journalEntry, Generation basedOn) = 0;
    // Keeps the archive, and drops the journal entries up to generation `basedOn`, in one step. Entries that this same
    // process appended after that stay, and apply to the archive. On the disk when this returns.
    virtual Written save(std::string_view archive, Generation basedOn) = 0;
    // Calls from the main loop when another process has written.
    [[nodiscard]] virtual Subscription addObserver(std::function<void()> changedByAnotherProcess) = 0;
};

}  // namespace plume

// How often, and when last, each snippet was used: what search and suggestions order by.
//
// A count fades by half in two weeks and grows by one with every use. Only identifiers, counts and times are kept,
// never what was typed; all of it stands in the settings under one key, which neither exports, backups nor
// synchronisation take along. While "RememberSnippetUses" is off, nothing is noted and nothing has weight. Belongs to
// the main thread.
#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>

#include "Foundation/Date.h"
#include "Foundation/Result.h"
#include "Foundation/Uuid.h"
#include "library/LibraryArchive.h"
#include "platform/UserDefaults.h"

namespace plume {

class SnippetUses {
  public:
    static constexpr const char* Key = "SnippetUses";
    static constexpr const char* SwitchKey = "RememberSnippetUses";
    static constexpr std::size_t MostKept = 5000;

    // Reads what the settings hold; what is damaged there counts as nothing. The settings outlive it.
    explicit SnippetUses(WritableUserDefaults& settings);

    void note(const Uuid& uuid, Date now);
    // From 0, never used, to 1, the most used of all.
    double weight(const Uuid& uuid, Date now) const;
    // The count as it has faded until now.
    double count(const Uuid& uuid, Date now) const;
    // Grows with every change of what weight() answers, other than by time.
    std::uint64_t revision() const;

    // Drops all that is known of snippets that are not among these; the next write() keeps it so.
    void dropAllBut(const SnippetGroups& living);
    // Nothing happens when nothing has changed since the last time. On failure it is tried again with the next call.
    Result<void> write();
    // All that is known is dropped, in the settings too.
    Result<void> forget();

  private:
    struct Use {
        double count = 0;
        Date time;
    };

    bool isOn() const { return settings_.boolForKey(SwitchKey); }
    void read();
    void readOne(std::string_view key, const PropertyList& value);
    void dropLeastUsed();
    static double faded(const Use& use, Date now);
    // Orders uses alike at every moment.
    static double standing(const Use& use);

    WritableUserDefaults& settings_;
    std::map<Uuid, Use> uses_;
    std::optional<Use> mostUsed_;
    std::uint64_t revision_ = 0;
    bool isWritten_ = true;
};

}  // namespace plume

#include "library/LibraryJournal.h"

#include <any>
#include <cstdint>
#include <optional>
#include <tuple>
#include <utility>
#include <vector>

#include "Foundation/archive/KeyedArchive.h"

namespace plume {

namespace {

using Array = PropertyList::Array;
using Dictionary = PropertyList::Dictionary;

// ---- Writing ----

PropertyList number(std::size_t value) {
    return static_cast<std::int64_t>(value);
}

Dictionary written(const ListChange& change) {
    return {{"At", number(change.at)}, {"Removed", number(change.removed)}, {"Added", number(change.added)}};
}

Dictionary written(const GroupChange& change) {
    Array changed;
    for (const std::size_t place : change.changed) changed.push_back(number(place));
    return {{"Group", number(change.group)},
            {"Settings", change.settings},
            {"Items", written(change.items)},
            {"Changed", std::move(changed)}};
}

// The records that the delta names, in its order.
struct ChangedRecords {
    std::vector<const KeyedCodable*> newGroups;
    std::vector<const KeyedCodable*> settings;
    std::vector<const KeyedCodable*> snippets;  // of each group the new ones, then the changed ones
    std::vector<std::shared_ptr<SnippetGroup>> withoutItems;
};

ChangedRecords changedRecords(const LibraryContents& library, const LibraryDelta& delta) {
    ChangedRecords records;
    const auto& groups = library.snippetGroups;
    for (std::size_t i = 0; i < delta.groups.added; ++i) {
        records.newGroups.push_back(groups[delta.groups.at + i].get());
    }
    for (const GroupChange& change : delta.groupChanges) {
        const SnippetGroup& group = *groups[change.group];
        if (change.settings) {
            records.withoutItems.push_back(group.snapshot());
            records.settings.push_back(records.withoutItems.back().get());
        }
        for (std::size_t i = 0; i < change.items.added; ++i) {
            records.snippets.push_back(group.items()[change.items.at + i].get());
        }
        for (const std::size_t place : change.changed) records.snippets.push_back(group.items()[place].get());
    }
    return records;
}

// ---- Reading ----

// What an entry says, before it is known to fit.
struct Entry {
    LibraryContents identity;
    LibraryDelta delta;
    SnippetGroups newGroups;
    SnippetGroups settings;
    std::vector<std::shared_ptr<Snippet>> snippets;
};

std::optional<std::size_t> count(const PropertyList& list, std::string_view key) {
    const auto* value = list.find<std::int64_t>(key);
    if (!value || *value < 0) return std::nullopt;
    return static_cast<std::size_t>(*value);
}

std::optional<ListChange> readListChange(const PropertyList* list) {
    if (!list) return std::nullopt;
    const auto at = count(*list, "At");
    const auto removed = count(*list, "Removed");
    const auto added = count(*list, "Added");
    if (!at || !removed || !added) return std::nullopt;
    return ListChange{*at, *removed, *added};
}

std::optional<GroupChange> readGroupChange(const PropertyList& list) {
    const auto group = count(list, "Group");
    const bool* settings = list.find<bool>("Settings");
    const auto items = readListChange(list.find("Items"));
    const auto* changed = list.find<Array>("Changed");
    if (!group || !settings || !items || !changed) return std::nullopt;
    GroupChange change{*group, *settings, *items, {}};
    for (const PropertyList& place : *changed) {
        const auto* value = place.as<std::int64_t>();
        if (!value || *value < 0) return std::nullopt;
        change.changed.push_back(static_cast<std::size_t>(*value));
    }
    return change;
}

bool readDelta(const KeyedDecoder& root, LibraryDelta& delta) {
    const auto groups = root.decodePropertyList("Groups");
    const auto changes = root.decodePropertyList("Changes");
    const auto list = readListChange(groups ? &*groups : nullptr);
    const auto* each = changes ? changes->as<Array>() : nullptr;
    if (!list || !each) return false;
    delta.groups = *list;
    for (const PropertyList& change : *each) {
        auto read = readGroupChange(change);
        if (!read) return false;
        delta.groupChanges.push_back(*std::move(read));
    }
    return true;
}

template <typename Record, typename Make>
std::vector<std::shared_ptr<Record>> readRecords(const KeyedDecoder& root, std::string_view key, Make make) {
    std::vector<std::shared_ptr<Record>> records;
    root.decodeObjects(key, [&](KeyedDecoder& coder) {
        std::any& decoded = coder.decodedObject();
        if (!decoded.has_value()) decoded = make(coder);
        if (const auto* record = std::any_cast<std::shared_ptr<Record>>(&decoded)) records.push_back(*record);
    });
    return records;
}

Result<Entry> readEntry(std::string_view bytes) {
    Entry entry;
    bool complete = false;
    const auto read = readKeyedArchive(bytes, [&](const KeyedDecoder& root) {
        entry.identity.dateInstalled = root.decodeDate("DateInstalled");
        entry.identity.uuidString = root.decodeString("UUID");
        entry.identity.versionUUIDString = root.decodeString("VersionUUID");
        entry.identity.dateCreated = root.decodeDate("DateCreated");
        complete = readDelta(root, entry.delta);
        entry.newGroups = readRecords<SnippetGroup>(root, "NewGroups", SnippetGroup::makeWithCoder);
        entry.settings = readRecords<SnippetGroup>(root, "GroupSettings", SnippetGroup::makeWithCoder);
        entry.snippets = readRecords<Snippet>(
            root, "Snippets", [](const KeyedDecoder& coder) { return std::make_shared<Snippet>(coder); });
    });
    if (!read) return read.error();
    if (!complete) return Error{"an entry of the journal lacks what it should say"};
    return entry;
}

bool fits(const ListChange& change, std::size_t length) {
    return change.at <= length && change.removed <= length - change.at;
}

// Every place that the entry names exists, and it holds as many records as it says.
bool fits(const Entry& entry, const LibraryContents& library) {
    const auto& groups = library.snippetGroups;
    const ListChange& list = entry.delta.groups;
    if (!fits(list, groups.size()) || entry.newGroups.size() != list.added) return false;
    const std::size_t groupCount = groups.size() - list.removed + list.added;
    std::size_t settings = 0;
    std::size_t snippets = 0;
    for (const GroupChange& change : entry.delta.groupChanges) {
        if (change.group >= groupCount) return false;
        const bool isNew = change.group >= list.at && change.group < list.at + list.added;
        if (isNew) return false;
        const std::size_t before = change.group < list.at ? change.group : change.group - list.added + list.removed;
        const std::size_t length = groups[before]->items().size();
        if (!fits(change.items, length)) return false;
        for (const std::size_t place : change.changed) {
            if (place >= length - change.items.removed + change.items.added) return false;
        }
        settings += change.settings ? 1 : 0;
        snippets += change.items.added + change.changed.size();
    }
    return settings == entry.settings.size() && snippets == entry.snippets.size();
}

template <typename Element>
auto place(std::vector<Element>& list, std::size_t index) {
    return list.begin() + static_cast<std::ptrdiff_t>(index);
}

template <typename Next>
void applyTo(SnippetGroup& group, const GroupChange& change, Next nextSnippet) {
    std::vector<std::shared_ptr<Snippet>> items = group.items();
    const auto first = place(items, change.items.at);
    items.erase(first, first + static_cast<std::ptrdiff_t>(change.items.removed));
    for (std::size_t i = 0; i < change.items.added; ++i) {
        items.insert(place(items, change.items.at + i), nextSnippet());
    }
    for (const std::size_t changed : change.changed) items[changed] = nextSnippet();
    group.replaceItems(items);
}

}  // namespace

std::string journalEntry(const LibraryContents& library, const LibraryDelta& delta) {
    const ChangedRecords records = changedRecords(library, delta);
    Array changes;
    for (const GroupChange& change : delta.groupChanges) changes.emplace_back(written(change));
    return keyedArchive([&](KeyedEncoder& root) {
        root.encodeDate("DateInstalled", library.dateInstalled);
        root.encodeString("UUID", library.uuidString);
        root.encodeString("VersionUUID", library.versionUUIDString);
        root.encodeDate("DateCreated", library.dateCreated);
        root.encodePropertyList("Groups", written(delta.groups));
        root.encodePropertyList("Changes", changes);
        root.encodeObjects("NewGroups", records.newGroups);
        root.encodeObjects("GroupSettings", records.settings);
        root.encodeObjects("Snippets", records.snippets);
    });
}

Result<void> applyJournalEntry(std::string_view bytes, LibraryContents& library) {
    const Result<Entry> read = readEntry(bytes);
    if (!read) return read.error();
    const Entry& entry = read.value();
    if (!fits(entry, library)) return Error{"an entry of the journal belongs to another state of the library"};

    auto& groups = library.snippetGroups;
    const ListChange& list = entry.delta.groups;
    const auto first = place(groups, list.at);
    groups.erase(first, first + static_cast<std::ptrdiff_t>(list.removed));
    groups.insert(place(groups, list.at), entry.newGroups.begin(), entry.newGroups.end());

    auto settings = entry.settings.begin();
    auto snippet = entry.snippets.begin();
    for (const GroupChange& change : entry.delta.groupChanges) {
        SnippetGroup& group = *groups[change.group];
        if (change.settings) {
            group.setName((*settings)->name());
            group.setAbbreviationPrefix((*settings)->abbreviationPrefix());
            group.copySettingsFromGroup(**settings++);
        }
        applyTo(group, change, [&] { return *snippet++; });
    }
    std::tie(library.dateInstalled, library.uuidString, library.versionUUIDString, library.dateCreated) =
        std::tie(entry.identity.dateInstalled, entry.identity.uuidString, entry.identity.versionUUIDString,
                 entry.identity.dateCreated);
    return {};
}

}  // namespace plume

#include "library/LibraryArchive.h"

#include <any>
#include <utility>

#include "Foundation/Strings.h"
#include "Foundation/archive/KeyedArchive.h"

namespace plume {

namespace {

// Grows when archives change so that older versions cannot read them.
constexpr const char16_t* Version = u"100";
// Before this one, contents were written in another syntax.
constexpr const char16_t* FirstVersionOfTodaysSyntax = u"24";

void encodeGroups(KeyedEncoder& root, const SnippetGroups& groups, const std::optional<Date>& dateInstalled) {
    std::vector<const KeyedCodable*> records;
    records.reserve(groups.size());
    for (const auto& group : groups) records.push_back(group.get());
    root.encodeString("Version", Version);
    root.encodeObjects("Snippets", records);
    root.encodeDate("DateInstalled", dateInstalled);
}

std::shared_ptr<SnippetGroup> decodeGroup(KeyedDecoder& coder) {
    std::any& decoded = coder.decodedObject();
    if (const auto* known = std::any_cast<std::shared_ptr<SnippetGroup>>(&decoded)) return *known;
    auto group = SnippetGroup::makeWithCoder(coder);
    decoded = group;
    return group;
}

}  // namespace

std::string libraryArchive(const LibraryContents& contents) {
    return keyedArchive([&](KeyedEncoder& root) {
        encodeGroups(root, contents.snippetGroups, contents.dateInstalled);
        root.encodeString("UUID", contents.uuidString);
        root.encodeString("VersionUUID", contents.versionUUIDString);
        root.encodeDate("DateCreated", contents.dateCreated);
        if (contents.preferences) root.encodePropertyList("Preferences", *contents.preferences);
    });
}

std::string groupArchive(const std::shared_ptr<SnippetGroup>& group, const std::optional<Date>& dateInstalled) {
    return keyedArchive([&](KeyedEncoder& root) { encodeGroups(root, {group}, dateInstalled); });
}

Result<LibraryContents> readLibraryArchive(std::string_view bytes, const ConvertOldSnippet& convertOldSnippet) {
    LibraryContents contents;
    bool hasGroups = false;
    bool isOld = false;
    const Result<void> read = readKeyedArchive(bytes, [&](const KeyedDecoder& root) {
        hasGroups = root.decodeObjects(
            "Snippets", [&](KeyedDecoder& group) { contents.snippetGroups.push_back(decodeGroup(group)); });
        contents.dateInstalled = root.decodeDate("DateInstalled");
        contents.uuidString = root.decodeString("UUID");
        contents.versionUUIDString = root.decodeString("VersionUUID");
        contents.dateCreated = root.decodeDate("DateCreated");
        if (auto preferences = root.decodePropertyList("Preferences")) {
            if (const auto* values = preferences->as<PropertyList::Dictionary>()) contents.preferences = *values;
        }
        const auto version = root.decodeString("Version");
        isOld = version && compareNaturally(*version, FirstVersionOfTodaysSyntax) < 0;
    });
    if (!read) return read.error();
    if (!hasGroups) return Error{"it holds no library: its root has no list \"Snippets\""};
    if (isOld && convertOldSnippet) convertOldSnippets(contents.snippetGroups, convertOldSnippet);
    return contents;
}

void convertOldSnippets(const SnippetGroups& groups, const ConvertOldSnippet& convertOldSnippet) {
    for (const auto& group : groups) {
        for (const auto& snippet : group->items()) {
            try {
                convertOldSnippet(*snippet);
            } catch (const std::exception&) {
                continue;  // one content that cannot be converted costs nobody the others
            }
        }
    }
}

}  // namespace plume

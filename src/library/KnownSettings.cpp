#include "library/KnownSettings.h"

#include <algorithm>
#include <limits>

#include "Foundation/Strings.h"
#include "library/SettingValues.h"

namespace plume {

namespace {

using Dictionary = PropertyList::Dictionary;
using Text = std::u16string;

constexpr std::int64_t EveryField = std::numeric_limits<std::int64_t>::max();

PropertyList boolean(const JsonNode& node) {
    return node.boolean();
}

PropertyList integer(const JsonNode& node) {
    return node.integer();
}

PropertyList notNegative(const JsonNode& node) {
    return node.integer(0);
}

// Everywhere, except in what is listed, only there.
PropertyList availability(const JsonNode& node) {
    return node.integer(0, 2);
}

// No modifier, or one of the four.
PropertyList selectorModifier(const JsonNode& node) {
    return node.integer(0, 4);
}

PropertyList seconds(const JsonNode& node) {
    constexpr double Day = 24 * 60 * 60;
    return node.number(0, Day);
}

PropertyList string(const JsonNode& node) {
    return node.string();
}

PropertyList strings(const JsonNode& node) {
    const auto texts = node.strings();
    return PropertyList::Array(texts.begin(), texts.end());
}

PropertyList dictionary(const JsonNode& node) {
    node.members();
    return settingFromJson(node);
}

PropertyList date(const JsonNode& node) {
    const auto moment = dateFromText(toUtf8(node.string()));
    if (!moment) node.fail("expected a date like \"2026-01-31T18:30:00Z\"");
    return *moment;
}

// Kept as it is written; who needs it reads it.
PropertyList objectAsText(const JsonNode& node) {
    node.members();
    return fromUtf8(node.value().dump());
}

// The modifiers in the upper half, the key code in the lower.
PropertyList hotKey(const JsonNode& node) {
    constexpr std::int64_t AllModifiers = 15;
    constexpr std::int64_t NoKey = 65535;
    const std::int64_t packed = node.integer(0);
    if ((packed >> 32) > AllModifiers || (packed & 0xFFFFFFFF) > NoKey) {
        node.fail("expected a packed hot key: 4294967296 times the modifiers (0 to 15) plus the key code (0 to 65535)");
    }
    return packed;
}

constexpr const char* Place = "settings";

// The value where it would stand in a file of settings, so that a mistake is told with the setting's name.
Result<PropertyList> valueFrom(const KnownSetting& setting, const nlohmann::ordered_json& value) {
    return readingJson([&] {
        const nlohmann::ordered_json object{{std::string(setting.name), value}};
        return setting.read(JsonNode::parse(object.dump(), Place).members().front().second);
    });
}

}  // namespace

const std::vector<KnownSetting>& knownSettings() {
    static const std::vector<KnownSetting> settings{
        {"ShowDockIcon", boolean, true},
        {"IsEnabled", boolean, true},
        {"FirstLaunch", boolean, true},
        {"AutoBackupInterval", integer, std::int64_t{2}},
        {"BackupDirectory", string},
        {"BackupQuantity", notNegative, std::int64_t{10}},
        {"PlayFeedbackSound", boolean, true},
        {"FeedbackSound", string, Text(u"Click")},
        {"ShowStatusIcon", boolean, true},
        {"ListenMouseDownEvents", boolean, true},
        {"RestoreClipboard", boolean, true},
        {"RestoreClipboardDelay", seconds, 0.4},
        {"LetProgramsTellPasswordFields", boolean},
        {"LongTextLength", integer, std::int64_t{100}},
        {"CapitalizationExcludedAbbreviations", string, Text(u"etc.\ne.g.\ni.e.")},
        {"DefaultSnippetEditorFont", dictionary,
         Dictionary{{"NSFontNameAttribute", Text(u"Helvetica")}, {"NSFontSizeAttribute", 12.0}}},
        {"MainWindowSearchBy", integer, EveryField},
        {"SnippetQuickSearchSearchBy", integer, EveryField},
        {"FontSizeDelta", integer},
        {"RememberSnippetUses", boolean, true},
        {"AutoCorrectIn", availability},
        {"AutoCorrectApplications", strings},
        {"AutoCorrectInputMethodsOption", availability},
        {"AutoCorrectInputMethods", strings},
        {"CapitalizeNewSentences", boolean},
        {"CorrectDoubleCapitals", boolean},
        {"DoubleCapitalsCorrectionExclusion", string},
        {"SuggestAutomatically", boolean, false},
        {"PlainForms", boolean, false},
        {"SnippetSelectorKeyModifier", selectorModifier},
        {"SnippetAdaptToAbbreviationCaseOption", integer},
        {"SnippetQuickSearchWildcardSearch", integer},
        {"WildcardSearch", integer},
        {"SnippetQuickSearchBeginsWithTyped", boolean},
        {"UseClipboard", boolean},
        {"UseClipboardIn", availability},
        {"UseClipboardApplications", strings},
        {"UseClipboardForLongText", boolean},
        {"CustomApplicationSettings", objectAsText},
        {"ListenAtAnnotatedSession", boolean},
        {"SUEnableAutomaticChecks", boolean},
        {"LastBackupTime", date},
        {"SyncEnabled", boolean},
        {"SyncDirectoryType", integer},
        {"SyncDirectory", string},
        {"SyncPreferences", boolean},
        {"SyncWithOSXSubstitutions", boolean},
        {"switchHotKey", hotKey},
        {"makeSnippetFromSelectionHotKey", hotKey},
        {"makeSnippetFromClipboardHotKey", hotKey},
        {"suggestAbbreviationsHotKey", hotKey},
        {"quickSearchHotKey", hotKey},
        {"openMainWindowHotKey", hotKey},
        {"OpenLastUsedSnippetHotKey", hotKey},
        {"UndoHotKey", hotKey},
        {"UndoAltHotKey", hotKey},
        {"ExpandHotKey", hotKey},
        {"QuickSearchHotKey", hotKey},
    };
    return settings;
}

const KnownSetting* findKnownSetting(std::string_view name) {
    const auto& known = knownSettings();
    const auto found = std::find_if(known.begin(), known.end(), [&](const KnownSetting& s) { return s.name == name; });
    return found == known.end() ? nullptr : &*found;
}

Result<PropertyList> settingFromText(const KnownSetting& setting, const std::string& text) {
    const auto json = readingJson([&] { return JsonNode::parse(text, Place).value(); });
    Result<PropertyList> asJson = json ? valueFrom(setting, json.value()) : Result<PropertyList>(json.error());
    if (asJson) return asJson;
    Result<PropertyList> asText = valueFrom(setting, toUtf8(fromUtf8(text)));
    return asText || !json ? asText : asJson;
}

PropertyList::Dictionary registeredSettings(const std::filesystem::path& backupFolder) {
    Dictionary registered;
    for (const KnownSetting& setting : knownSettings()) {
        if (setting.registered) registered.emplace(setting.name, *setting.registered);
    }
    if (!backupFolder.empty()) registered.insert_or_assign("BackupDirectory", fromUtf8(backupFolder.string()));
    return registered;
}

}  // namespace plume

#include "library/SettingsFile.h"

#include <algorithm>
#include <limits>
#include <vector>

#include "Foundation/Strings.h"
#include "library/MemoryUserDefaults.h"

namespace plume {

namespace {

using Defaults = MemoryUserDefaults;
using Reader = Defaults::Value (*)(const JsonNode&);

constexpr std::int64_t EveryField = std::numeric_limits<std::int64_t>::max();

Defaults::Value boolean(const JsonNode& node) {
    return node.boolean();
}

Defaults::Value integer(const JsonNode& node) {
    return node.integer();
}

Defaults::Value notNegative(const JsonNode& node) {
    return node.integer(0);
}

// Everywhere, except in what is listed, only there.
Defaults::Value availability(const JsonNode& node) {
    return node.integer(0, 2);
}

// No modifier, or one of the four.
Defaults::Value selectorModifier(const JsonNode& node) {
    return node.integer(0, 4);
}

Defaults::Value seconds(const JsonNode& node) {
    constexpr double Day = 24 * 60 * 60;
    return node.number(0, Day);
}

Defaults::Value string(const JsonNode& node) {
    return node.string();
}

Defaults::Value strings(const JsonNode& node) {
    return node.strings();
}

// Kept as it is written; who needs it reads it.
Defaults::Value object(const JsonNode& node) {
    node.members();
    return fromUtf8(node.value().dump());
}

// The modifiers in the upper half, the key code in the lower.
Defaults::Value hotKey(const JsonNode& node) {
    constexpr std::int64_t AllModifiers = 15;
    constexpr std::int64_t NoKey = 65535;
    const std::int64_t packed = node.integer(0);
    if ((packed >> 32) > AllModifiers || (packed & 0xFFFFFFFF) > NoKey) {
        node.fail("expected a packed hot key: 4294967296 times the modifiers (0 to 15) plus the key code (0 to 65535)");
    }
    return packed;
}

struct Setting {
    const char* name;
    Reader read;
    std::optional<Defaults::Value> registered = std::nullopt;
};

const std::vector<Setting>& knownSettings() {
    using Text = std::u16string;
    static const std::vector<Setting> settings{
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
        {"MainWindowSearchBy", integer, EveryField},
        {"SnippetQuickSearchSearchBy", integer, EveryField},
        {"FontSizeDelta", integer},
        {"AutoCorrectIn", availability},
        {"AutoCorrectApplications", strings},
        {"AutoCorrectInputMethodsOption", availability},
        {"AutoCorrectInputMethods", strings},
        {"CapitalizeNewSentences", boolean},
        {"CorrectDoubleCapitals", boolean},
        {"DoubleCapitalsCorrectionExclusion", string},
        {"SnippetSelectorKeyModifier", selectorModifier},
        {"SnippetAdaptToAbbreviationCaseOption", integer},
        {"SnippetQuickSearchWildcardSearch", integer},
        {"UseClipboard", boolean},
        {"UseClipboardIn", availability},
        {"UseClipboardApplications", strings},
        {"UseClipboardForLongText", boolean},
        {"CustomApplicationSettings", object},
        {"ListenAtAnnotatedSession", boolean},
        {"SUEnableAutomaticChecks", boolean},
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

std::shared_ptr<Defaults> makeDefaults() {
    auto defaults = std::make_shared<Defaults>();
    for (const Setting& setting : knownSettings()) {
        if (setting.registered) defaults->set(setting.name, *setting.registered);
    }
    return defaults;
}

}  // namespace

std::shared_ptr<const UserDefaults> SettingsFile::registeredDefaults() {
    return makeDefaults();
}

Result<std::shared_ptr<const UserDefaults>> SettingsFile::read(std::string_view text, const std::string& fileName) {
    return readingJson([&] { return readFrom(JsonNode::parse(text, fileName)); });
}

std::shared_ptr<const UserDefaults> SettingsFile::readFrom(const JsonNode& node) {
    const std::shared_ptr<Defaults> defaults = makeDefaults();
    for (const auto& [name, value] : node.members()) {
        const auto& known = knownSettings();
        const auto setting =
            std::find_if(known.begin(), known.end(), [&key = name](const Setting& s) { return s.name == key; });
        if (setting == known.end()) value.fail("unknown setting; expected one of those that Plume knows");
        defaults->set(name, setting->read(value));
    }
    return defaults;
}

}  // namespace plume

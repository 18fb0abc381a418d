#include "app/HotKeyDispatch.h"

#include <algorithm>

namespace plume {

namespace {

// The hot key for quick search that the system recognises by itself.
constexpr std::string_view SystemQuickSearchSetting = "QuickSearchHotKey";
constexpr SystemHotKeys::Id SystemQuickSearchId = 1;
// The one whose hot key no setting holds.
constexpr std::string_view ClearCommand{};

}  // namespace

const std::vector<std::string_view>& HotKeyDispatch::settingNames() {
    static const std::vector<std::string_view> names{"switchHotKey",
                                                     "makeSnippetFromClipboardHotKey",
                                                     "makeSnippetFromSelectionHotKey",
                                                     "suggestAbbreviationsHotKey",
                                                     "quickSearchHotKey",
                                                     "openMainWindowHotKey",
                                                     "OpenLastUsedSnippetHotKey",
                                                     "UndoHotKey",
                                                     "UndoAltHotKey",
                                                     "ExpandHotKey",
                                                     SystemQuickSearchSetting};
    return names;
}

std::optional<GeneralHotKey> HotKeyDispatch::hotKeyIn(const UserDefaults& settings, std::string_view name) {
    if (!settings.hasKey(name)) return std::nullopt;
    GeneralHotKey hotKey;
    hotKey.setValue(settings.integerForKey(name));
    return hotKey.isValid() ? std::optional(hotKey) : std::nullopt;
}

HotKeyDispatch::HotKeyDispatch(MacInputService& inputService, const Actions& actions) : inputService_(inputService) {
    addCommands(actions);
    hotKeysPressed_ = inputService_.hotKeysPressed.addObserver(this, &HotKeyDispatch::onMacInputServiceHotKeysPressed);
}

void HotKeyDispatch::addCommands(const Actions& actions) {
    using Swallows = std::optional<bool>;
    const auto add = [this](std::string_view setting, const std::function<void()>& action, Swallows swallows = true) {
        if (!action) return commands_.push_back({setting, {}});
        commands_.push_back({setting, [action, swallows]() -> Swallows {
                                 action();
                                 return swallows;
                             }});
    };
    add("switchHotKey", actions.switchEnabled);
    add("makeSnippetFromClipboardHotKey", actions.makeSnippetFromClipboard);
    add("makeSnippetFromSelectionHotKey", actions.makeSnippetFromSelection);
    add("suggestAbbreviationsHotKey", actions.suggestAbbreviations);
    add("quickSearchHotKey", actions.quickSearch);
    add("openMainWindowHotKey", actions.openMainWindow);
    add("OpenLastUsedSnippetHotKey", actions.openLastUsedSnippet);
    add(ClearCommand, actions.clear, std::nullopt);
    commands_.push_back({"UndoHotKey", [undo = actions.undo] { return undo(true); }});
    commands_.push_back({"UndoAltHotKey", [undo = actions.undo] { return undo(false); }});
    add("ExpandHotKey", actions.expand);
    add(SystemQuickSearchSetting, actions.quickSearch);
}

HotKeyDispatch::~HotKeyDispatch() {
    unregisterHotKeys();
}

void HotKeyDispatch::unregisterHotKeys() {
    for (const auto& [command, hotKey] : hotKeys_) inputService_.unregisterHotKey(hotKey);
    hotKeys_.clear();
    // An empty hot key takes the system's place for it away.
    static_cast<void>(inputService_.registerSystemHotKey(SystemQuickSearchId, {}, [] {}));
}

Result<void> HotKeyDispatch::registerHotKeys(const UserDefaults& settings) {
    for (const auto& [command, hotKey] : hotKeys_) inputService_.unregisterHotKey(hotKey);
    hotKeys_.clear();
    for (const Command& command : commands_) {
        if (!command.perform || command.setting == SystemQuickSearchSetting) continue;
        // Command alone clears, so that a shortcut that was begun and given up leaves nothing half typed behind.
        const auto hotKey = command.setting == ClearCommand
                                ? std::optional(GeneralHotKey{KeyModifier::Command, KeyCode::None})
                                : hotKeyIn(settings, command.setting);
        if (!hotKey) continue;
        hotKeys_.emplace_back(&command, *hotKey);
        inputService_.registerHotKey(*hotKey);
    }
    const auto& quickSearch = std::ranges::find(commands_, SystemQuickSearchSetting, &Command::setting)->perform;
    const auto system = quickSearch ? hotKeyIn(settings, SystemQuickSearchSetting) : std::nullopt;
    return inputService_.registerSystemHotKey(SystemQuickSearchId, system.value_or(GeneralHotKey{}),
                                              [quickSearch] { quickSearch(); });
}

std::vector<std::string_view> HotKeyDispatch::hotKeysWithoutAction(const UserDefaults& settings) const {
    std::vector<std::string_view> names;
    for (const Command& command : commands_) {
        if (!command.perform && hotKeyIn(settings, command.setting)) names.push_back(command.setting);
    }
    return names;
}

void HotKeyDispatch::onMacInputServiceHotKeysPressed(ZDHotKeysPressedEventArgs& event) {
    // An action may have the hot keys registered anew.
    const auto hotKeys = hotKeys_;
    for (const auto& [command, hotKey] : hotKeys) {
        if (std::find(event.hotKeys.begin(), event.hotKeys.end(), hotKey) == event.hotKeys.end()) continue;
        if (const std::optional<bool> swallows = command->perform()) event.cancel = *swallows;
    }
}

}  // namespace plume

#include "app/HotKeyDispatch.h"

#include <algorithm>

namespace plume {

namespace {

// The hot key for quick search that the system recognises by itself.
constexpr std::string_view SystemQuickSearchSetting = "QuickSearchHotKey";
constexpr SystemHotKeys::Id SystemQuickSearchId = 1;

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

HotKeyDispatch::HotKeyDispatch(MacInputService& inputService, Actions actions)
    : inputService_(inputService), actions_(std::move(actions)) {
    hotKeysPressed_ = inputService_.hotKeysPressed.addObserver(this, &HotKeyDispatch::onMacInputServiceHotKeysPressed);
}

HotKeyDispatch::~HotKeyDispatch() {
    for (const auto& [command, hotKey] : hotKeys_) inputService_.unregisterHotKey(hotKey);
    // An empty hot key takes the system's place for it away.
    static_cast<void>(inputService_.registerSystemHotKey(SystemQuickSearchId, {}, [] {}));
}

Result<void> HotKeyDispatch::registerHotKeys(const UserDefaults& settings) {
    for (const auto& [command, hotKey] : hotKeys_) inputService_.unregisterHotKey(hotKey);
    hotKeys_.clear();
    const auto add = [&](Command command, const std::optional<GeneralHotKey>& hotKey) {
        if (hotKey) hotKeys_.emplace_back(command, *hotKey);
    };
    add(Command::Switch, hotKeyIn(settings, "switchHotKey"));
    add(Command::SuggestAbbreviations, hotKeyIn(settings, "suggestAbbreviationsHotKey"));
    add(Command::QuickSearch, hotKeyIn(settings, "quickSearchHotKey"));
    // Command alone, so that a shortcut that was begun and given up leaves nothing half typed behind.
    add(Command::Clear, GeneralHotKey{KeyModifier::Command, KeyCode::None});
    add(Command::Undo, hotKeyIn(settings, "UndoHotKey"));
    add(Command::UndoAlt, hotKeyIn(settings, "UndoAltHotKey"));
    add(Command::Expand, hotKeyIn(settings, "ExpandHotKey"));
    for (const auto& [command, hotKey] : hotKeys_) inputService_.registerHotKey(hotKey);

    const GeneralHotKey system = hotKeyIn(settings, SystemQuickSearchSetting).value_or(GeneralHotKey{});
    return inputService_.registerSystemHotKey(SystemQuickSearchId, system, [this] {
        inputService_.ignoreNextHotKey();
        perform(Command::QuickSearch);
    });
}

void HotKeyDispatch::onMacInputServiceHotKeysPressed(ZDHotKeysPressedEventArgs& event) {
    // An action may have the hot keys registered anew.
    const auto hotKeys = hotKeys_;
    for (const auto& [command, hotKey] : hotKeys) {
        if (std::find(event.hotKeys.begin(), event.hotKeys.end(), hotKey) == event.hotKeys.end()) continue;
        if (const std::optional<bool> swallows = perform(command)) event.cancel = *swallows;
    }
}

std::optional<bool> HotKeyDispatch::perform(Command command) {
    switch (command) {
        case Command::Switch:
            actions_.switchEnabled();
            return true;
        case Command::SuggestAbbreviations:
            actions_.suggestAbbreviations();
            return true;
        case Command::QuickSearch:
            actions_.quickSearch();
            return true;
        case Command::Clear:
            actions_.clear();
            return std::nullopt;
        case Command::Undo:
            return actions_.undo(true);
        case Command::UndoAlt:
            return actions_.undo(false);
        case Command::Expand:
            actions_.expand();
            return true;
    }
    return std::nullopt;
}

}  // namespace plume

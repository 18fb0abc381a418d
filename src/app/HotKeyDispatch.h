// The program's own hot keys: knows them by their settings, and does what they stand for.
//
// Owned by the composition; belongs to the tap thread.
#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "input/GeneralHotKey.h"
#include "input/MacInputService.h"
#include "platform/UserDefaults.h"

namespace plume {

// Hot keys that do something in a window, or with one.
enum class HotKeyForWindow : std::uint8_t {
    MakeSnippetFromClipboard,
    MakeSnippetFromSelection,
    OpenMainWindow,
    OpenLastUsedSnippet
};

class HotKeyDispatch {
  public:
    // What the hot keys do. Those that answer say whether the key is swallowed. The key of an empty one passes.
    struct Actions {
        std::function<void()> switchEnabled;
        std::function<void()> makeSnippetFromClipboard = {};
        std::function<void()> makeSnippetFromSelection = {};
        std::function<void()> suggestAbbreviations = {};
        std::function<void()> quickSearch = {};
        std::function<void()> openMainWindow = {};
        std::function<void()> openLastUsedSnippet = {};
        std::function<void()> clear;
        std::function<bool(bool withTrigger)> undo;
        std::function<void()> expand;
    };

    // The names of the settings that hold a hot key, in the order in which they take effect.
    static const std::vector<std::string_view>& settingNames();
    // The hot key of that setting; nothing when there is none.
    static std::optional<GeneralHotKey> hotKeyIn(const UserDefaults& settings, std::string_view name);

    // Listens from here to its end. The service is not owned and outlives it.
    HotKeyDispatch(MacInputService& inputService, const Actions& actions);
    ~HotKeyDispatch();
    HotKeyDispatch(const HotKeyDispatch&) = delete;
    HotKeyDispatch& operator=(const HotKeyDispatch&) = delete;

    // Registers the hot keys of these settings in place of the previous ones. What the system refuses is an error that
    // says why; the others are registered all the same.
    Result<void> registerHotKeys(const UserDefaults& settings);
    // None is registered any more.
    void unregisterHotKeys();
    // The settings that hold a hot key for which there is nothing to do here.
    std::vector<std::string_view> hotKeysWithoutAction(const UserDefaults& settings) const;

  private:
    // The setting of a hot key, and what it does: whether the key is swallowed; nothing leaves that as it is.
    struct Command {
        std::string_view setting;
        std::function<std::optional<bool>()> perform;
    };

    void addCommands(const Actions& actions);
    void onMacInputServiceHotKeysPressed(ZDHotKeysPressedEventArgs& event);

    MacInputService& inputService_;
    Subscription hotKeysPressed_;
    std::vector<Command> commands_;  // in the order in which they take effect
    std::vector<std::pair<const Command*, GeneralHotKey>> hotKeys_;
};

}  // namespace plume

// The program's own hot keys: knows them by their settings, and does what they stand for.
//
// Owned by the composition; belongs to the tap thread.
#pragma once

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

class HotKeyDispatch {
  public:
    // What the hot keys do. Those that answer say whether the key is swallowed.
    struct Actions {
        std::function<void()> switchEnabled;
        std::function<void()> suggestAbbreviations;
        std::function<void()> quickSearch;
        std::function<void()> clear;
        std::function<bool(bool withTrigger)> undo;
        std::function<void()> expand;
    };

    // The names of the settings that hold a hot key, in the order in which they take effect.
    static const std::vector<std::string_view>& settingNames();
    // The hot key of that setting; nothing when there is none.
    static std::optional<GeneralHotKey> hotKeyIn(const UserDefaults& settings, std::string_view name);

    // Listens from here to its end. The service is not owned and outlives it.
    HotKeyDispatch(MacInputService& inputService, Actions actions);
    ~HotKeyDispatch();
    HotKeyDispatch(const HotKeyDispatch&) = delete;
    HotKeyDispatch& operator=(const HotKeyDispatch&) = delete;

    // Registers the hot keys of these settings in place of the previous ones. What the system refuses is an error that
    // says why; the others are registered all the same.
    Result<void> registerHotKeys(const UserDefaults& settings);

  private:
    enum class Command { Switch, SuggestAbbreviations, QuickSearch, Clear, Undo, UndoAlt, Expand };

    void onMacInputServiceHotKeysPressed(ZDHotKeysPressedEventArgs& event);
    // Whether the key is swallowed; nothing when the command leaves that as it is.
    std::optional<bool> perform(Command command);

    MacInputService& inputService_;
    Subscription hotKeysPressed_;
    const Actions actions_;
    std::vector<std::pair<Command, GeneralHotKey>> hotKeys_;
};

}  // namespace plume

// What the settings window needs of the program around it.
//
// Everything is called on the main thread, nothing waits, and all of it outlives the window. Answers come by the
// functions that are given, on the main thread; a window that is gone by then is the giver's to guard against.
#pragma once

#include <functional>
#include <string>
#include <vector>

#include "Foundation/Result.h"
#include "app/preferences/ProgramServices.h"
#include "input/GeneralHotKey.h"
#include "library/DataManager.h"
#include "platform/UserDefaults.h"

namespace plume {

struct PreferencesServices {
    WritableUserDefaults& settings;
    DataManager& dataManager;

    // ---- Hot keys ----
    // From now on keys go to `pressed` instead of anywhere else: each key with the modifiers that are held, and
    // modifiers alone when they are let go without a key. Until endRecordingHotKey().
    std::function<void(std::function<void(const GeneralHotKey&)> pressed)> beginRecordingHotKey;
    std::function<void()> endRecordingHotKey;
    // Whether the desktop leaves this combination to Plume; the error says who has it.
    std::function<void(const GeneralHotKey&, std::function<void(const Result<void>&)> told)> tryHotKey;
    // What the key of this code is called: "K", "F5", "Return".
    std::function<std::u16string(KeyCode)> keyName;

    // ---- Programs ----
    ProgramServices programs;
    // The rows that Plume comes with: JSON as in data/applications.json.
    std::string builtInApplicationRows;

    // ---- The desktop ----
    std::function<bool()> startsAtLogin;
    std::function<Result<void>(bool starts)> setStartsAtLogin;
    std::vector<std::string> soundNames;
    std::function<void(const std::string& name)> playSound;

    // ---- Commands of the application ----
    std::function<void()> importFile;
    std::function<void()> exportLibrary;
    std::function<void()> restore;
    // To be called when the user has changed what synchronisation does.
    std::function<void()> syncSettingsChanged;
    std::function<void()> showDiagnostics;
    std::function<Result<void>()> forgetSnippetUses;
};

}  // namespace plume

// What the editor of the library needs of the program around it.
//
// Everything is called on the main thread and outlives the editor's window.
#pragma once

#include <filesystem>
#include <functional>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "app/editor/ChipFormServices.h"
#include "app/editor/ScriptRunPanel.h"
#include "app/preferences/ProgramServices.h"
#include "library/DataManager.h"
#include "platform/Files.h"
#include "platform/UserDefaults.h"

namespace plume {

struct EditorServices {
    DataManager& dataManager;
    WritableUserDefaults& settings;
    Files& files;
    // The groups and dictionaries that Plume comes with.
    std::filesystem::path resources;
    // What placeholders and their forms ask; `groups` and `inside` are the window's.
    ChipFormServices placeholders;
    // What runs scripts; `groups` and `readClipboard` are the window's.
    ScriptRunServices scripts;
    ProgramServices programs;
    // The keyboard layouts that the desktop has, with their names.
    std::function<std::vector<std::pair<std::u16string, QString>>()> inputSources;
    // Lets the user choose a file to import; not called when none was chosen.
    std::function<void(std::function<void(const std::filesystem::path&)> chosen)> askForFile;
    // See ImportWindow.
    std::function<void(std::function<void()> work, std::function<void()> done)> inBackground;
    // See PreviewPane.
    std::function<void(bool expands)> setExpandsInOwnWindows;
    std::function<void()> showPreferences;
    std::function<void()> quit;
};

}  // namespace plume

// What the icon's menu shows and does.
//
// Everything is called on the main thread and outlives the menu.
#pragma once

#include <cstdint>
#include <functional>
#include <memory>

#include "library/LibraryArchive.h"

namespace plume {

struct StatusMenuServices {
    // The library of now.
    std::function<const SnippetGroups&()> groups;
    // Types the snippet into the program that has the keyboard. Called when the menu is gone.
    std::function<void(const std::shared_ptr<Snippet>&)> sendSnippetDirectly;
    // In points, to be added to the usual height of a row and size of its font.
    std::function<std::int64_t()> fontSizeDelta;

    std::function<void()> toggleEnabled;
    std::function<void()> tryKeyboardAgain;
    std::function<void()> newSnippet;
    std::function<void()> makeSnippetFromClipboard;
    std::function<void()> makeSnippetFromSelection;
    std::function<void()> searchSnippets;    // empty: there is no such window, and no such row
    std::function<void()> showMacrosWindow;  // empty: likewise
    std::function<void()> showPreferences;
    std::function<void()> showReports;
    std::function<void()> showDecisions;
    std::function<void()> showDiagnostics;
    std::function<void()> importFile;
    std::function<void()> exportLibrary;
    std::function<void()> restore;
    std::function<void()> showWelcome;
    std::function<void()> showAbout;
    std::function<void()> quit;
};

}  // namespace plume

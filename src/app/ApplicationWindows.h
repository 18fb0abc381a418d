// The windows of the application, as its delegate asks for them.
//
// Owned by whoever puts the application together; belongs to the main thread. No operation waits for the user: answers
// come by the functions that are given. Each shows the window, or brings the one that is open to the front.
#pragma once

#include <filesystem>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "Foundation/Result.h"

namespace plume {

class Snippet;

class ApplicationWindows {
  public:
    enum class FileUse { Import, Restore, Nothing };
    using Path = std::filesystem::path;

    virtual ~ApplicationWindows() = default;

    virtual void showMacrosWindow(bool expandAll) = 0;
    // In the window of the library.
    virtual void showSnippet(const std::shared_ptr<Snippet>& snippet) = 0;
    // `content` is what the new snippet begins with.
    virtual void showNewSnippetWindow(const std::u16string& content) = 0;
    // `page` is the name of a settings page, empty for the one that was seen last.
    virtual void showPreferencesWindow(const std::string& page) = 0;
    virtual void showAboutWindow() = 0;
    virtual void showDiagnosticWindow(const std::u16string& report) = 0;
    // What was reported lately.
    virtual void showReportsWindow() = 0;
    // Why abbreviations did or did not expand lately.
    virtual void showDecisionsWindow() = 0;
    virtual void showWelcomeWindow() = 0;
    virtual void showRestoreWindow() = 0;
    // The desktop lacks what `missing` says. `closed` is called once, when the user has closed the window, also after
    // `checkAgain` has found that all is well.
    virtual void showPrompt(const Error& missing, std::function<Result<void>()> checkAgain,
                            std::function<void()> closed) = 0;
    // Whether the file is to be imported or to take the library's place.
    virtual void askForFileUse(const Path& file, std::function<void(FileUse)> answer) = 0;
    // Lets the user choose a file to open; not called when none was chosen.
    virtual void askForFile(std::function<void(const Path&)> chosen) = 0;
    // Lets the user choose where to write the library.
    virtual void askWhereToExport(std::function<void(const Path&)> chosen) = 0;
    // Which library is to be kept when synchronisation begins: see LibrarySync::ReturnCode.
    virtual void askForFirstSync(const std::string& folderName, std::function<void(int returnCode)> answer) = 0;
    // Tells that something was or was not done, in a dialog with one button.
    virtual void tell(const std::u16string& message, const std::u16string& details) = 0;

    virtual bool hasVisibleWindow() const = 0;
    // All that are open, minimised ones too.
    virtual void bringAllToFront() = 0;
    // What is edited is put into the library.
    virtual void commitEdits() = 0;
};

}  // namespace plume

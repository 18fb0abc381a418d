// What the windows and the icon ask of the running program.
//
// On the main thread; all that is referred to outlives it, and it outlives the windows.
#pragma once

#include <QCoreApplication>
#include <memory>

#include "app/AppDelegate.h"
#include "app/cli/Autostart.h"
#include "app/cli/BackgroundWork.h"
#include "app/cli/UserLibrary.h"
#include "app/editor/EditorServices.h"
#include "app/preferences/PreferencesServices.h"
#include "app/search/QuickSearchWindow.h"
#include "app/status/StatusMenuServices.h"
#include "app/windows/DecisionsWindow.h"
#include "app/windows/WelcomeServices.h"
#include "platform/Sounds.h"
#include "ports/posix/PosixProcessLauncher.h"

namespace plume {

class ApplicationServices {
    Q_DECLARE_TR_FUNCTIONS(ApplicationServices)
  public:
    struct Dependencies {
        AppDelegate& delegate;
        UserLibrary& library;
        SnippetUses& uses;
        Files& files;
        Sounds& sounds;
        RunLoop& mainLoop;
    };

    explicit ApplicationServices(Dependencies dependencies)
        : around_(dependencies),
          autostart_(dependencies.files),
          trials_(dependencies.mainLoop),
          imports_(dependencies.mainLoop) {}

    StatusMenuServices statusMenu() const;
    ProgramServices programs() const;
    PreferencesServices preferences();
    DecisionsWindow::Services decisions() const;
    WelcomeServices welcome();
    QuickSearchServices quickSearch();
    EditorServices editor();

  private:
    ScriptRunServices scripts();
    Result<std::string> importFound(const std::filesystem::path& path);

    const Dependencies around_;
    Autostart autostart_;
    PosixProcessLauncher trialLauncher_;
    // A script that is tried may take long, and nothing else is to wait for it.
    BackgroundWork trials_;
    BackgroundWork imports_;
};

}  // namespace plume

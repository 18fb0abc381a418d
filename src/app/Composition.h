// Puts the program together: from a platform's ports, the settings and a library to an engine that expands.
//
// Owned by whoever runs the program (the command line, the scenario player). Everything belongs to the tap thread,
// where it is made and destroyed too, except for report and log, which may be called from any thread. The loops run no
// more calls once it is being destroyed.
#pragma once

#include <functional>
#include <memory>
#include <string>

#include "app/HotKeyDispatch.h"
#include "content/SnippetParser.h"
#include "content/scripts/ShellScriptRunner.h"
#include "engine/AutoText.h"
#include "input/BundleIdentifierResolver.h"
#include "input/MacInputService.h"
#include "platform/Notices.h"
#include "platform/ProcessLauncher.h"
#include "platform/Sounds.h"
#include "platform/UserDefaults.h"

namespace plume {

class Composition {
  public:
    // A platform's ports. Nothing is owned; all of it outlives the composition.
    struct Ports {
        KeyboardTap& keyboardTap;
        MouseTap& mouseTap;
        EventPoster& poster;
        Pasteboard& pasteboard;
        ProcessManager& processManager;
        InputSources& inputSources;
        Accessibility& accessibility;
        SecureInput& secureInput;
        SystemHotKeys& systemHotKeys;
        Sounds& sounds;
        Notices& notices;
        ProcessLauncher& processLauncher;
        RunLoop& tapLoop;
        RunLoop& mainLoop;  // may be the same loop as tapLoop
    };

    // What the program around it gives; what is empty or null is done without.
    struct Environment {
        // Outlives the composition.
        const UserDefaults& settings;
        // Tells the user, in one sentence. Never empty.
        std::function<void(const std::string&)> report;
        // Writes one line to the log. Never empty.
        std::function<void(const std::string&)> log;
        // Where dates are written: see ContentEnvironment.
        std::string timeZone = {};
        std::string locale = {};
        // Windows. Without a form or a list the user is told that one is needed, and nothing is expanded.
        FieldsEditor::Factory makeFieldsEditor = {};
        std::function<std::unique_ptr<SuggestionController>()> makeSuggestionController = {};
        std::function<std::unique_ptr<QuickSearchController>()> makeQuickSearchController = {};
        VMHelperController* vmHelper = nullptr;
        // How the platform's applications are typed to; null: as the built-in table says.
        std::shared_ptr<const ApplicationTable> applications = {};
        // The switch hot key has enabled or disabled the engine.
        std::function<void(bool enabled)> enabledChanged = {};
        // A snippet has been sent.
        std::function<void(const Snippet& snippet)> snippetUsed = {};
        // A hot key asks for a window. Empty: there are none, and these keys pass.
        std::function<void(HotKeyForWindow hotKey)> hotKeyForWindow = {};
    };

    Composition(const Ports& ports, Environment environment);
    // Ends scripts that run.
    ~Composition();
    Composition(const Composition&) = delete;
    Composition& operator=(const Composition&) = delete;

    void setSnippetGroups(AutoText::Groups groups) { engine_->setSnippetGroups(std::move(groups)); }
    // Gives every setting to whom it concerns; again whenever settings have changed.
    void loadPreferences();
    // In place of those before.
    void registerHotKeys();
    void unregisterHotKeys() { hotKeys_->unregisterHotKeys(); }
    // Hot keys, then keys: from now on the user is heard.
    void start();
    void stop();

    AutoText& engine() { return *engine_; }
    MacInputService& inputService() { return *inputService_; }
    SnippetParser& parser() { return *parser_; }

  private:
    void makeParts();
    HotKeyDispatch::Actions hotKeyActions();
    void checkConflicts();

    const Ports ports_;
    const Environment environment_;
    BundleIdentifierResolver identifiers_;
    ShellScriptRunner scriptRunner_;
    std::unique_ptr<MacInputService> inputService_;
    std::unique_ptr<SnippetParser> parser_;
    std::unique_ptr<AutoText> engine_;
    std::unique_ptr<HotKeyDispatch> hotKeys_;
};

}  // namespace plume

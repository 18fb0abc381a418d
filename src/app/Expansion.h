// The thread that hears the keys, as the main thread sees it: what is to hold there is sent, what happens there is
// told.
//
// Owned by whoever runs the program, who also runs both loops; they may be one. Everything here belongs to the main
// thread unless it says otherwise. Nothing waits, and what is sent takes effect in the order in which it was sent, at
// the next key. Made before the tap loop runs or on its thread; end() comes before that loop ends, and the object goes
// when neither loop runs any more.
#pragma once

#include <cstddef>
#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "Foundation/Uuid.h"
#include "app/Composition.h"
#include "app/FormBridge.h"
#include "app/QuickSearchBridge.h"
#include "app/SuggestionBridge.h"
#include "library/LibraryFeed.h"
#include "library/MemoryUserDefaults.h"

namespace plume {

// Told on the main thread.
class ExpansionListener {
  public:
    virtual ~ExpansionListener() = default;
    // By a hot key.
    virtual void enabledChanged(bool enabled) = 0;
    virtual void snippetUsed(const Uuid& snippet) = 0;
    virtual void hotKeyPressed(HotKeyForWindow hotKey) = 0;
    virtual void secureInputChanged() = 0;
    // The keyboard is not listened to any more until tryTapAgain(), or a minute later.
    virtual void keyboardTapGivenUp() = 0;
    // One sentence for the user.
    virtual void reported(const std::string& sentence) = 0;
};

class Expansion {
  public:
    struct Dependencies {
        Composition::Ports ports;
        std::shared_ptr<const ApplicationTable> applications;  // null: as the built-in table says
        // Writes one line to the log; from any thread.
        std::function<void(const std::string& line)> log;
        // Told of everything; outlives both loops.
        ExpansionListener& listener;
        // Whether there are windows for the hot keys that ask for one.
        bool hasWindows = false;
        // The windows of the lists, which outlive both loops: called on the main thread. Empty: there are none.
        std::function<SuggestionView&()> suggestionView = {};
        std::function<QuickSearchView&()> quickSearchView = {};
        // The forms, in the same way.
        std::function<FormView&()> formView = {};
    };

    // Names a snippet by where it stands in the library that was sent last.
    struct SnippetPlace {
        std::size_t group = 0;
        std::size_t item = 0;
    };

    // What the thread knows of the desktop.
    struct Findings {
        bool evenTapCreated = false;
        std::optional<RunningApplication> foregroundProgram;
        std::vector<RunningApplication> tappingProcesses;
    };

    explicit Expansion(Dependencies dependencies);
    ~Expansion();
    Expansion(const Expansion&) = delete;
    Expansion& operator=(const Expansion&) = delete;

    // ---- From start to end ----
    // Makes the engine with this library and these settings; nothing is heard yet.
    void begin(std::optional<LibraryUpdate> library, PropertyList::Dictionary settings);
    // Registers the hot keys, looks for conflicts, and hears the user from now on.
    void start();
    // Nothing is heard any more, and scripts are ended.
    void end();

    // ---- What holds ----
    void setLibrary(LibraryUpdate update);
    // Every setting that has a value. Hot keys are registered anew.
    void loadPreferences(PropertyList::Dictionary settings);
    void setEnabled(bool enabled);
    void enableEvents();
    // What was typed is forgotten: nobody hears what happens to the keyboard until enableEvents().
    void disableEvents();
    void tryTapAgain();
    // While the user tries snippets in a window of Plume's own.
    void setExpandsInOwnWindows(bool expands);

    // ---- What is to be done now ----
    // Into the program that has the keyboard.
    void sendSnippetDirectly(SnippetPlace place);
    // Has the program in front copy what is selected.
    void sendCopyCommand();
    void undo();
    void expandAtHotkey();
    void suggestAbbreviations();
    void quickSearch();
    void quickSearchAtTopRightCorner();
    // What was chosen in the quick-search window, which is gone: into the program that had the keyboard before.
    // Nothing when it is not in the library any more.
    void sendFoundSnippet(std::optional<SnippetPlace> place);
    // What the window shows first now.
    void setFoundSnippets(std::vector<std::optional<SnippetPlace>> places);

    // ---- Hot keys to be chosen ----
    // Keys go to `pressed` and nowhere else; modifiers alone when they are let go without a key.
    void beginRecordingHotKey(std::function<void(const GeneralHotKey&)> pressed);
    void endRecordingHotKey();
    // Whether the desktop leaves the combination to Plume; the error says what is in the way.
    void tryHotKey(const GeneralHotKey& hotKey, std::function<void(const Result<void>&)> told);

    // ---- Questions ----
    void examine(std::function<void(const Findings&)> told);
    // The text on the clipboard; nothing when there is none.
    void readClipboard(std::function<void(const std::optional<std::u16string>&)> told);
    void runningPrograms(std::function<void(const std::vector<RunningApplication>&)> told);
    // The next program besides Plume that is in front within 20 seconds; nothing when none is.
    void nextFrontProgram(std::function<void(const std::optional<RunningApplication>&)> told);
    // The newest last.
    void recentDecisions(std::function<void(std::vector<MatchDecision>)> told);
    // What the key of this code is called in the present layout; a number when it has no name.
    std::u16string keyName(KeyCode key) const;
    // The tap thread's own, with everything that was sent before done; for what is told by values alone.
    void ask(std::function<void(AutoText& engine)> question);

    // ---- What is known here ----
    // A program holds the keyboard just now, or a password field has it.
    bool keyboardIsHeld() const { return around_.ports.secureInput.isSecureEventInputEnabled(); }
    // The same as it was when somebody looked last, every three seconds and at keys.
    bool secureInput() const;
    // The name of the program in front when secure input began; nothing when it is not known or secure input is off.
    std::optional<std::u16string> lastAppEnabledSecureInput() const;
    // Before anything is begun, too.
    Result<void> testFunction() const { return around_.ports.keyboardTap.check(); }

  private:
    // Everything of the thread that hears the keys.
    struct TapSide {
        MemoryUserDefaults settings;
        FedLibrary library;
        std::unique_ptr<Composition> composition;
        QuickSearchBridge* quickSearch = nullptr;  // the engine's; null before it is first needed
        FormView::Id newestForm = 0;
        Subscription searchKeys;
        Subscription searchShortcuts;
        Timer frontWait;
    };
    using WhenFront = std::function<void(const std::optional<RunningApplication>&)>;

    Composition::Environment environment();
    void addLists(Composition::Environment& environment);
    std::unique_ptr<FieldsEditor> makeForm(std::shared_ptr<SnippetExpandedContent> content,
                                           FieldsEditor::Target& target);
    std::unique_ptr<QuickSearchController> makeQuickSearch();
    std::u16string typedQuery() const;
    void make(LibraryUpdate* library, const PropertyList::Dictionary& settings);
    // Calls on the tap thread, where the composition exists.
    void onTap(std::function<void(Composition&)> call);
    void tellKeyNames(const MacInputService& service);
    void onMain(std::function<void()> call) { around_.ports.mainLoop.perform(std::move(call)); }
    void observe(MacInputService& service);
    void waitForFront(const WhenFront& told, int attemptsLeft);
    void secureInputChanged(MacInputService& service);
    void keyboardTapGivenUp(KeyboardTapGivenUp& event);

    const Dependencies around_;
    TapSide tap_;
    MacInputService* service_ = nullptr;  // of the tap thread, with parts that the main thread may use
    std::map<KeyCode, std::u16string> keyNames_;
    Subscription secureInputObserver_;
    Subscription givenUpObserver_;
};

}  // namespace plume

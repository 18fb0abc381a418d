// Hears every key of the session before any program does, tells the engine, the hot keys' owner and others about it,
// swallows what they decide to swallow, and delivers output.
//
// Owned by the composition root, which also owns the tap thread and runs its loop. Everything belongs to the tap thread
// unless it says otherwise. The service is destroyed when neither loop runs calls any more. Nothing fails to its
// listeners: what goes wrong is logged in one sentence, without anything that was typed.
#pragma once

#include <atomic>
#include <cstdint>
#include <deque>
#include <functional>
#include <limits>
#include <memory>
#include <optional>
#include <string>
#include <thread>
#include <vector>

#include "Foundation/ZDEvent.h"
#include "content/PLOutput.h"
#include "input/AclExport.h"
#include "input/EventArgs.h"
#include "input/HotKeyTable.h"
#include "input/SRKeyCodeTransformer.h"
#include "input/SecureInputWatch.h"
#include "input/UserKeysHold.h"
#include "input/delivery/OutputDelivery.h"
#include "input/delivery/VMHelperController.h"
#include "platform/KeyboardTap.h"
#include "platform/MouseTap.h"
#include "platform/ProcessManager.h"
#include "platform/RunLoop.h"
#include "platform/SystemHotKeys.h"

namespace plume {

class MacInputService;

// The keyboard went to another program, or a shortcut may have changed the text.
struct InputContextChange {};

// The tap was lost three times within a minute; it is tried again after another one, or when somebody asks for it.
struct KeyboardTapGivenUp {};

class MacInputService final : private KeyboardTapListener {
  public:
    // Nothing is owned; all of it outlives the service. `log` is called on either thread.
    struct Dependencies {
        KeyboardTap& keyboardTap;
        MouseTap& mouseTap;
        EventPoster& poster;
        Pasteboard& pasteboard;
        ProcessManager& processManager;
        InputSources& inputSources;
        Accessibility& accessibility;
        SecureInput& secureInput;
        SystemHotKeys& systemHotKeys;
        BundleIdentifierResolver& bundleIdentifierResolver;
        RunLoop& tapLoop;
        RunLoop& mainLoop;  // may be the same loop as tapLoop
        std::function<void(const std::string&)> log;
        VMHelperController* vmHelper = nullptr;  // null: no window
    };

    explicit MacInputService(Dependencies dependencies);
    ~MacInputService() override;
    MacInputService(const MacInputService&) = delete;
    MacInputService& operator=(const MacInputService&) = delete;

    // Raised on the tap thread, inside the callback that decides about the key: `cancel` swallows it.
    ZDEvent<ZDKeyEventArgs> keyDownEvent;
    ZDEvent<ZDUnregisteredHotKeyPressedEventArgs> unregisteredHotKeyPressedEvent;
    ZDEvent<ZDHotKeysPressedEventArgs> hotKeysPressed;
    // Raised on the tap thread.
    ZDEvent<InputContextChange> inputContextChangedEvent;
    ZDEvent<ZDMouseEventArgs> mouseDownEvent;
    // Raised on the main thread, where observers register before enableEvents(); nobody's answer is waited for.
    ZDEvent<ZDKeyEventArgs> keyUpEvent;
    // Raised on the main thread, where observers register.
    ZDEvent<MacInputService> secureInputChangedEvent;
    ZDEvent<KeyboardTapGivenUp> keyboardTapGivenUpEvent;

    // From any thread: start and stop hearing keys, as soon as the tap thread can (at once on it). A tap that cannot be
    // created is logged, and nothing is heard.
    void enableEvents();
    void disableEvents();
    // From any thread: the tap that was given up is tried again now. Nothing where none was.
    void tryTapAgain();
    // Whether the keyboard tap exists.
    bool evenTapCreated() const { return around_.keyboardTap.exists(); }
    // From any thread: whether a keyboard tap could be created at all, and what is in the way.
    Result<void> testFunction() const { return around_.keyboardTap.check(); }

    // At once when the service is active.
    void setListenMouseDownEvents(bool listen);
    // From the next start on.
    void setListenAtAnnotatedSession(bool annotated) { resolver_.listenAtAnnotatedSession = annotated; }

    void registerHotKey(const GeneralHotKey& hotKey) { hotKeys_.registerHotKey(hotKey); }
    void unregisterHotKey(const GeneralHotKey& hotKey) { hotKeys_.unregisterHotKey(hotKey); }
    // The release of the modifiers held now is no hot key.
    void ignoreNextHotKey() { hotKeys_.ignoreNextHotKey(); }
    // While there is a recorder, it gets what is pressed as a hot key would be: each key with the modifiers that are
    // held, modifiers alone when they are let go without one. Nobody else hears of these keys. Empty ends it.
    void setHotKeyRecorder(std::function<void(const GeneralHotKey&)> recorder);
    // Whether to swallow the key; KeyCode::None checks the held modifiers alone.
    bool checkHotKeys(KeyCode keyCode) { return hotKeys_.checkHotKeys(keyCode); }
    // A hot key that the system recognises, in place of the previous one under this id; one without a key is none. The
    // error says what is in the way.
    Result<void> registerSystemHotKey(SystemHotKeys::Id id, const GeneralHotKey& hotKey, std::function<void()> pressed);

    // The user's settings of delivery, in force from the next output on.
    DeliveryPreferences& preferences() { return resolver_.preferences; }
    // Seconds from the end of a pasted output to the restore of the clipboard.
    void setRestoreClipboardDelay(double seconds);
    // Replaces or adds the setting of one application.
    void setCustomApplicationSetting(const std::u16string& bundleIdentifier,
                                     std::shared_ptr<const ContextInputSetting> setting);

    // A platform's own table of applications, and the user's rows: see ContextInputSettings.
    void setApplicationTable(std::shared_ptr<const ApplicationTable> table);
    Result<void> setOwnApplicationRows(std::string_view text, const std::string& fileName);

    // State from any thread; the name on the main thread, nothing when it is not known or secure input is off.
    bool secureInput() const { return secureInputWatch_.state(); }
    const std::optional<std::u16string>& lastAppEnabledSecureInput() const {
        return secureInputWatch_.lastAppEnabledSecureInput();
    }
    // Main thread.
    void checkSecureInput() { secureInputWatch_.checkSecureInput(); }
    // Main thread, before the service is destroyed on the other one.
    void stopCheckingSecureInput() { secureInputWatch_.stop(); }

    // Other programs that can swallow keys.
    std::vector<RunningApplication> tappingProcesses() const;

    // Presses what copies in the application in front.
    void sendCopyCommand();
    // Copies the rows of the list in the application in front, from the selected row down, until a row repeats.
    void exportACLs();

    // What the user has on the clipboard, also while an expansion stands there.
    const PasteboardReader& userPasteboard() const { return userPasteboard_; }
    const SRKeyCodeTransformer& keyCodeTransformer() const { return keyCodeTransformer_; }
    // Every output has been delivered.
    bool isIdle() const { return delivery_.isIdle(); }

    // The modifiers held now.
    KeyModifiers keyModifier() const { return hotKeys_.keyModifier(); }
    // The last key went to Plume itself, where nothing is to expand.
    bool isSameProcess() const;
    // From any thread: whether Plume's own windows count as another program's for now, so that one can try it there.
    void setExpandsInOwnWindows(bool expands) { expandsInOwnWindows_ = expands; }
    ProcessSerialNumber lastProcessReceivedKeyEvent() const { return lastProcessReceivedKeyEvent_; }
    // What a key code produces with the modifiers of these event flags.
    std::optional<std::u16string> stringForKeyCode(KeyCode keyCode, EventFlags flags) const;
    // What the last key produced; nothing when it produced nothing.
    const std::optional<std::u16string>& lastKeyString() const { return lastKeyString_; }
    // The program has got it, and did so before anybody was asked.
    bool lastKeyIsDelivered() const { return lastKeyDelivered_; }

    // The application in front when its setting was last resolved, and resolving it anew; the setting is never null.
    const std::optional<std::u16string>& contextBundleIdentifier() const;
    std::shared_ptr<const ContextInputSetting> refreshContextInputSetting();
    // Erases and delivers. From any thread: at once on the tap thread, where `cancelTrigger` and the content's suffix
    // are decided when it returns, otherwise as soon as that one can.
    void sendOutput(std::shared_ptr<PLOutput> output);
    // The user's keys from now on wait until the hold is gone, these seconds at most.
    std::unique_ptr<UserKeysHold> holdUserKeys(double seconds) {
        return std::make_unique<UserKeysHold>(delivery_, around_.tapLoop, seconds);
    }
    void bringLastProcessToFront();

    // The tap thread's.
    RunLoop& runLoop() { return around_.tapLoop; }

  private:
    bool keyboardEvent(const TapEvent& event) override;
    void tapDisabledByTimeout() override;
    void tapDisabledByUserInput() override;
    void typingInterrupted() override;

    void onTapThread(std::function<void()> call);
    void enableEventsInternal();
    void disableEventsInternal();
    void enableMouseEventTap();

    void mouseDown(Point location);
    void forgetLastKey();
    void keyDelivered(const TapEvent& event);
    bool keyDown(ZDKeyEventArgs& key, const TapEvent& event);
    bool keyUp(const ZDKeyEventArgs& key);
    bool record(const TapEvent& event);
    bool unregisteredHotKey(const ZDKeyEventArgs& key);
    void followFrontProcess();
    void raiseInputContextChanged();
    void readKey(const TapEvent& event, ZDKeyEventArgs& key) const;
    void layoutChanged();

    Dependencies around_;
    HotKeyTable hotKeys_;
    SRKeyCodeTransformer keyCodeTransformer_;
    ContextInputResolver resolver_;
    OutputDelivery delivery_;
    AclExport aclExport_;
    UserPasteboard userPasteboard_;
    SecureInputWatch secureInputWatch_;

    std::atomic<std::thread::id> eventTapThread_;
    std::atomic<bool> keyUpObserved_ = false;
    std::atomic<bool> expandsInOwnWindows_ = false;
    std::function<void(const GeneralHotKey&)> hotKeyRecorder_;
    KeyModifiers recordedModifiers_;  // held since a key was recorded: none
    bool active_ = false;
    bool listenMouseDownEvents_ = false;
    std::optional<KeyCode> lastKeyCode_;
    std::optional<std::u16string> lastKeyString_;
    bool lastKeyDelivered_ = false;
    KeyCode canceledKeyCode_ = KeyCode::None;  // its key down was swallowed, its key up will be
    ProcessSerialNumber lastProcessReceivedKeyEvent_;
    std::uint32_t lastWindowReceivedKeyEvent_ = 0;
    bool isLastProcessReceivedKeyEventNull_ = true;
    std::deque<double> timeouts_;  // when the tap was lost, within the last minute
    Timer nextTry_;                // set while the tap is given up
};

}  // namespace plume

// What the focused program tells of its user interface, by AT-SPI.
//
// Programs may be slow or hang, so none is ever asked on a caller's thread: a thread of its own asks them. A caller
// waits for an answer for 15 ms at most, and after an answer that did not come nobody waits for another one for a
// second.
//
// No program is asked to tell of its focus by itself, which would slow down every key that it gets. Whoever owns this
// object says when the focus may be elsewhere: which program is in front, that somebody clicks, that somebody types.
#pragma once

#include <sys/types.h>

#include <atomic>
#include <memory>
#include <string_view>

#include "platform/Accessibility.h"
#include "ports/dbus/BusThread.h"

namespace plume {

class AtspiSession;

enum class AccessibilityStatus {
    Starting,
    Working,
    // Works, but only with those programs that always tell of their user interface.
    SwitchedOff,
    NotInstalled,  // the session cannot start its accessibility bus
    NoSession,     // no D-Bus session at all
    Failed,        // the accessibility bus is there and cannot be used
};

// In English: what is the matter and what to do about it.
std::string_view sentenceOf(AccessibilityStatus status);

// What a user did that may move the focus.
enum class FocusMover { Tab, Return, Click };

class AtspiAccessibility final : public Accessibility {
  public:
    // Returns at once; until the accessibility bus is found everything answers nothing.
    AtspiAccessibility();
    // Waits for its thread a few hundredths of a second at most; a thread that hangs in a program is left behind.
    ~AtspiAccessibility() override;
    AtspiAccessibility(const AtspiAccessibility&) = delete;
    AtspiAccessibility& operator=(const AtspiAccessibility&) = delete;

    // The program in front, when something of it is known to have the focus. Never waits; its elements' attributes do,
    // and its AXFocusedUIElement is what has the focus when it is asked for. An element belongs to the thread that it
    // was made for.
    std::shared_ptr<UIElement> frontApplicationElement() const override;
    void askForFocusedPlaces(std::function<void(const FocusedPlaces&)> told) const override;
    double mainScreenHeight() const override { return screenHeight_; }
    // In the pixels in which programs tell of their places. From any thread.
    void setMainScreenHeight(double height) { screenHeight_ = height; }

    // ---- What happens on the desktop. From any thread, never waiting. ----
    // The process of the program in front; 0 when it is not known. When it is another one than before, the focus is
    // forgotten at once, and then looked for.
    void setFrontProcess(pid_t process);
    // After a click, a Tab, or a change of windows: looks for the focus a few times within a second.
    void focusMayHaveMoved();
    // At every key: looks for the focus when it was not looked for lately, and once more when nobody types any longer.
    // Costs a look at the clock otherwise.
    void userTypes();

    // Whether a password is typed into what has the focus. From any thread, never waits.
    bool focusIsPassword() const;
    // The same, for a key that is typed now: the first one in a program that has just come to the front waits until the
    // program was asked, 50 ms at most, and one behind userMovesFocus() until 50 ms after it. On the tap thread.
    bool focusIsPasswordForKey();
    // After a Tab, a Return or a click of the user, which the program in front gets now: as focusMayHaveMoved(), and
    // the next key waits for where the focus went, if that program tells of its focus at all. On the tap thread.
    void userMovesFocus(FocusMover mover);
    // Whether the program in front has moved the focus by itself, from one field of a line to another, since this was
    // asked last. On the tap thread.
    bool takeOwnMove();
    // The process that has the focus, by the bus's account; 0 when it is not known. From any thread, never waits.
    pid_t focusedProcess() const;
    // From any thread, never waits.
    AccessibilityStatus status() const;

    // Switches the desktop's accessibility on, as its own settings do: it stays so. From any thread, never waiting; the
    // status tells in the end whether it worked. Chromium looks at it only when it starts.
    void switchOn();

  private:
    std::atomic<double> screenHeight_ = 0;
    BusThread<AtspiSession> thread_;
};

}  // namespace plume

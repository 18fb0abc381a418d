// Follows the focus from program to program by what they tell of themselves. Belongs to the accessibility thread.
#pragma once

#include <sys/types.h>

#include <array>
#include <chrono>
#include <deque>
#include <memory>

#include "platform/desktop/AtspiFocus.h"
#include "platform/desktop/AtspiQueue.h"

namespace plume {

class AtspiFocusTracker {
  public:
    AtspiFocusTracker(AtspiQueue& queue, AtspiFocus& focus) : queue_(queue), focus_(focus) {}
    ~AtspiFocusTracker();
    AtspiFocusTracker(const AtspiFocusTracker&) = delete;
    AtspiFocusTracker& operator=(const AtspiFocusTracker&) = delete;

    // Whether libatspi tells of the focus from now on.
    bool start();
    // libatspi gives each program a connection of its own, in GLib's default main context; they are brought here.
    void adoptConnections() const;

  private:
    enum class Kind { FocusGained, FocusLost, WindowActivated, WindowLeft };
    struct Event {
        Kind kind;
        AtspiPart source;
    };
    // libatspi's own calls, run inside of ours while those wait for a program: they only take notes.
    static void heard(AtspiEvent* event, void* tracker);
    void note(Kind kind, AtspiAccessible* source);
    void handleNoted();
    void handle(const Event& event);

    void gained(const AtspiPart& part);
    void considerAgain(const AtspiPart& part);
    void considerCandidate(int looks);
    void windowActivated(const AtspiPart& window);
    void windowLeft(const AtspiPart& window);
    void setFocus(const AtspiPart& part);
    void clearFocus();
    static bool isInActiveWindow(const AtspiPart& part);

    // For programs that told of their focus before anybody listened, or do not tell again.
    void findFocus();
    void lookForFocusIn(const AtspiPart& window, int looks);
    void findFocusIn(const AtspiPart& window);
    AtspiPart focusedBelow(const AtspiPart& part, int depth, int& left) const;
    AtspiPart child(const AtspiPart& part, int index) const;

    // A program that ends need not tell that its focus has gone.
    void watch(pid_t process);
    void stopWatching();

    AtspiQueue& queue_;
    AtspiFocus& focus_;
    std::array<AtspiEventListener*, 5> listeners_{};
    std::deque<Event> noted_;
    AtspiPart activeWindow_;
    AtspiPart candidate_;  // said to have the focus, and to be looked at again
    AtspiPart previous_;   // what had the focus before that window
    pid_t watched_ = 0;
    int watchedDescriptor_ = -1;
    GSource* watch_ = nullptr;
};

}  // namespace plume

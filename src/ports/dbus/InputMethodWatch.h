// Follows the input method of the desktop (IBus or Fcitx): which engine of it turns keys into text, and
// into what.
//
// Heard on a thread of its own, which waits for the input method to come, and to come back. Without a session's bus, or
// without an input method, nothing is ever told.
#pragma once

#include <functional>
#include <string>

#include "platform/InputMethod.h"
#include "platform/RunLoop.h"
#include "ports/dbus/BusThread.h"

namespace plume {

class InputMethodSession;

class InputMethodWatch {
  public:
    // Told on the loop's thread, at every change: the engine, such as "ibus:libpinyin" or "fcitx:pinyin"; empty when
    // there is none, or one that only stands for a keyboard layout.
    using EngineListener = std::function<void(const std::string& identifier)>;

    // Called on the loop's thread when there is something to take from the input method.
    using Happened = std::function<void()>;

    // Of this display, such as ":0". The loop outlives it.
    InputMethodWatch(const std::string& display, RunLoop& loop, EngineListener engineChanged, Happened happened);
    ~InputMethodWatch();

    // As long as the watch.
    InputMethod& inputMethod();

  private:
    BusThread<InputMethodSession> thread_;
};

}  // namespace plume

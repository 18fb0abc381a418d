#pragma once

#include <filesystem>
#include <initializer_list>
#include <map>
#include <string_view>
#include <vector>

#include "testing/rig/InputTestSocket.h"
#include "testing/rig/XServer.h"

namespace plume::rig {

// Keys that print nothing, by their X keycode on a PC keyboard.
enum class Key {
    Escape = 9,
    Backspace = 22,
    Tab = 23,
    Return = 36,
    LeftControl = 37,
    LeftShift = 50,
    LeftAlt = 64,
    CapsLock = 66,
    F2 = 68,
    F3 = 69,
    AltGr = 108,
    Home = 110,
    Up = 111,
    Left = 113,
    Right = 114,
    End = 115,
    Down = 116,
    Insert = 118,
    Delete = 119,
    LeftSuper = 133,
};

// The keyboard a test types on: to the X server a device like any other, not our own synthesiser. It knows which keys
// print a character in the layout that the server was started with. Nothing here waits unless it says so.
class TestKeyboard {
  public:
    TestKeyboard(const std::filesystem::path& socket, const XServer::Options& layout);  // throws RigError

    void press(Key key) { press(static_cast<int>(key)); }
    void release(Key key) { release(static_cast<int>(key)); }
    void tap(Key key);
    void press(int keycode);
    void release(int keycode);

    // Holds the modifiers while the key is tapped.
    void chord(std::initializer_list<Key> modifiers, Key key);
    void chord(std::initializer_list<Key> modifiers, char32_t character);

    // Types UTF-8 text with Shift and AltGr where the layout asks for them, and waits until the server has taken the
    // keys. Throws RigError, before the first key, for a character that is not on the layout.
    void type(std::string_view text);

    // The same, as a fast typist does it: each key goes down before the one before it comes up, and waits for the gap.
    void typeRollingOver(std::string_view text, Milliseconds gap = Milliseconds(0));

    // Releases all keys that are still down.
    void releaseAll();

    // The key that prints a character, without regard to modifiers.
    int keycodeOf(char32_t character) const { return strokeOf(character).keycode; }

    void sync() { socket_.sync(); }

  private:
    struct Stroke {
        int keycode = 0;
        bool shift = false;
        bool altGr = false;
    };

    const Stroke& strokeOf(char32_t character) const;
    std::vector<Stroke> strokesOf(std::string_view text) const;
    void holdModifiersOf(const Stroke& stroke);
    void hold(Key key, bool down);

    InputTestSocket socket_;
    std::map<char32_t, Stroke> strokes_;
    std::vector<int> down_;
};

}  // namespace plume::rig

// How output is delivered into one application.
//
// A plain record. The built-in table names the applications that need something special; others can be added to it.
// Settings in the table are never changed in place: the resolver hands out copies of table entries.
// The families found by the start or the end of an identifier are shared records, and what delivery sets in one of them
// stays set.
#pragma once

#include <cstdint>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/Flags.h"
#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"
#include "Foundation/Result.h"
#include "input/delivery/StepCounts.h"

namespace plume {

enum class InputFlag : std::uint16_t {
    DisableCapitalization = 0x0001,
    UseClipboard = 0x0002,              // paste texts instead of typing them
    UseClipboardIfHasNewLine = 0x0004,  // the same, for contents with a line feed
    DoNotRestoreClipboard = 0x0008,     // neither back up nor restore the clipboard
    AlternativePasting = 0x0010,        // press the paste modifier as a key of its own
    UseVMHelper = 0x0020,               // paste by way of the helper window for virtual machines
    ClickAtVMHelper = 0x0040,           // show that window under the pointer and click it first
    ClickAtVM = 0x0080,                 // click at the pointer once the target is active again
    DeleteAfterActivateVM = 0x0100,     // send the backspaces only then
    Reactivate = 0x0200,                // activate Plume, then the target again, before pasting
    DoNotSetModifier = 0x0400,          // in alternative pasting: no modifier flags on the V key
    DelayPasting = 0x0800,              // wait pastingDelay before the paste keystroke
    PostToSessionEventTap = 0x1000,     // post past the tap
    UseControlKey = 0x2000,             // paste and copy with Control
    IncludeHTMLData = 0x4000,           // offer rich content as HTML too
    ExcludeParagraphTag = 0x8000,       // and that without paragraph elements
};

using InputFlags = Flags<InputFlag>;

constexpr InputFlags operator|(InputFlag a, InputFlag b) {
    return InputFlags(a) | b;
}

// A key with modifiers, named as a shortcut is: by what it types, or by its code where it types nothing.
struct Keystroke {
    char16_t letter = 0;              // a small letter, or other ASCII; without modifiers it is typed
    KeyCode keyCode = KeyCode::None;  // counts where there is no letter
    EventFlags flags = {};

    bool operator==(const Keystroke&) const = default;
};

// Pressed one after the other.
using Keystrokes = std::vector<Keystroke>;

struct ContextInputSetting {
    std::optional<std::u16string> bundleIdentifier;  // of the application it was resolved for
    InputFlags flags;
    double pastingDelay = 0;        // seconds
    double afterPastingDelay = 0;   // seconds
    std::uint64_t blockLength = 0;  // units in a typed chunk; 0 means 20

    // What pastes and copies. Nothing: V and C with Command, or as the flags say. Empty: no key does, and everything is
    // typed.
    std::optional<Keystrokes> pasteKeys = {};
    std::optional<Keystrokes> copyKeys = {};
    bool pastesPrimary = false;  // those keys paste what is selected, not what was copied
    // What has to pass behind Backspace, arrows and other keys before typed text may follow, in seconds: for programs
    // that do what keys say later than they insert text. A paste may follow at once.
    double afterErasingDelay = 0;
    // The program proposes the rest of a word as selected text, which the first Backspace would remove alone.
    bool overtypesCompletion = false;
    // The program takes a key that is pressed twice at once for pressed once, unless another one is pressed in between.
    bool losesRepeatedKeys = false;
    bool typesBeyondBmp = true;  // characters beyond U+FFFF can be typed
    ErasedAtOnce erasesAtOnce = ErasedAtOnce::Character;
    std::uint64_t longestTyped = 0;  // units; longer texts are pasted; 0 means no limit

    bool has(InputFlag flag) const { return flags.contains(flag); }
    bool canPaste() const { return !pasteKeys || !pasteKeys->empty(); }

    // Everything but the identifier, which belongs to a resolution.
    std::shared_ptr<ContextInputSetting> copy() const;
};

class ApplicationTable;
class ApplicationRows;

// Settings by bundle identifier, with the families of identifiers.
class ContextInputSettings {
  public:
    // With the built-in applications.
    ContextInputSettings();

    // A platform's own table, which replaces the built-in applications and families. Not null.
    void setTable(std::shared_ptr<const ApplicationTable> table);
    // The user's rows, a JSON object in the form of that table's; they come before everything else. Those that there
    // were before are gone. An empty text is none. The error names `fileName`, the place and what was expected.
    Result<void> setOwnRows(std::string_view text, const std::string& fileName);

    // Replaces or adds one application.
    void set(const std::u16string& bundleIdentifier, std::shared_ptr<const ContextInputSetting> setting);

    // The setting for an application: a copy of its entry, the shared record of its family, or a fresh one with nothing
    // set but what the platform's table says of all others. Its bundleIdentifier is the one asked for. Never null;
    // `isKnown` is set to whether there was an entry or family.
    std::shared_ptr<ContextInputSetting> resolve(const std::optional<std::u16string>& bundleIdentifier, bool& isKnown);

  private:
    std::shared_ptr<ContextInputSetting> familyOf(std::u16string_view bundleIdentifier) const;

    std::shared_ptr<ContextInputSetting> entryOf(const std::u16string& bundleIdentifier) const;

    std::shared_ptr<const ApplicationTable> table_;
    std::shared_ptr<const ApplicationRows> ownRows_;
    std::map<std::u16string, std::shared_ptr<const ContextInputSetting>, std::less<>> applications_;
    std::shared_ptr<ContextInputSetting> newLine_;
    std::shared_ptr<ContextInputSetting> fusionApp_;
    std::shared_ptr<ContextInputSetting> parallelsApp_;
    std::shared_ptr<ContextInputSetting> crossOverApp_;
    std::shared_ptr<ContextInputSetting> wineskinApp_;
    std::shared_ptr<ContextInputSetting> adobeApp_;
};

}  // namespace plume

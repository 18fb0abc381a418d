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

#include "Foundation/Flags.h"

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

struct ContextInputSetting {
    std::optional<std::u16string> bundleIdentifier;  // of the application it was resolved for
    InputFlags flags;
    double pastingDelay = 0;        // seconds
    double afterPastingDelay = 0;   // seconds
    std::uint64_t blockLength = 0;  // units in a typed chunk; 0 means 20

    bool has(InputFlag flag) const { return flags.contains(flag); }

    // Everything but the identifier, which belongs to a resolution.
    std::shared_ptr<ContextInputSetting> copy() const;
};

// Settings by bundle identifier, with the families of identifiers.
class ContextInputSettings {
  public:
    // With the built-in applications.
    ContextInputSettings();

    // Replaces or adds one application.
    void set(const std::u16string& bundleIdentifier, std::shared_ptr<const ContextInputSetting> setting);

    // The setting for an application: a copy of its entry, the shared record of its family, or a fresh one with nothing
    // set. Its bundleIdentifier is the one asked for. Never null; `isKnown` is set to whether there was an entry or
    // family.
    std::shared_ptr<ContextInputSetting> resolve(const std::optional<std::u16string>& bundleIdentifier, bool& isKnown);

  private:
    std::shared_ptr<ContextInputSetting> familyOf(std::u16string_view bundleIdentifier) const;

    std::map<std::u16string, std::shared_ptr<const ContextInputSetting>, std::less<>> applications_;
    std::shared_ptr<ContextInputSetting> newLine_;
    std::shared_ptr<ContextInputSetting> fusionApp_;
    std::shared_ptr<ContextInputSetting> parallelsApp_;
    std::shared_ptr<ContextInputSetting> crossOverApp_;
    std::shared_ptr<ContextInputSetting> wineskinApp_;
    std::shared_ptr<ContextInputSetting> adobeApp_;
};

}  // namespace plume

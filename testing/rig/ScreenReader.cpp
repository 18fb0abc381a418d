#include "testing/rig/ScreenReader.h"

#include <algorithm>
#include <array>

#include "Foundation/Strings.h"
#include "ports/atspi/AtspiSession.h"
#include "ports/atspi/AtspiText.h"
#include "testing/rig/RigError.h"

namespace plume::rig {

namespace {

// Nobody can do anything with these.
constexpr std::array<std::optional<AtspiRole>, 3> Idle{AtspiRole::Label, AtspiRole::Filler, AtspiRole::Panel};

constexpr int MostChildren = 200;
constexpr Milliseconds Patience(3'000);  // for a search through all that a program shows

}  // namespace

ScreenReader::ScreenReader() {
    if (!bus_.connect(findAccessibilityBus().address)) throw RigError("the accessibility bus takes no screen reader");
}

std::optional<Rectangle> ScreenReader::place(pid_t process, const std::string& name) {
    const AtspiPart part = find(process, name);
    return part ? screenBounds(bus_, part) : std::nullopt;
}

std::optional<std::string> ScreenReader::text(pid_t process, const std::string& name) {
    const AtspiPart part = find(process, name);
    const auto text = part ? AtspiTextReader(bus_, part, {}).wholeText() : std::nullopt;
    return text ? std::optional(toUtf8(*text)) : std::nullopt;
}

AtspiPart ScreenReader::find(pid_t process, const std::string& name) {
    bus_.begin(Patience);
    const AtspiPart desktop{"org.a11y.atspi.Registry", "/org/a11y/atspi/accessible/root"};
    for (const AtspiPart& program : childrenOf(bus_, desktop, MostChildren)) {
        const auto its = bus_.callBus("GetConnectionUnixProcessID", {program.program}).values().uint32();
        if (its != static_cast<std::uint32_t>(process)) continue;
        for (const AtspiPart& window : childrenOf(bus_, program, MostChildren)) {
            if (AtspiPart found = findIn(window, name)) return found;
        }
    }
    return {};
}

AtspiPart ScreenReader::findIn(const AtspiPart& part, const std::string& name) {
    if (!hasState(bus_, part, AtspiState::Showing)) return {};
    if (isCalled(part, name)) return part;
    for (const AtspiPart& child : childrenOf(bus_, part, MostChildren)) {
        if (AtspiPart found = findIn(child, name)) return found;
    }
    return {};
}

bool ScreenReader::isCalled(const AtspiPart& part, const std::string& name) {
    return bus_.property(part, AccessibleInterface, "Name").values().inside().string() == name &&
           std::ranges::find(Idle, roleNumberOf(bus_, part)) == Idle.end();
}

}  // namespace plume::rig

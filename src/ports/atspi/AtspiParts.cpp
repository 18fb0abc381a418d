#include "ports/atspi/AtspiParts.h"

#include <algorithm>
#include <array>
#include <utility>

namespace plume {

namespace {

constexpr std::string_view NoPart = "/org/a11y/atspi/null";

struct NamedRole {
    AtspiRole role;
    std::u16string_view name;
};

constexpr std::array Roles = {
    NamedRole{AtspiRole::Alert, u"AXWindow"},
    NamedRole{AtspiRole::Application, u"AXApplication"},
    NamedRole{AtspiRole::CheckBox, u"AXCheckBox"},
    NamedRole{AtspiRole::ComboBox, u"AXComboBox"},
    NamedRole{AtspiRole::Dialog, u"AXWindow"},
    NamedRole{AtspiRole::DocumentWeb, u"AXWebArea"},
    NamedRole{AtspiRole::FileChooser, u"AXWindow"},
    NamedRole{AtspiRole::Filler, u"AXGroup"},
    NamedRole{AtspiRole::Frame, u"AXWindow"},
    NamedRole{AtspiRole::Icon, u"AXImage"},
    NamedRole{AtspiRole::Image, u"AXImage"},
    NamedRole{AtspiRole::Label, u"AXStaticText"},
    NamedRole{AtspiRole::Link, u"AXLink"},
    NamedRole{AtspiRole::List, u"AXList"},
    NamedRole{AtspiRole::ListBox, u"AXList"},
    NamedRole{AtspiRole::Menu, u"AXMenu"},
    NamedRole{AtspiRole::MenuBar, u"AXMenuBar"},
    NamedRole{AtspiRole::MenuItem, u"AXMenuItem"},
    NamedRole{AtspiRole::PageTabList, u"AXTabGroup"},
    NamedRole{AtspiRole::Panel, u"AXGroup"},
    NamedRole{AtspiRole::PushButton, u"AXButton"},
    NamedRole{AtspiRole::RadioButton, u"AXRadioButton"},
    NamedRole{AtspiRole::ScrollBar, u"AXScrollBar"},
    NamedRole{AtspiRole::ScrollPane, u"AXScrollArea"},
    NamedRole{AtspiRole::Slider, u"AXSlider"},
    NamedRole{AtspiRole::Static, u"AXStaticText"},
    NamedRole{AtspiRole::Table, u"AXTable"},
    NamedRole{AtspiRole::Terminal, u"AXTextArea"},
    NamedRole{AtspiRole::ToggleButton, u"AXCheckBox"},
    NamedRole{AtspiRole::ToolBar, u"AXToolbar"},
    NamedRole{AtspiRole::Tree, u"AXOutline"},
    NamedRole{AtspiRole::TreeTable, u"AXOutline"},
    NamedRole{AtspiRole::Window, u"AXWindow"},
};

}  // namespace

AtspiPart partIn(BusReader reader) {
    auto name = reader.string();
    auto path = reader.objectPath();
    // Programs write what they like as a name.
    if (!name || !path || *path == NoPart || dbus_validate_bus_name(name->c_str(), nullptr) == 0) return {};
    return {std::move(*name), std::move(*path)};
}

std::optional<AtspiStates> statesOf(AtspiBus& bus, const AtspiPart& part) {
    const BusAnswer answer = bus.call(part, AccessibleInterface, "GetState");
    BusReader words = answer.values().inside();
    const auto low = words.uint32();
    const auto high = words.uint32();
    if (!low) return std::nullopt;
    return AtspiStates(static_cast<std::uint64_t>(high.value_or(0)) << 32U | *low);
}

bool hasState(AtspiBus& bus, const AtspiPart& part, AtspiState state) {
    const auto states = statesOf(bus, part);
    return states && states->has(state);
}

std::optional<AtspiRole> roleNumberOf(AtspiBus& bus, const AtspiPart& part) {
    const auto role = bus.call(part, AccessibleInterface, "GetRole").values().uint32();
    return role ? std::optional(static_cast<AtspiRole>(*role)) : std::nullopt;
}

AtspiPart parentOf(AtspiBus& bus, const AtspiPart& part) {
    const BusAnswer answer = bus.property(part, AccessibleInterface, "Parent");
    return partIn(answer.values().inside().inside());
}

AtspiPart topLevelOf(AtspiBus& bus, AtspiPart part) {
    constexpr int DeepestPart = 100;
    for (int depth = 0; depth < DeepestPart; ++depth) {
        AtspiPart parent = parentOf(bus, part);
        if (!parent) return {};
        if (roleNumberOf(bus, parent) == AtspiRole::Application) return part;
        part = std::move(parent);
    }
    return {};
}

std::vector<AtspiPart> childrenOf(AtspiBus& bus, const AtspiPart& part, std::int32_t most) {
    std::vector<AtspiPart> children;
    const BusAnswer counted = bus.property(part, AccessibleInterface, "ChildCount");
    const std::int32_t count = counted.values().inside().int32().value_or(0);
    if (count > most) {  // perhaps millions, so not all at once
        for (std::int32_t i = 0; i < most && !bus.leftUnanswered(); ++i) {
            const BusAnswer answer = bus.call(part, AccessibleInterface, "GetChildAtIndex", {i});
            if (AtspiPart child = partIn(answer.values().inside())) children.push_back(std::move(child));
        }
    } else if (count > 0) {
        const BusAnswer answer = bus.call(part, AccessibleInterface, "GetChildren");
        for (BusReader list = answer.values().inside(); !list.isAtEnd();) {
            if (AtspiPart child = partIn(list.inside())) children.push_back(std::move(child));
        }
    }
    return children;
}

std::u16string_view roleOf(AtspiBus& bus, const AtspiPart& part) {
    const auto role = roleNumberOf(bus, part);
    if (role == AtspiRole::PasswordText) return u"AXTextField";
    if (role == AtspiRole::Entry || role == AtspiRole::Text || role == AtspiRole::SpinButton) {
        return hasState(bus, part, AtspiState::MultiLine) ? u"AXTextArea" : u"AXTextField";
    }
    const auto* found = std::ranges::find(Roles, role, &NamedRole::role);
    return found != Roles.end() ? found->name : u"AXUnknown";
}

std::u16string_view subroleOf(AtspiBus& bus, const AtspiPart& part) {
    const auto role = roleNumberOf(bus, part);
    if (!role) return u"";
    switch (*role) {
        case AtspiRole::PasswordText:
            return u"AXSecureTextField";
        case AtspiRole::Alert:
        case AtspiRole::Dialog:
        case AtspiRole::FileChooser:
            return u"AXDialog";
        case AtspiRole::Frame:
            return u"AXStandardWindow";
        default:
            return u"";
    }
}

}  // namespace plume

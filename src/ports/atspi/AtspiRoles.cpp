#include "ports/atspi/AtspiRoles.h"

#include <algorithm>
#include <array>

namespace plume {

namespace {

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

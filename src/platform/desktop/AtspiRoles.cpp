#include "platform/desktop/AtspiRoles.h"

#include <algorithm>
#include <array>

namespace plume {

namespace {

struct NamedRole {
    AtspiRole role;
    std::u16string_view name;
};

constexpr std::array Roles = {
    NamedRole{ATSPI_ROLE_ALERT, u"AXWindow"},
    NamedRole{ATSPI_ROLE_APPLICATION, u"AXApplication"},
    NamedRole{ATSPI_ROLE_CHECK_BOX, u"AXCheckBox"},
    NamedRole{ATSPI_ROLE_COMBO_BOX, u"AXComboBox"},
    NamedRole{ATSPI_ROLE_DIALOG, u"AXWindow"},
    NamedRole{ATSPI_ROLE_DOCUMENT_WEB, u"AXWebArea"},
    NamedRole{ATSPI_ROLE_FILE_CHOOSER, u"AXWindow"},
    NamedRole{ATSPI_ROLE_FILLER, u"AXGroup"},
    NamedRole{ATSPI_ROLE_FRAME, u"AXWindow"},
    NamedRole{ATSPI_ROLE_ICON, u"AXImage"},
    NamedRole{ATSPI_ROLE_IMAGE, u"AXImage"},
    NamedRole{ATSPI_ROLE_LABEL, u"AXStaticText"},
    NamedRole{ATSPI_ROLE_LINK, u"AXLink"},
    NamedRole{ATSPI_ROLE_LIST, u"AXList"},
    NamedRole{ATSPI_ROLE_LIST_BOX, u"AXList"},
    NamedRole{ATSPI_ROLE_MENU, u"AXMenu"},
    NamedRole{ATSPI_ROLE_MENU_BAR, u"AXMenuBar"},
    NamedRole{ATSPI_ROLE_MENU_ITEM, u"AXMenuItem"},
    NamedRole{ATSPI_ROLE_PAGE_TAB_LIST, u"AXTabGroup"},
    NamedRole{ATSPI_ROLE_PANEL, u"AXGroup"},
    NamedRole{ATSPI_ROLE_PUSH_BUTTON, u"AXButton"},
    NamedRole{ATSPI_ROLE_RADIO_BUTTON, u"AXRadioButton"},
    NamedRole{ATSPI_ROLE_SCROLL_BAR, u"AXScrollBar"},
    NamedRole{ATSPI_ROLE_SCROLL_PANE, u"AXScrollArea"},
    NamedRole{ATSPI_ROLE_SLIDER, u"AXSlider"},
    NamedRole{ATSPI_ROLE_STATIC, u"AXStaticText"},
    NamedRole{ATSPI_ROLE_TABLE, u"AXTable"},
    NamedRole{ATSPI_ROLE_TERMINAL, u"AXTextArea"},
    NamedRole{ATSPI_ROLE_TOGGLE_BUTTON, u"AXCheckBox"},
    NamedRole{ATSPI_ROLE_TOOL_BAR, u"AXToolbar"},
    NamedRole{ATSPI_ROLE_TREE, u"AXOutline"},
    NamedRole{ATSPI_ROLE_TREE_TABLE, u"AXOutline"},
    NamedRole{ATSPI_ROLE_WINDOW, u"AXWindow"},
};

}  // namespace

std::u16string_view roleOf(AtspiAccessible* part) {
    const AtspiRole role = atspi_accessible_get_role(part, nullptr);
    if (role == ATSPI_ROLE_PASSWORD_TEXT) return u"AXTextField";
    if (role == ATSPI_ROLE_ENTRY || role == ATSPI_ROLE_TEXT || role == ATSPI_ROLE_SPIN_BUTTON) {
        return hasState(part, ATSPI_STATE_MULTI_LINE) ? u"AXTextArea" : u"AXTextField";
    }
    const auto* found = std::ranges::find(Roles, role, &NamedRole::role);
    return found != Roles.end() ? found->name : u"AXUnknown";
}

std::u16string_view subroleOf(AtspiAccessible* part) {
    switch (atspi_accessible_get_role(part, nullptr)) {
        case ATSPI_ROLE_PASSWORD_TEXT:
            return u"AXSecureTextField";
        case ATSPI_ROLE_ALERT:
        case ATSPI_ROLE_DIALOG:
        case ATSPI_ROLE_FILE_CHOOSER:
            return u"AXDialog";
        case ATSPI_ROLE_FRAME:
            return u"AXStandardWindow";
        default:
            return u"";
    }
}

}  // namespace plume

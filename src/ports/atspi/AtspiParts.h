// What the parts of programs are asked, by several files, and what AT-SPI and Plume call them. All on the accessibility
// thread.
#pragma once

#include <cstdint>
#include <optional>
#include <string_view>
#include <vector>

#include "ports/atspi/AtspiBus.h"

namespace plume {

constexpr const char* AccessibleInterface = "org.a11y.atspi.Accessible";

// The numbers of the states and roles that Plume knows; programs use many more.
enum class AtspiState : std::uint32_t {
    Active = 1,
    Editable = 7,
    Focused = 12,
    MultiLine = 17,
    Showing = 25,
    ManagesDescendants = 31,
};

enum class AtspiRole : std::uint32_t {
    Alert = 2,
    CheckBox = 7,
    ComboBox = 11,
    Dialog = 16,
    FileChooser = 19,
    Filler = 20,
    Frame = 23,
    Icon = 26,
    Image = 27,
    Label = 29,
    List = 31,
    Menu = 33,
    MenuBar = 34,
    MenuItem = 35,
    PageTabList = 38,
    Panel = 39,
    PasswordText = 40,
    PushButton = 43,
    RadioButton = 44,
    ScrollBar = 48,
    ScrollPane = 49,
    Slider = 51,
    SpinButton = 52,
    Table = 55,
    Terminal = 60,
    Text = 61,
    ToggleButton = 62,
    ToolBar = 63,
    Tree = 65,
    TreeTable = 66,
    Window = 69,
    Application = 75,
    Entry = 79,
    Link = 88,
    DocumentWeb = 95,
    ListBox = 98,
    Static = 116,
};

class AtspiStates {
  public:
    explicit AtspiStates(std::uint64_t bits) : bits_(bits) {}
    bool has(AtspiState state) const { return (bits_ >> static_cast<std::uint32_t>(state) & 1U) != 0; }

  private:
    std::uint64_t bits_;
};

// Nothing, or none, when there is no answer.
std::optional<AtspiStates> statesOf(AtspiBus& bus, const AtspiPart& part);
bool hasState(AtspiBus& bus, const AtspiPart& part, AtspiState state);
std::optional<AtspiRole> roleNumberOf(AtspiBus& bus, const AtspiPart& part);
AtspiPart parentOf(AtspiBus& bus, const AtspiPart& part);
// The window: the part right below the program, for which a toolkit may have a part or none.
AtspiPart topLevelOf(AtspiBus& bus, AtspiPart part);
std::vector<AtspiPart> childrenOf(AtspiBus& bus, const AtspiPart& part, std::int32_t most);

// "AXUnknown" for a role that Plume has no use for.
std::u16string_view roleOf(AtspiBus& bus, const AtspiPart& part);
// Empty when it has none.
std::u16string_view subroleOf(AtspiBus& bus, const AtspiPart& part);

// A structure of a name and a path; none for what cannot be asked.
AtspiPart partIn(BusReader reader);

}  // namespace plume

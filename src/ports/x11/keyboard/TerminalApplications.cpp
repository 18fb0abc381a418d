#include "ports/x11/keyboard/TerminalApplications.h"

#include <algorithm>
#include <iterator>
#include <string>

namespace plume {

namespace {

struct Terminal {
    std::u16string_view identifier;  // in small letters
    PasteStyle style;
};

// Sorted. Desktop files and window classes of the same program are rows of their own.
constexpr Terminal Terminals[] = {
    {u"alacritty", PasteStyle::ControlShift},
    {u"aterm", PasteStyle::ShiftInsert},
    {u"blackbox", PasteStyle::ControlShift},
    {u"com.alacritty.alacritty", PasteStyle::ControlShift},
    {u"com.gexperts.tilix", PasteStyle::ControlShift},
    {u"com.mitchellh.ghostty", PasteStyle::ControlShift},
    {u"com.raggesilver.blackbox", PasteStyle::ControlShift},
    {u"contour", PasteStyle::ControlShift},
    {u"cool-retro-term", PasteStyle::ControlShift},
    {u"debian-uxterm", PasteStyle::ShiftInsert},
    {u"debian-xterm", PasteStyle::ShiftInsert},
    {u"deepin-terminal", PasteStyle::ControlShift},
    {u"eterm", PasteStyle::ShiftInsert},
    {u"ghostty", PasteStyle::ControlShift},
    {u"gnome-terminal", PasteStyle::ControlShift},
    {u"gnome-terminal-server", PasteStyle::ControlShift},
    {u"guake", PasteStyle::ControlShift},
    {u"hyper", PasteStyle::ControlShift},
    {u"io.elementary.terminal", PasteStyle::ControlShift},
    {u"kgx", PasteStyle::ControlShift},
    {u"kitty", PasteStyle::ControlShift},
    {u"koi8rxterm", PasteStyle::ShiftInsert},
    {u"konsole", PasteStyle::ControlShift},
    {u"lxterm", PasteStyle::ShiftInsert},
    {u"lxterminal", PasteStyle::ControlShift},
    {u"mate-terminal", PasteStyle::ControlShift},
    {u"mlterm", PasteStyle::ShiftInsert},
    {u"org.contourterminal.contour", PasteStyle::ControlShift},
    {u"org.gnome.console", PasteStyle::ControlShift},
    {u"org.gnome.ptyxis", PasteStyle::ControlShift},
    {u"org.gnome.terminal", PasteStyle::ControlShift},
    {u"org.kde.konsole", PasteStyle::ControlShift},
    {u"org.kde.yakuake", PasteStyle::ControlShift},
    {u"org.wezfurlong.wezterm", PasteStyle::ControlShift},
    {u"pantheon-terminal", PasteStyle::ControlShift},
    {u"ptyxis", PasteStyle::ControlShift},
    {u"qterminal", PasteStyle::ControlShift},
    {u"rio", PasteStyle::ControlShift},
    {u"roxterm", PasteStyle::ControlShift},
    {u"rxvt", PasteStyle::ShiftInsert},
    {u"rxvt-unicode", PasteStyle::ShiftInsert},
    {u"sakura", PasteStyle::ControlShift},
    {u"st", PasteStyle::ControlShift},
    {u"st-256color", PasteStyle::ControlShift},
    {u"tabby", PasteStyle::ControlShift},
    {u"terminator", PasteStyle::ControlShift},
    {u"terminology", PasteStyle::ControlShift},
    {u"tilda", PasteStyle::ControlShift},
    {u"tilix", PasteStyle::ControlShift},
    {u"urxvt", PasteStyle::ShiftInsert},
    {u"urxvtc", PasteStyle::ShiftInsert},
    {u"uxterm", PasteStyle::ShiftInsert},
    {u"wezterm", PasteStyle::ControlShift},
    {u"wterm", PasteStyle::ShiftInsert},
    {u"xfce4-terminal", PasteStyle::ControlShift},
    {u"xterm", PasteStyle::ShiftInsert},
    {u"yakuake", PasteStyle::ControlShift},
};
static_assert(std::ranges::is_sorted(Terminals, {}, &Terminal::identifier));

std::u16string inSmallLetters(std::u16string_view identifier) {
    std::u16string letters(identifier);
    for (char16_t& c : letters) {
        if (c >= u'A' && c <= u'Z') c = static_cast<char16_t>(c - u'A' + u'a');
    }
    return letters;
}

}  // namespace

PasteStyle pasteStyleOf(std::u16string_view identifier) {
    std::u16string key = inSmallLetters(identifier);
    constexpr std::u16string_view DesktopFile = u".desktop";
    if (key.ends_with(DesktopFile)) key.resize(key.size() - DesktopFile.size());
    const auto* const found = std::ranges::lower_bound(Terminals, std::u16string_view(key), {}, &Terminal::identifier);
    return found != std::end(Terminals) && found->identifier == key ? found->style : PasteStyle::Control;
}

bool pastesPrimary(std::u16string_view identifier) {
    return pasteStyleOf(identifier) == PasteStyle::ShiftInsert;
}

}  // namespace plume

// Turns texts of the library into rows of a menu: one line, short, and nothing in it that a menu takes for a command.
//
// Pure; from any thread.
#pragma once

#include <QString>
#include <string_view>

namespace plume {

class Snippet;

// Who draws a menu.
enum class MenuHome {
    Widget,  // Plume itself
    Bus      // the desktop's panel, which is sent the rows
};

// The first line that holds something, with single spaces, without control characters, changes of direction and
// places of pictures; elided to `limit` characters as a reader counts them. Empty when nothing is left.
QString harmlessLine(std::u16string_view text, qsizetype limit);

// The abbreviation as it is typed, with a label or the beginning of the content.
QString snippetLine(const Snippet& snippet);
// As little as tells it from others: the abbreviation, or else what snippetLine() says.
QString snippetName(const Snippet& snippet);

// So that it is read in a menu as it stands: "&" and, on the bus, "_" would mark the letter behind them.
QString asMenuText(QString text, MenuHome home);

}  // namespace plume

// Changing the library as text in an editor of the user's choice.
#pragma once

#include <iosfwd>

namespace plume {

// Writes the library as readable JSON into a file, lets $VISUAL or $EDITOR work on it, and takes what comes out of that
// in place of the library, after a backup. A mistake in it is shown with its place; the editor comes up again if the
// user wants that, otherwise the text stays where the message says. Returns the exit status.
int editLibrary(std::istream& input, std::ostream& output, std::ostream& error);

}  // namespace plume

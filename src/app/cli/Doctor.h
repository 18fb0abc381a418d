// Looks at the desktop: what of it Plume can use, what is missing, and what to do about that.
#pragma once

#include <iosfwd>

namespace plume {

// Writes its findings, and returns the exit status: whether `plume run` could work here. Changes nothing on the
// desktop, and takes two seconds at most when its parts answer.
int examineDesktop(std::ostream& output);

}  // namespace plume

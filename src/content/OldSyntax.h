// The older placeholder syntax, "%date:short%", of libraries that older versions wrote.
#pragma once

#include "library/Snippet.h"

namespace plume {

// Rewrites the snippet's content in today's syntax, in place. A snippet without content stays as it is.
void convertOldSnippet(Snippet& snippet);

}  // namespace plume

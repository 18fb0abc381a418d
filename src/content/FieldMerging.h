// Putting the values of the fill-in form into the content.
#pragma once

#include "content/SnippetExpandedContent.h"

namespace plume {

// Puts every field's value in at the field's location, and moves what stands behind it. A field without a value, and an
// optional one that is not ticked, gives the empty string.
void mergeFields(SnippetExpandedContent& content);

}  // namespace plume

// Placeholders that are changed by hand: reading one, and writing it without losing what its kind does not know.
//
// Pure; from any thread.
#pragma once

#include <memory>
#include <string>
#include <string_view>

#include "content/SnippetVariable.h"

namespace plume {

// The placeholder that has something to change; null for the caret and for what is none. An arrow is the key that it
// stands for.
std::shared_ptr<SnippetVariable> editablePlaceholder(std::u16string_view body);

// The body that makes `changed`, which was read from `original`. Parameters of the original that its kind does not know
// stand at the end, by their names.
std::u16string editedBody(std::u16string_view original, const SnippetVariable& changed);

}  // namespace plume

// The text of AutoKey's phrases and the source of its scripts, as Plume says it.
#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "import/ScriptShelf.h"

namespace plume {

// The phrase with placeholders for its macros and keys: "<cursor>", "<date format=%Y>", "<ctrl>+a". What the text of
// anything else in angle brackets is stays as it is. `problems` gets what is lost. `name` is what its scripts are
// called after.
std::u16string contentOfAutoKeyPhrase(std::u16string_view phrase, const std::u16string& name, ScriptShelf& scripts,
                                      std::vector<std::string>& problems);

// A shell script that runs the Python source, or nothing when the source needs what only AutoKey gives it.
std::optional<std::u16string> shellScriptOfPython(std::u16string_view source);

}  // namespace plume

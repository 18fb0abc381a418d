// Scripts that make shells complete the command line of the program.
#pragma once

#include <string>

namespace plume {

// For "bash", "zsh" or "fish". Abbreviations are asked for when they are needed.
std::string completionScript(const std::string& shell);

}  // namespace plume

// Writes shell scripts for what other programs run or choose.
#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace plume {

// In single quotes, so that the shell takes nothing of it for its own.
std::u16string quotedForShell(std::u16string_view text);

// Sets and exports a variable of the shell to a text that may hold placeholders: what they are replaced by is never
// read as commands.
std::u16string shellAssignment(std::u16string_view variable, std::u16string_view text);

// A bash script that prints one of the texts, each as likely as the others. Without placeholders.
std::u16string randomChoiceScript(const std::vector<std::u16string>& choices);

}  // namespace plume

// What the window filters of other text expanders say, as far as a list of applications can say it.
#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace plume {

// The names that a regular expression stands for: "^(Firefox|Google-chrome)$" is two. As they are written and in lower
// case, since window classes and desktop files of one program often differ in that. Nothing when it stands for more
// than a few names.
std::optional<std::vector<std::u16string>> namesInPattern(std::u16string_view pattern);

// The program's name in such names of executables: "/usr/bin/gedit", "Telegram.exe".
std::vector<std::u16string> programNames(const std::vector<std::u16string>& paths);

}  // namespace plume

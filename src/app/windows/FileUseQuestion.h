// Whether a library's file is to be imported, or to take the place of the library.
//
// On the main thread; owns itself.
#pragma once

#include <filesystem>
#include <functional>

#include "app/ApplicationWindows.h"

class QWidget;

namespace plume {

// `answer` is called once; FileUse::Nothing when the question is closed.
QWidget* askForFileUse(const std::filesystem::path& file, std::function<void(ApplicationWindows::FileUse)> answer);

}  // namespace plume

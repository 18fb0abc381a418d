// Panels for the files that a library is read from and written to.
//
// On the main thread; each owns itself. `chosen` is called once, or never when the panel is closed.
#pragma once

#include <filesystem>
#include <functional>

class QWidget;

namespace plume {

// A file of any kind that can be imported.
QWidget* askForLibraryFile(std::function<void(const std::filesystem::path&)> chosen);

// Where to write the library: a path that ends with .plume, .csv or .json. Who chooses a file that is there has agreed
// to its being replaced.
QWidget* askWhereToExport(std::function<void(const std::filesystem::path&)> chosen);

}  // namespace plume

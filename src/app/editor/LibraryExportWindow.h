// The panel for the file that snippets are written to, and their being written.
//
// On the main thread; owns itself, and is gone when it is closed. The filter that is chosen gives the file its ending.
// A file that is there is replaced only when its being replaced was agreed to in the panel.
#pragma once

#include <QFileDialog>
#include <filesystem>
#include <functional>

#include "app/editing/LibraryEditor.h"
#include "platform/Files.h"

namespace plume {

class LibraryExportWindow final : public QFileDialog {
    Q_OBJECT
  public:
    using Write = std::function<Result<void>(const std::filesystem::path& path)>;

    // `name` is what the file is called at first, without an ending. `write` is called once at most; its error is told.
    LibraryExportWindow(QWidget* parent, const QString& title, const QString& name, Write write);

    Q_SIGNAL void exported(const std::filesystem::path& path);

  private:
    void takeEnding(const QString& filter);
    void exportTo(const QString& path);

    const Write write_;
};

// Open at once, and hold up the window `parent` alone. The manager and the files outlive them.
LibraryExportWindow* exportLibrary(QWidget* parent, DataManager& manager, Files& files);
LibraryExportWindow* exportGroup(QWidget* parent, DataManager& manager, Files& files,
                                 const std::shared_ptr<SnippetGroup>& group);
// As it is now; null when nothing is selected.
LibraryExportWindow* exportSelection(QWidget* parent, DataManager& manager, Files& files,
                                     const LibrarySelection& selection);

}  // namespace plume

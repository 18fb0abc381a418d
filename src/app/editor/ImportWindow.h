// Shows what a file would bring into the library, and imports what of it is wanted.
//
// On the main thread; owns itself, and is gone when it is closed. It holds up the window that it belongs to. The file
// is read in the background; closing the window meanwhile imports nothing.
#pragma once

#include <QDialog>
#include <filesystem>
#include <functional>

#include "app/editing/ImportPreview.h"
#include "platform/Files.h"
#include "platform/UserDefaults.h"

class QCheckBox;
class QLabel;
class QListView;
class QProgressBar;
class QPushButton;
class QStringListModel;
class QTreeView;
class QVBoxLayout;

namespace plume {

class ImportModel;

class ImportWindow final : public QDialog {
    Q_OBJECT
  public:
    // All of it outlives the window, and the work in the background.
    struct Services {
        const Files& files;
        WritableUserDefaults& settings;
        std::function<const SnippetGroups&()> library;
        // Of what was chosen; once, before the window closes.
        std::function<void(const ImportedLibrary& chosen)> import;
        // Does the work on another thread, then calls back on the main one. Empty: at once, here.
        std::function<void(std::function<void()> work, std::function<void()> done)> inBackground = {};
    };

    // Begins to read. `parent` may be null.
    ImportWindow(QWidget* parent, Services services, const std::filesystem::path& path);

    void reject() override { close(); }

  protected:
    void closeEvent(QCloseEvent* event) override;

  private:
    void makeList();
    void makeRemarks();
    void addShownWhenRead(QVBoxLayout& layout);
    void makeButtons(QVBoxLayout& layout);
    void read(const std::filesystem::path& path);
    void showRead(Result<ImportCandidate> candidate);
    void showFailure(const QString& heading, const QString& reason);
    void showPreview();
    void showHeading();
    void showChoice();
    void importChosen();

    const Services services_;
    const QString fileName_;
    ImportCandidate candidate_;
    ImportModel* model_;
    QStringListModel* remarkModel_;
    QLabel* heading_;
    QLabel* reason_;
    QProgressBar* progress_;
    QTreeView* list_;
    QCheckBox* converts_;
    QLabel* remarksTitle_;
    QListView* remarks_;
    QPushButton* importButton_;
    QPushButton* cancelButton_;
};

}  // namespace plume

// Lets the user choose a backup, or another .plume file, to take the place of the library.
//
// On the main thread; owns itself, and is gone when it is closed or something was restored. All that it is given
// outlives it.
#pragma once

#include <optional>
#include <vector>

#include "app/windows/SmallWindow.h"
#include "library/DataManager.h"

class QLabel;
class QListView;
class QPushButton;
class QStandardItemModel;

namespace plume {

class RestoreDataWindowController final : public SmallWindow {
    Q_OBJECT
  public:
    RestoreDataWindowController(DataManager& manager, const Files& files, WritableUserDefaults& settings);

  protected:
    // Backups may have come and gone while another window was in front.
    void changeEvent(QEvent* event) override;

  private:
    void makeLayout(WritableUserDefaults& settings);
    void fill();
    void selectionChanged();
    void restoreSelected();
    std::optional<Files::Path> selectedBackup() const;
    void chooseFile();
    void askAndRestore(const Files::Path& path);
    void restore(const Files::Path& path);
    // Whether the file is there; tells when it is not.
    bool checkExists(const Files::Path& path);

    DataManager& manager_;
    const Files& files_;
    std::vector<Files::Path> paths_;  // of the rows
    QStandardItemModel* model_;
    QListView* list_;
    QLabel* nothing_;
    QPushButton* restoreButton_;
};

}  // namespace plume

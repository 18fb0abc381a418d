// The list of groups and snippets with the field that searches it and the line that counts.
//
// On the main thread; the editor's window owns it. The library and the settings outlive it.
#pragma once

#include <QWidget>

#include "Foundation/Subscription.h"
#include "app/editing/LibraryFilter.h"
#include "app/editor/OutlineModel.h"

class QLabel;
class QLineEdit;
class QMenu;

namespace plume {

class OutlineView;

class OutlinePane final : public QWidget {
    Q_OBJECT
  public:
    OutlinePane(LibraryEditor& editor, WritableUserDefaults& settings);

    OutlineView& view() { return *view_; }
    OutlineModel& model() { return model_; }
    bool filtering() const { return filter_.filtering(); }

    // After the lists of the library have changed.
    void reload();
    void clearFilter();
    void focusFilter();
    // "Search by" and wildcards, for the menu bar too.
    QMenu& options() { return *options_; }
    // Open groups are kept with the settings.
    void keepOpenGroups();

  protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

  private:
    void makeOptions();
    void addField(SnippetSearch::SearchBy field, const QString& text);
    void onFilterChanged();
    void refreshStatusString();
    void settingsChanged(UserDefaultsChange& change);
    void setFontSize();

    LibraryEditor& editor_;
    WritableUserDefaults& settings_;
    LibraryFilter filter_;
    OutlineModel model_;
    QLineEdit* field_;
    QMenu* options_;
    OutlineView* view_;
    QLabel* nothing_;
    QLabel* status_;
    Subscription fontSize_;
};

}  // namespace plume

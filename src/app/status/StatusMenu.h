// The icon's menu: whether Plume is on, the user's groups of snippets, and the way to everything else.
//
// Owned by the icon; belongs to the main thread. Follows the status also while it is open; the library is looked at
// each time that it opens. What a row does is done when the menu is gone, for it may type into another program.
#pragma once

#include <QMenu>
#include <functional>
#include <memory>
#include <vector>

#include "app/StatusItem.h"
#include "app/status/MenuTexts.h"
#include "app/status/StatusMenuServices.h"

namespace plume {

class SnippetRowsMenu;

class StatusMenu final : public QMenu {
    Q_OBJECT
  public:
    StatusMenu(StatusMenuServices services, MenuHome home);

    void setStatus(const Status& status);

  private:
    struct Group {
        QString title;
        std::weak_ptr<const SnippetGroup> group;
        SnippetRowsMenu* menu = nullptr;
    };

    void addStatusRows();
    void addSnippetRows();
    void addOtherRows();
    QAction* addRow(QMenu& menu, const QString& text, const std::function<void()>& act);
    void showStatus();

    void prepare();
    bool hasGroupsOfNow() const;
    void addGroupsOfNow();
    void setFontSize();

    void whenGone(std::function<void()> act, int delay);
    void send(const std::weak_ptr<Snippet>& chosen);

    const StatusMenuServices services_;
    const MenuHome home_;
    Status status_;
    QAction* enabled_ = nullptr;
    QAction* secureInput_ = nullptr;
    QAction* listenAgain_ = nullptr;
    QAction* afterGroups_ = nullptr;
    std::vector<Group> groups_;
};

}  // namespace plume

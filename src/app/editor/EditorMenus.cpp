#include "app/editor/EditorMenus.h"

#include <QAction>
#include <QMenu>

namespace plume {

QAction* EditorMenus::add(QMenu& menu, const QString& text, const QKeySequence& keys, Command command,
                          Condition canBeUsed) {
    QAction* action = menu.addAction(text);
    action->setShortcut(keys);
    connect(action, &QAction::triggered, this, std::move(command));
    if (canBeUsed) conditions_.emplace_back(action, std::move(canBeUsed));
    return action;
}

QAction* EditorMenus::addFor(QWidget& widget, QMenu& menu, const QString& text, const QKeySequence& keys,
                             Command command, Condition canBeUsed) {
    QAction* action = add(menu, text, keys, std::move(command), std::move(canBeUsed));
    action->setShortcutContext(Qt::WidgetShortcut);
    widget.addAction(action);
    return action;
}

void EditorMenus::refresh() {
    for (const auto& [action, canBeUsed] : conditions_) action->setEnabled(canBeUsed());
}

}  // namespace plume

// The menus of the editor's window, and which of their commands can be used now.
//
// On the main thread; the window owns it.
#pragma once

#include <QKeySequence>
#include <QObject>
#include <functional>
#include <utility>
#include <vector>

class QAction;
class QMenu;
class QWidget;

namespace plume {

class EditorMenus final : public QObject {
    Q_OBJECT
  public:
    using Command = std::function<void()>;
    using Condition = std::function<bool()>;

    explicit EditorMenus(QObject* parent) : QObject(parent) {}

    // A command without a condition can always be used.
    QAction* add(QMenu& menu, const QString& text, const QKeySequence& keys, Command command,
                 Condition canBeUsed = nullptr);
    // Its keys hold while this widget has the keyboard.
    QAction* addFor(QWidget& widget, QMenu& menu, const QString& text, const QKeySequence& keys, Command command,
                    Condition canBeUsed);
    // After what the conditions ask has changed.
    void refresh();

  private:
    std::vector<std::pair<QAction*, Condition>> conditions_;
};

}  // namespace plume

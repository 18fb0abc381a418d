#include "app/form/helper/PageView.h"

#include <QContextMenuEvent>
#include <QMenu>
#include <QWebEngineContextMenuRequest>

namespace plume {

void PageView::contextMenuEvent(QContextMenuEvent* event) {
    auto* const menu = new QMenu(this);
    menu->setAttribute(Qt::WA_DeleteOnClose);
    addSpellings(*menu);
    const bool isEditable = lastContextMenuRequest()->isContentEditable();
    for (const auto action : {QWebEnginePage::Undo, QWebEnginePage::Redo, QWebEnginePage::Cut, QWebEnginePage::Copy,
                              QWebEnginePage::Paste, QWebEnginePage::SelectAll}) {
        if (isEditable || action == QWebEnginePage::Copy) menu->addAction(pageAction(action));
    }
    menu->popup(event->globalPos());
}

void PageView::addSpellings(QMenu& menu) {
    const QStringList spellings = lastContextMenuRequest()->spellCheckerSuggestions();
    for (const QString& spelling : spellings) {
        menu.addAction(spelling, page(), [this, spelling] { page()->replaceMisspelledWord(spelling); });
    }
    if (!spellings.isEmpty()) menu.addSeparator();
}

}  // namespace plume

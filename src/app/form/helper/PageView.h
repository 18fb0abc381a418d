// A view of a page whose menu holds what one does with text, and nothing of browsers.
//
// On the main thread; belongs to its window.
#pragma once

#include <QWebEngineView>

class QMenu;

namespace plume {

class PageView final : public QWebEngineView {
    Q_OBJECT
  public:
    explicit PageView(QWidget* parent) : QWebEngineView(parent) {}

  protected:
    void contextMenuEvent(QContextMenuEvent* event) override;

  private:
    void addSpellings(QMenu& menu);
};

}  // namespace plume

// The suggestion list's window: beside the caret, above everything, and never in the way of the keyboard.
//
// On the main thread; whoever puts the application together owns it.
#pragma once

#include <QFrame>

#include "app/SuggestionView.h"

class QLabel;
class QListView;
class QStandardItemModel;

namespace plume {

class SuggestionWindow final : public QFrame, public SuggestionView {
    Q_OBJECT
  public:
    SuggestionWindow();

    void setEvents(Events events) override { events_ = std::move(events); }
    void show(const SuggestionPage& page, const CaretPlace& place) override;
    void update(const SuggestionPage& page) override;
    void hide() override { QFrame::hide(); }

  protected:
    void wheelEvent(QWheelEvent* event) override;

  private:
    void fill(const SuggestionPage& page);
    void fillCount(const SuggestionPage& page);
    void placeWindow();
    QSize fittingSize();
    void rowClicked(const QModelIndex& index) const;

    Events events_;
    SuggestionPage page_;
    CaretPlace place_;
    QStandardItemModel* model_;
    QListView* list_;
    QLabel* count_;
    int width_ = 0;      // of the rows
    int wheelRest_ = 0;  // of a turn that made no whole row yet
};

}  // namespace plume

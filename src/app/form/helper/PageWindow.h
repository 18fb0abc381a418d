// The window of one form: a page, placed beside where the user types.
//
// On the main thread; owned by whoever keeps the forms. Its page is loaded when it is made, and shown when that is
// wanted and the page is there.
#pragma once

#include <QWidget>
#include <functional>
#include <optional>

#include "app/form/FormMessages.h"
#include "app/form/helper/PageLink.h"

class QWebEngineView;

namespace plume {

class PageProfile;

class PageWindow final : public QWidget {
    Q_OBJECT
  public:
    struct Events {
        std::function<void(const FormReport& report)> reported;
        // What draws the pages has ended.
        std::function<void()> died;
    };

    PageWindow(PageProfile& profile, const PrepareForm& form, Events events);
    ~PageWindow() override;

    void place(const FormPlace& place);
    void update(const UpdateForm& order);

  protected:
    void changeEvent(QEvent* event) override;
    void closeEvent(QCloseEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    bool eventFilter(QObject* watched, QEvent* event) override;

  private:
    PageLink::Events linkEvents();
    void makePage(PageProfile& profile);
    void drawAhead(QSize size);
    void appearWhenReady();
    void comeToScreen(const QRect& frame);
    void keepOnScreen();
    void pageDrawn();
    Q_INVOKABLE void painted();
    QSize fittingSize(QSize room) const;

    const FormNumber form_;
    const Events events_;
    PageLink link_;
    QWebEngineView* view_;
    std::optional<FormPlace> place_;
    std::optional<QSize> measured_;
    bool isDrawn_ = false;     // in the size that it has now
    bool isOnScreen_ = false;  // or on its way there
    bool isTold_ = false;      // that it is shown
};

}  // namespace plume
